#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/ChildrensTimeConverter.h>

namespace VelaMediaLib {

class Group;

/// What a group's mixer hands its tracks as parent converter: the group's
/// parametric time to the time of its own tracks, on which its children
/// stand (see ChildrensTimeConverter). It lives inside its group and is
/// handed out sharing the group's ownership.
class VELAMEDIALIB_API GroupChildrensTimeConverter : public ChildrensTimeConverter {
public:
    explicit GroupChildrensTimeConverter(const Group& group) : group_(group) {}

protected:
    boost::shared_ptr<const Media> container() const override;

private:
    const Group& group_;
};

} // namespace VelaMediaLib
