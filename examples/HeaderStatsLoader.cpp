#include "HeaderStatsLoader.h"

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <fstream>
#include <limits>
#include <vector>

using namespace VelaMediaLib;

namespace VelaExamples {
namespace {

typedef std::vector<unsigned char> Bytes;

const unsigned char kPngSignature[8] = {137, 'P', 'N', 'G', '\r', '\n', 26, '\n'};

// ---- reading ----

/// Up to `count` bytes from the current position: fewer at the end of the file.
Bytes readUpTo(std::istream& in, size_t count) {
    Bytes bytes(count);
    in.read(reinterpret_cast<char*>(bytes.data()), std::streamsize(count));
    bytes.resize(size_t(in.gcount()));
    return bytes;
}

uint32_t littleEndian(const unsigned char* p, int size) {
    uint32_t value = 0;
    for (int i = size - 1; i >= 0; --i) value = value << 8 | p[i];
    return value;
}

uint32_t bigEndian(const unsigned char* p) { return uint32_t(p[0]) << 24 | p[1] << 16 | p[2] << 8 | p[3]; }

bool startsWith(const Bytes& bytes, size_t at, const char* text) {
    const size_t length = std::strlen(text);
    return bytes.size() >= at + length && std::memcmp(bytes.data() + at, text, length) == 0;
}

uint32_t crc32(const unsigned char* data, size_t size, uint32_t crc = 0) {
    crc = ~crc;
    for (size_t i = 0; i < size; ++i) {
        crc ^= data[i];
        for (int bit = 0; bit < 8; ++bit) crc = crc & 1 ? 0xEDB88320u ^ (crc >> 1) : crc >> 1;
    }
    return ~crc;
}

struct WavFormat {
    uint32_t channels = 0, sampleRate = 0, blockAlign = 0, bitsPerSample = 0;
};

/// Walks the chunks after "RIFF....WAVE" to "fmt " and "data".
void readWav(std::istream& in, const std::string& path, MediaFileStats& stats) {
    const auto corrupt = [&](const std::string& what) { return IOException(what + " in WAV file: " + path); };
    WavFormat format;
    bool haveFormat = false, haveData = false;
    uint32_t dataSize = 0;
    while (!(haveFormat && haveData)) {
        const Bytes header = readUpTo(in, 8);
        if (header.size() < 8) throw corrupt(haveFormat ? "no data chunk" : "no fmt chunk");
        const uint32_t size = littleEndian(header.data() + 4, 4);
        if (startsWith(header, 0, "fmt ")) {
            const Bytes body = readUpTo(in, 16);
            if (size < 16 || body.size() < 16) throw corrupt("truncated fmt chunk");
            format.channels = littleEndian(body.data() + 2, 2);
            format.sampleRate = littleEndian(body.data() + 4, 4);
            format.blockAlign = littleEndian(body.data() + 12, 2);
            format.bitsPerSample = littleEndian(body.data() + 14, 2);
            in.seekg(std::streamoff(size - 16 + size % 2), std::ios::cur);
            haveFormat = true;
        } else {
            if (startsWith(header, 0, "data")) {
                dataSize = size;
                haveData = true;
            }
            in.seekg(std::streamoff(size) + size % 2, std::ios::cur);
        }
    }
    if (format.channels == 0 || format.sampleRate == 0 || format.blockAlign == 0)
        throw corrupt("bad fmt chunk");
    TrackStats audio;
    audio.type = TrackType::Audio;
    audio.range = Range<long long>(0, dataSize / format.blockAlign);
    audio.rangeEditRate = format.sampleRate;
    audio.sampleRate = SafeRational(format.sampleRate);
    audio.numChannels = int(format.channels);
    audio.bitDepth = int(format.bitsPerSample);
    stats.addTrackStats(audio);
}

/// Reads the IHDR chunk that follows the signature.
void readPng(std::istream& in, const std::string& path, MediaFileStats& stats) {
    const size_t chunkSize = 8 + 13 + 4; // length, type, IHDR data, CRC
    const Bytes chunk = readUpTo(in, chunkSize);
    if (chunk.size() < chunkSize) throw IOException("truncated header in PNG file: " + path);
    if (bigEndian(chunk.data()) != 13 || !startsWith(chunk, 4, "IHDR") ||
        crc32(chunk.data() + 4, 4 + 13) != bigEndian(chunk.data() + 21))
        throw IOException("corrupt IHDR chunk in PNG file: " + path);
    const uint32_t width = bigEndian(chunk.data() + 8), height = bigEndian(chunk.data() + 12);
    const uint32_t largest = uint32_t(std::numeric_limits<int>::max());
    if (width == 0 || height == 0 || width > largest || height > largest)
        throw IOException("corrupt image size in PNG file: " + path);
    TrackStats image;
    image.type = TrackType::Image;
    image.rect = Rect<int>(0, 0, int(width), int(height));
    image.range = Range<long long>(0, 1);
    image.rangeEditRate = 1;
    stats.addTrackStats(image);
    stats.setRect(image.rect);
}

// ---- writing ----

void put16(Bytes& out, uint32_t v) {
    out.push_back(v & 0xFF);
    out.push_back(v >> 8 & 0xFF);
}
void put32(Bytes& out, uint32_t v) {
    put16(out, v & 0xFFFF);
    put16(out, v >> 16);
}
void put32BigEndian(Bytes& out, uint32_t v) {
    for (int shift = 24; shift >= 0; shift -= 8) out.push_back(v >> shift & 0xFF);
}
void putText(Bytes& out, const char* text) { out.insert(out.end(), text, text + std::strlen(text)); }

void writeFile(const std::string& path, const Bytes& bytes) {
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(bytes.data()), std::streamsize(bytes.size()));
    if (!out) throw IOException("cannot write file: " + path);
}

void putPngChunk(Bytes& out, const char* type, const Bytes& data) {
    put32BigEndian(out, uint32_t(data.size()));
    const size_t start = out.size();
    putText(out, type);
    out.insert(out.end(), data.begin(), data.end());
    put32BigEndian(out, crc32(out.data() + start, out.size() - start));
}

/// A zlib stream of stored (uncompressed) blocks.
Bytes storedZlib(const Bytes& raw) {
    Bytes out = {0x78, 0x01};
    size_t at = 0;
    do {
        const size_t length = std::min<size_t>(raw.size() - at, 65535);
        out.push_back(at + length == raw.size() ? 1 : 0); // final block flag, type "stored"
        put16(out, uint32_t(length));
        put16(out, uint32_t(~length & 0xFFFF));
        out.insert(out.end(), raw.begin() + long(at), raw.begin() + long(at + length));
        at += length;
    } while (at < raw.size());
    uint32_t a = 1, b = 0;
    for (unsigned char byte : raw) {
        a = (a + byte) % 65521;
        b = (b + a) % 65521;
    }
    put32BigEndian(out, b << 16 | a);
    return out;
}

} // namespace

