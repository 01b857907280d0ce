#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/ValueFormatter.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>

namespace VelaMediaLib {

/// An interpolater value is written as its name and read back through the
/// shared instances; an empty reference is written as null.
template <typename X>
struct VELAMEDIALIB_TEMPLATE_API ValueFormatter<boost::shared_ptr<Interpolater<X>>> {
    static void write(std::ostream& out, const boost::shared_ptr<Interpolater<X>>& value) {
        out << (value ? value->asJson() : std::string("null"));
    }
    /// Defined in detail/InterpolaterValueFormatterRead.h, where the library reads documents.
    static boost::shared_ptr<Interpolater<X>> read(const Json::Value& json);
};

} // namespace VelaMediaLib
