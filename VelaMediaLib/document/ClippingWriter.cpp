#include <VelaMediaLib/document/ClippingWriter.h>

#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/model/source/Source.h>

#include <sstream>

namespace VelaMediaLib {

std::string clippingToJSONString(const Project& project, const Mixer& clipping, bool compact) {
    std::ostringstream out;
    XMLOptions options(out, compact ? 0 : 2);
    {
        JSONWriter root(options, 0);
        const int members = root.memberLevel();
        writeJSONMember(options, members, "version", std::string(InternalProject::documentVersion()));
        const boost::rational<unsigned long> rate = project.editRate();
        options.key("editRate");
        writeJSONValue(options, members,
                       SafeRational((long long)rate.numerator(), (long long)rate.denominator()));
        options.key("sourceBin");
        {
            // Sources first: each takes its id, so every clip's "src" names it.
            JSONWriter array(options, members, JSONWriter::Array);
            for (const boost::shared_ptr<const Source>& source : clipping.allSources()) {
                options.element();
                source->toJSON(options, array.memberLevel());
            }
        }
        options.key("tracks");
        JSONWriter array(options, members, JSONWriter::Array);
        const Mixer::Tracks tracks = clipping.tracks();
        for (size_t index = 0; index < tracks.size(); ++index) {
            options.element();
            tracks[index]->toJSON(options, array.memberLevel(), int(index));
        }
    }
    if (!compact) out << "\n";
    return out.str();
}

} // namespace VelaMediaLib
