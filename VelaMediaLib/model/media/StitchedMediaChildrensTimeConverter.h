#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/ChildrensTimeConverter.h>

namespace VelaMediaLib {

class StitchedMedia;

/// What a stitched media's internal track names as its parent converter:
/// the stitched media's parametric time to the time of its internal track,
/// where its parts lie end to end (see ChildrensTimeConverter), so a part's
/// time follows every trim and stretch of the stitched media. It holds the
/// stitched media weakly.
class VELAMEDIALIB_API StitchedMediaChildrensTimeConverter : public ChildrensTimeConverter {
public:
    explicit StitchedMediaChildrensTimeConverter(const boost::weak_ptr<const StitchedMedia>& stitched)
        : stitched_(stitched) {}

protected:
    boost::shared_ptr<const Media> container() const override;

private:
    boost::weak_ptr<const StitchedMedia> stitched_;
};

} // namespace VelaMediaLib
