#include "ProjectSummary.h"

#include <VelaMediaLib/document/format/JSONWriter.h>

#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <iomanip>
#include <ostream>

using namespace VelaMediaLib;

namespace VelaTool {

namespace {

const char* statusName(OfflineStatus status) {
    switch (status) {
    case OfflineStatus::Online:
        return "online";
    case OfflineStatus::FileMissing:
        return "file missing";
    case OfflineStatus::FileUnreadable:
        return "file unreadable";
    case OfflineStatus::StatsUnavailable:
        return "stats unavailable";
    case OfflineStatus::Reconnectable:
        return "reconnectable";
    }
    return "unknown";
}

int attributeValue(const boost::shared_ptr<Attribute<int>>& attribute) {
    return attribute ? attribute->value() : 0;
}

} // namespace

ProjectSummary::ProjectSummary(const Project& project) {
    const boost::rational<unsigned long> rate = project.editRate();
    rateNumerator_ = rate.numerator();
    rateDenominator_ = rate.denominator();
    const TimelinePtr timeline = project.timeline();
    width_ = attributeValue(timeline->attributeWidth());
    height_ = attributeValue(timeline->attributeHeight());
    duration_ = timeline->duration();
    tracks_ = timeline->numTracks();
    countClips(project);
    listSources(project);
}

void ProjectSummary::countClips(const Project& project) {
    for (const MixerPtr& mixer : project.timeline()->mixers())
        for (const TrackPtr& track : mixer->tracks())
            for (const MediaPtr& media : track->medias())
                Track::visitWithin(media, [this](const MediaPtr& clip, bool&) {
                    ++clipsByKind_[MediaTypeFromMediaDispatcher::typeOf(*clip)];
                });
}

void ProjectSummary::listSources(const Project& project) {
    for (const SourcePtr& source : project.sourceBin()->sources()) {
        const OfflineStatus status = source->offlineStatus();
        sources_.push_back({source->filename(), status == OfflineStatus::Online, statusName(status)});
    }
}

size_t ProjectSummary::clipCount() const {
    size_t count = 0;
    for (const auto& kind : clipsByKind_) count += kind.second;
    return count;
}

void ProjectSummary::printText(std::ostream& out) const {
    const double seconds = double(duration_) * double(rateDenominator_) / double(rateNumerator_);
    out << "edit rate  " << rateNumerator_ << "/" << rateDenominator_ << " ticks per second\n";
    out << "canvas     " << width_ << " x " << height_ << "\n";
    out << "duration   " << duration_ << " ticks (" << std::fixed << std::setprecision(3) << seconds
        << " s)\n"
        << std::defaultfloat;
    out << "tracks     " << tracks_ << "\n";
    out << "clips      " << clipCount() << "\n";
    for (const auto& kind : clipsByKind_)
        out << "  " << std::left << std::setw(18) << kind.first << std::right << kind.second << "\n";
    out << "sources    " << sources_.size() << "\n";
    for (const SourceLine& source : sources_) out << "  " << source.path << "  (" << source.status << ")\n";
}

void ProjectSummary::printJSON(std::ostream& out) const {
    out << "{\"editRate\":\"" << rateNumerator_ << "/" << rateDenominator_ << "\",\"width\":" << width_
        << ",\"height\":" << height_ << ",\"duration\":" << duration_ << ",\"tracks\":" << tracks_
        << ",\"clips\":{";
    const char* separator = "";
    for (const auto& kind : clipsByKind_) {
        out << separator << VelaMediaLib::quotedJSONString(kind.first) << ":" << kind.second;
        separator = ",";
    }
    out << "},\"sources\":[";
    separator = "";
    for (const SourceLine& source : sources_) {
        out << separator << "{\"src\":" << VelaMediaLib::quotedJSONString(source.path)
            << ",\"online\":" << (source.online ? "true" : "false")
            << ",\"status\":" << VelaMediaLib::quotedJSONString(source.status) << "}";
        separator = ",";
    }
    out << "]}\n";
}

} // namespace VelaTool
