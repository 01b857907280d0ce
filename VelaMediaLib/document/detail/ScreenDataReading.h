#pragma once
// A screen recording's "screenData": "rect" [x, y, w, h], "cursor" [[time, x,
// y], ...], "clicks" [[time, button], ...] (or [time,
// x, y, button]) and "keystrokes" [[time, key,
// modifiers], ...], times exact (integers or "n/d").

#include <json/value.h>

namespace VelaMediaLib {

class ScreenDataHolder;

/// Reads the media's "screenData", if any, into the holder.
void readScreenData(const Json::Value& media, ScreenDataHolder& holder);

} // namespace VelaMediaLib