bool HeaderStatsLoader::loadStats(const std::string& path, MediaFileStats& stats) {
    std::ifstream in(path, std::ios::binary);
    if (!in) return false;
    const Bytes start = readUpTo(in, 12);
    if (startsWith(start, 0, "RIFF") && startsWith(start, 8, "WAVE")) {
        readWav(in, path, stats);
    } else if (start.size() >= 8 && std::memcmp(start.data(), kPngSignature, 8) == 0) {
        in.clear();
        in.seekg(8);
        readPng(in, path, stats);
    } else {
        return false;
    }
    stats.setFilename(path);
    return true;
}

void writeTestWav(const std::string& path, int sampleRate, int channels, double seconds) {
    const uint32_t samples = uint32_t(std::lround(seconds * sampleRate));
    const uint32_t blockAlign = uint32_t(channels) * 2, dataSize = samples * blockAlign;
    Bytes out;
    putText(out, "RIFF");
    put32(out, 36 + dataSize);
    putText(out, "WAVEfmt ");
    put32(out, 16);
    put16(out, 1); // PCM
    put16(out, uint32_t(channels));
    put32(out, uint32_t(sampleRate));
    put32(out, uint32_t(sampleRate) * blockAlign);
    put16(out, blockAlign);
    put16(out, 16);
    putText(out, "data");
    put32(out, dataSize);
    out.resize(out.size() + dataSize, 0);
    writeFile(path, out);
}

void writeTestPng(const std::string& path, int width, int height) {
    Bytes out(kPngSignature, kPngSignature + 8);
    Bytes header;
    put32BigEndian(header, uint32_t(width));
    put32BigEndian(header, uint32_t(height));
    header.insert(header.end(), {8, 0, 0, 0, 0}); // 8-bit greyscale, deflate, no filter, no interlace
    putPngChunk(out, "IHDR", header);
    Bytes rows;
    for (int y = 0; y < height; ++y) {
        rows.push_back(0); // no filter on this row
        for (int x = 0; x < width; ++x)
            rows.push_back((unsigned char)((x + y) * 255 / std::max(1, width + height - 2)));
    }
    putPngChunk(out, "IDAT", storedZlib(rows));
    putPngChunk(out, "IEND", Bytes());
    writeFile(path, out);
}

} // namespace VelaExamples
