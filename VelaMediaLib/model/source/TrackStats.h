#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/model/source/MediaOrientation.h>
#include <VelaMediaLib/model/source/TrackType.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <boost/rational.hpp>
#include <string>
#include <vector>

namespace VelaMediaLib {

/// What is known about one stream of a media file, as a stats loader found it.
struct VELAMEDIALIB_API TrackStats {
    TrackType type = TrackType::Unknown;
    /// Range(start, duration) in ticks of rangeEditRate.
    Range<long long> range;
    /// Ticks per second of range.
    boost::rational<unsigned long> rangeEditRate = 1;
    /// Samples or frames per second.
    SafeRational sampleRate;
    /// The picture of a visual stream.
    Rect<int> rect;
    int bitDepth = 0;
    int numChannels = 0;
    double integratedLUFS = 0;
    double peakLevel = 0;
    MediaOrientation orientation = MediaOrientation::Normal;
    std::vector<std::string> metaData;
    /// The file the stream lies in; empty for the record's own file.
    std::string filename;
    /// The stream's number within its file.
    int fileTrackNumber = 0;

    bool operator==(const TrackStats& o) const {
        return type == o.type && range == o.range && rangeEditRate == o.rangeEditRate &&
               sampleRate == o.sampleRate && rect == o.rect && bitDepth == o.bitDepth &&
               numChannels == o.numChannels && integratedLUFS == o.integratedLUFS &&
               peakLevel == o.peakLevel && orientation == o.orientation && metaData == o.metaData &&
               filename == o.filename && fileTrackNumber == o.fileTrackNumber;
    }
    bool operator!=(const TrackStats& o) const { return !(*this == o); }
};

} // namespace VelaMediaLib
