#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Source;

/// Something that plays an imported source; clips without one answer null.
class VELAMEDIALIB_API Sourceable {
public:
    virtual ~Sourceable() = default;
    virtual boost::shared_ptr<const Source> source() const = 0;
    virtual void setSource(const boost::shared_ptr<const Source>& source) = 0;
};

} // namespace VelaMediaLib
