#include "DocumentGenerator.h"

#include <initializer_list>
#include <string>
#include <vector>

namespace VelaBench {

/// The library's text layout: "{" and "[" followed by a line break, members
/// separated by ",\n", keys as "\"key\" : ", the closing bracket on a line of
/// its own at the opening level; compact drops every blank and line break.
class DocumentGenerator::Writer {
public:
    explicit Writer(bool compact) : compact_(compact) { text_.reserve(64 << 20); }

    void open(char bracket) {
        text_ += bracket;
        if (!compact_) text_ += '\n';
        open_.push_back(true);
    }
    void close(char bracket) {
        const bool empty = open_.back();
        open_.pop_back();
        if (!empty && !compact_) text_ += '\n';
        indent(open_.size());
        text_ += bracket;
    }
    void key(const char* name) {
        next();
        text_ += '"';
        text_ += name;
        text_ += compact_ ? "\":" : "\" : ";
    }
    void element() { next(); }
    Writer& raw(const std::string& value) {
        text_ += value;
        return *this;
    }
    Writer& number(long long value) { return raw(std::to_string(value)); }
    Writer& string(const std::string& value) { return raw("\"" + value + "\""); }
    /// A short array of integers on one line, as the library writes rectangles and ranges.
    void numbers(const char* name, std::initializer_list<long long> values) {
        key(name);
        text_ += '[';
        for (const long long* v = values.begin(); v != values.end(); ++v)
            text_ += (v == values.begin() ? "" : compact_ ? "," : ", ") + std::to_string(*v);
        text_ += ']';
    }
    void member(const char* name, long long value) {
        key(name);
        number(value);
    }
    void member(const char* name, const std::string& value) {
        key(name);
        string(value);
    }
    void emptyObject(const char* name) {
        key(name);
        open('{');
        close('}');
    }
    std::string take() { return std::move(text_); }

private:
    void next() {
        if (!open_.back()) text_ += compact_ ? "," : ",\n";
        open_.back() = false;
        indent(open_.size());
    }
    void indent(size_t level) {
        if (!compact_) text_.append(2 * level, ' ');
    }

    bool compact_;
    std::string text_;
    std::vector<bool> open_; // whether each open container is still empty
};

std::string DocumentGenerator::text() const {
    Writer out(shape_.compact);
    out.open('{');
    out.member("width", 1920);
    out.member("height", 1080);
    out.member("version", "1.0");
    out.member("editRate", 30);
    writeSources(out);
    writeTimeline(out);
    out.close('}');
    return out.take();
}

void DocumentGenerator::writeSources(Writer& out) const {
    out.key("sourceBin");
    out.open('[');
    for (int track = 0; track < shape_.tracks; ++track) {
        out.element();
        out.open('{');
        out.member("id", track + 1);
        out.member("src", "/media/take" + std::to_string(track) + ".mov");
        out.numbers("rect", {0, 0, 1920, 1080});
        out.member("lastMod", 0);
        out.key("sourceTracks");
        out.open('[');
        out.element();
        out.open('{');
        out.member("type", "video");
        out.numbers("range", {0, 108000000}); // 1000 hours
        out.member("editRate", 30);
        out.numbers("trackRect", {0, 0, 1920, 1080});
        out.close('}');
        out.close(']');
        out.close('}');
    }
    out.close(']');
}

void DocumentGenerator::writeTimeline(Writer& out) const {
    out.key("timeline");
    out.open('{');
    out.member("id", shape_.tracks + 1);
    out.key("sceneTrack");
    out.open('{');
    out.key("scenes");
    out.open('[');
    out.element();
    out.open('{');
    out.key("velaml");
    out.open('{');
    out.key("tracks");
    out.open('[');
    for (int track = 0; track < shape_.tracks; ++track) writeTrack(out, track);
    out.close(']');
    out.close('}');
    out.close('}');
    out.close(']');
    out.close('}');
    out.close('}');
}

void DocumentGenerator::writeTrack(Writer& out, int track) const {
    out.element();
    out.open('{');
    out.member("trackIndex", track);
    out.key("medias");
    out.open('[');
    for (int clip = 0; clip < shape_.clipsPerTrack; ++clip) writeClip(out, track, clip);
    out.close(']');
    out.key("transitions");
    out.open('[');
    out.close(']');
    out.close('}');
}

void DocumentGenerator::writeClip(Writer& out, int track, int clip) const {
    out.element();
    out.open('{');
    out.member("id", shape_.tracks + 2 + (long long)track * shape_.clipsPerTrack + clip);
    out.member("_type", "VMFile");
    out.member("src", track + 1);
    out.member("trackNumber", 0);
    out.key("attributes");
    out.open('{');
    out.member("ident", "clip " + std::to_string(track) + "." + std::to_string(clip));
    out.close('}');
    out.member("start", (long long)clip * 100);
    out.member("duration", 90);
    out.member("mediaStart", (long long)(clip * 37 % 1000) * 30);
    out.member("mediaDuration", 90);
    out.member("scalar", 1);
    out.key("parameters");
    out.open('{');
    if (clip % shape_.keyframedEvery == 0) writeOpacity(out);
    out.close('}');
    out.close('}');
}

/// Fades in over 15 ticks, dips at the middle, fades out: four keyframes.
void DocumentGenerator::writeOpacity(Writer& out) const {
    out.key("opacity");
    out.open('{');
    out.member("type", "double");
    out.key("keyframes");
    out.open('[');
    const long long times[] = {0, 15, 45, 90};
    const char* values[] = {"0.0", "1.0", "0.5", "0.0"};
    for (int k = 0; k < 4; ++k) {
        out.element();
        out.open('{');
        out.member("time", times[k]);
        out.member("endTime", times[k]);
        out.key("value");
        out.raw(values[k]);
        out.member("duration", k == 2 ? 5 : 0);
        out.member("interp", k == 0 ? "linr" : "eios");
        out.close('}');
    }
    out.close(']');
    out.close('}');
}

} // namespace VelaBench
