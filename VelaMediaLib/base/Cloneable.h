#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

/// Something that can be copied whole.
class VELAMEDIALIB_API Cloneable {
public:
    virtual ~Cloneable() = default;
};

/// A Cloneable whose copies are of a known base type.
template <typename Base>
class VELAMEDIALIB_TEMPLATE_API DecoratedCloneable : public Cloneable {
public:
    virtual boost::shared_ptr<Base> clone() const = 0;
};

} // namespace VelaMediaLib
