#include <VelaMediaLib/document/AMFileReader.h>
#include <VelaMediaLib/document/CalloutReader.h>
#include <VelaMediaLib/document/GroupReader.h>
#include <VelaMediaLib/document/IMFileReader.h>
#include <VelaMediaLib/document/JSONReader.h>
#include <VelaMediaLib/document/StitchedMediaReader.h>
#include <VelaMediaLib/document/VMFileReader.h>
#include <VelaMediaLib/document/detail/EffectReading.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>

#include <cstring>

namespace VelaMediaLib {

void ReadContext::takeId(long long id) {
    if (!ids.insert(id).second) refuseDocument("duplicate id: " + std::to_string(id));
}

void refuseDocument(const std::string& what) { throw ParserException("Invalid project json - " + what); }

JSONReader::JSONReader(const boost::shared_ptr<ReadContext>& context) : context_(context) {}

JSONReader::~JSONReader() = default;

void JSONReader::readMetaData(const Json::Value& value, MetaDatable& object) {
    const Json::Value* metadata = optionalMember(documentObject(value, "an object"), "metadata");
    if (!metadata) return;
    documentObject(*metadata, "a metadata object");
    for (auto it = metadata->begin(); it != metadata->end(); ++it)
        object.addMetaData(it.name(), it->isString() ? it->asString() : compactJSON(*it));
}

void JSONReader::readSourceEffect(const Json::Value& value, Media& media) {
    const Json::Value* effect = optionalMember(value, "sourceEffect");
    if (!effect) return;
    auto* clip = dynamic_cast<MediaImpl*>(&media);
    const auto stored = boost::dynamic_pointer_cast<StoredEffect>(readEffect(*effect));
    if (!clip || !stored) refuseDocument("a sourceEffect this clip cannot keep");
    clip->setSourceEffect(stored);
}

namespace {

template <typename Reader>
std::unique_ptr<MediaReader> make(const boost::shared_ptr<ReadContext>& context) {
    return std::unique_ptr<MediaReader>(new Reader(context));
}

typedef std::unique_ptr<MediaReader> (*ReaderMaker)(const boost::shared_ptr<ReadContext>&);

const struct {
    const char* type;
    ReaderMaker make;
} kKinds[] = {
    {"AMFile", make<AMFileReader>},
    {"Callout", make<CalloutReader>},
    {"Caption", make<CaptionReader>},
    {"Group", make<GroupReader>},
    {"IMFile", make<IMFileReader>},
    {"ScreenIMFile", make<ScreenIMFileReader>},
    {"ScreenVMFile", make<ScreenVMFileReader>},
    {"StitchedMedia", make<StitchedMediaReader>},
    {"UnifiedMedia", make<UnifiedMediaReader>},
    {"VMFile", make<VMFileReader>},
    {"PlaceholderMedia", make<PlaceholderReader>},
};

} // namespace

std::unique_ptr<MediaReader>
JSONReader::mediaReaderForJsonValue(const Json::Value& value, const boost::shared_ptr<ReadContext>& context) {
    const Json::Value* type = optionalMember(documentObject(value, "a media object"), "_type");
    if (!type || !type->isString()) return nullptr;
    const std::string name = type->asString();
    for (const auto& kind : kKinds)
        if (name == kind.type) return kind.make(context);
    return nullptr;
}

} // namespace VelaMediaLib
