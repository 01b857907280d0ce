#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/time/parameters/Parameter.h>

#include <boost/shared_ptr.hpp>
#include <cstdint>
#include <map>
#include <type_traits>

namespace VelaMediaLib {

/// The objects a document reading has met, by their "id". An identifier added
/// as one kind answers an empty pointer when asked for as a kind it is not
/// (a Source asked for as a Media); a clip can be asked for as any of its
/// kinds (Media, Parametric, its own class).
class VELAMEDIALIB_API SymbolTable {
public:
    /// For sources, timelines, groups, effects, clips and vector nodes.
    template <typename T>
    void addSymbol(uint32_t ident, const boost::shared_ptr<T>& object) {
        static_assert(std::is_base_of<VelaObject, T>::value, "symbols are model objects");
        objects_[ident] = object;
    }
    void addParameterSymbol(uint32_t ident, const boost::shared_ptr<Parameter<double>>& parameter) {
        parameters_[ident] = parameter;
    }

    template <typename T>
    boost::shared_ptr<T> symbolForIdent(uint32_t ident) const {
        if constexpr (std::is_same<T, Parameter<double>>::value) {
            const auto found = parameters_.find(ident);
            return found == parameters_.end() ? boost::shared_ptr<T>() : found->second;
        } else {
            const auto found = objects_.find(ident);
            return found == objects_.end() ? boost::shared_ptr<T>()
                                           : boost::dynamic_pointer_cast<T>(found->second);
        }
    }
    bool hasSymbolForIdent(uint32_t ident) const { return objects_.count(ident) || parameters_.count(ident); }

private:
    std::map<uint32_t, boost::shared_ptr<VelaObject>> objects_;
    std::map<uint32_t, boost::shared_ptr<Parameter<double>>> parameters_;
};

} // namespace VelaMediaLib
