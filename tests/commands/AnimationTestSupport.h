#pragma once
// The project document as the strongest check of an animation or keyframe
// edit: undo gives back the text before, redo the text after, and a refused
// edit leaves it and the history as they were.

#include "EditTestSupport.h"

namespace VelaMediaLib {
namespace testing {

// The edit tests' fixture, named for the animation and keyframe suites.
typedef EditTest DocumentEditTest;

} // namespace testing
} // namespace VelaMediaLib
