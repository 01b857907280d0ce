#pragma once
// An example of the stats loaders a host supplies: it knows WAV and PNG files
// by their headers, which is all an editor needs to place them on a timeline.

#include <VelaMediaLib/model/source/StatsLoader.h>

#include <string>

namespace VelaExamples {

/// Reads the header of a WAV file (one audio stream: channels, sample rate,
/// bits per sample, and the sample count of its data) or of a PNG file (one
/// image stream of its width and height). Answers false for other files and
/// throws IOException for a file that has the signature but a truncated or
/// corrupt header.
class HeaderStatsLoader : public VelaMediaLib::StatsLoader {
public:
    bool loadStats(const std::string& path, VelaMediaLib::MediaFileStats& stats) override;
};

/// Writes a silent 16-bit PCM WAV file. Throws IOException when it cannot.
void writeTestWav(const std::string& path, int sampleRate, int channels, double seconds);
/// Writes a valid grey PNG file. Throws IOException when it cannot.
void writeTestPng(const std::string& path, int width, int height);

} // namespace VelaExamples
