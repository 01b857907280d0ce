#include <VelaMediaLib/time/parameters/DiffParameter.h>
#include <VelaMediaLib/time/parameters/detail/DiffParameterDocument.h>

namespace VelaMediaLib {

#define VELA_INSTANTIATE_DIFF_PARAMETER(Type) template class VELAMEDIALIB_INSTANTIATION DiffParameter<Type>;
VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_INSTANTIATE_DIFF_PARAMETER)
#undef VELA_INSTANTIATE_DIFF_PARAMETER

} // namespace VelaMediaLib
