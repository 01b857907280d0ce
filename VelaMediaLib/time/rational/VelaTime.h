#pragma once

namespace VelaMediaLib {

/// A time or duration counted in ticks of the project's edit rate.
typedef long long VelaTime;

} // namespace VelaMediaLib
