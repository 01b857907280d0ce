// The example loader reads back what the example writers wrote, passes over
// other files and refuses a broken header of its own kinds.
#include <HeaderStatsLoader.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>

#include <boost/make_shared.hpp>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <random>

using namespace VelaMediaLib;
using namespace VelaExamples;

namespace {

class HeaderStatsLoaderTest : public ::testing::Test {
protected:
    void SetUp() override { std::filesystem::create_directories(dir); }
    void TearDown() override { std::filesystem::remove_all(dir); }
    std::string path(const std::string& name) const { return (dir / name).string(); }
    /// Keeps the first `size` bytes of the file.
    void truncate(const std::string& file, size_t size) const { std::filesystem::resize_file(file, size); }
    bool load(const std::string& file) { return loader.loadStats(file, *stats); }

    const std::filesystem::path dir =
        std::filesystem::temp_directory_path() / ("vela-headers-" + std::to_string(std::random_device()()));
    HeaderStatsLoader loader;
    const boost::shared_ptr<MediaFileStats> stats = MediaFileStats::create();
};

} // namespace

TEST_F(HeaderStatsLoaderTest, AWavFileIsOneAudioStreamCountedInSamples) {
    const std::string wav = path("tone.wav");
    writeTestWav(wav, 48000, 2, 0.5);
    ASSERT_TRUE(load(wav));
    ASSERT_EQ(stats->numTracks(), 1);
    EXPECT_EQ(stats->trackType(0), TrackType::Audio);
    EXPECT_EQ(stats->trackRange(0), Range<long long>(0, 24000));
    EXPECT_EQ(stats->rangeEditRate(0), boost::rational<unsigned long>(48000));
    EXPECT_EQ(stats->sampleRate(0), SafeRational(48000));
    EXPECT_EQ(stats->numChannels(0), 2);
    EXPECT_EQ(stats->bitDepth(0), 16);
    EXPECT_EQ(stats->filename(), wav);
    EXPECT_EQ(stats->mediaRangeInSeconds(), Range<double>(0, 0.5));
}

TEST_F(HeaderStatsLoaderTest, APngFileIsOneImageOfItsSize) {
    const std::string png = path("still.png");
    writeTestPng(png, 320, 200);
    ASSERT_TRUE(load(png));
    ASSERT_EQ(stats->numTracks(), 1);
    EXPECT_EQ(stats->trackType(0), TrackType::Image);
    EXPECT_EQ(stats->trackRect(0), Rect<int>(0, 0, 320, 200));
    EXPECT_EQ(stats->rect(), Rect<int>(0, 0, 320, 200));
    EXPECT_EQ(stats->trackRange(0), Range<long long>(0, 1));
}

TEST_F(HeaderStatsLoaderTest, OtherFilesArePassedOverAndBrokenHeadersRefused) {
    const std::string text = path("notes.txt"), wav = path("cut.wav"), png = path("cut.png");
    std::ofstream(text) << "RIFF is not enough";
    EXPECT_FALSE(load(text));
    EXPECT_FALSE(load(path("missing.wav")));

    writeTestWav(wav, 44100, 1, 1);
    truncate(wav, 30); // inside the fmt chunk
    EXPECT_THROW(load(wav), IOException);
    writeTestPng(png, 4, 4);
    truncate(png, 20);
    EXPECT_THROW(load(png), IOException);
    writeTestPng(png, 4, 4);
    std::fstream(png, std::ios::in | std::ios::out | std::ios::binary)
        .seekp(17)
        .put('\x7f'); // width, not CRC
    EXPECT_THROW(load(png), IOException);
}

TEST_F(HeaderStatsLoaderTest, ImportsThroughTheLoaderList) {
    const auto registered = boost::make_shared<HeaderStatsLoader>();
    MediaFileStats::addStatsLoader(registered);
    const std::string png = path("list.png");
    writeTestPng(png, 8, 6);
    EXPECT_EQ(MediaFileStats::create(png)->rect(), Rect<int>(0, 0, 8, 6));
    EXPECT_FALSE(MediaFileStats::isFileOpenable(path("none.png")));
    MediaFileStats::removeStatsLoader(registered);
}
