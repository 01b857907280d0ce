#include <VelaMediaLib/time/parameters/ParameterImpl.h>

namespace VelaMediaLib {

#define VELA_INSTANTIATE_PARAMETER(Type) template class ParameterImpl<Type>;
VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_INSTANTIATE_PARAMETER)
#undef VELA_INSTANTIATE_PARAMETER

} // namespace VelaMediaLib
