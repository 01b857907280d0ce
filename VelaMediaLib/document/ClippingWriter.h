#pragma once

#include <VelaMediaLib/base/Export.h>

#include <string>

namespace VelaMediaLib {

class Mixer;
class Project;

/// The clipboard document of a clipping, as ClippingParser reads it: "version"
/// (the project document's), "editRate" (the project's: the clipping's ticks
/// count in it), "sourceBin" (the entries of the sources its clips play, each
/// once, so that a project lacking them can add them) and "tracks" (the
/// clipping's tracks in order, each numbered by its place, without track
/// flags: a paste puts the clips on tracks of its own choosing). Compact
/// writes no line breaks or indentation. Reads each value under the read lock.
VELAMEDIALIB_API std::string clippingToJSONString(const Project& project, const Mixer& clipping,
                                                  bool compact = true);

} // namespace VelaMediaLib
