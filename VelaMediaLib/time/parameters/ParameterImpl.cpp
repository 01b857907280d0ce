#include <VelaMediaLib/time/parameters/ParameterImpl.h>
#include <VelaMediaLib/time/parameters/detail/ParameterImplDocument.h>

namespace VelaMediaLib {

#define VELA_INSTANTIATE_PARAMETER(Type) template class VELAMEDIALIB_INSTANTIATION ParameterImpl<Type>;
VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_INSTANTIATE_PARAMETER)
#undef VELA_INSTANTIATE_PARAMETER

} // namespace VelaMediaLib
