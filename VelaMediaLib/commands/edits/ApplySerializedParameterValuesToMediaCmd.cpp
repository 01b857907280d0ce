#include <VelaMediaLib/commands/edits/ApplySerializedParameterValuesToMediaCmd.h>

#include <json/reader.h>
#include <json/value.h>

#include <algorithm>
#include <memory>
#include <utility>

namespace VelaMediaLib {
namespace {

Json::Value parseObject(const std::string& text) {
    Json::CharReaderBuilder builder;
    builder["allowComments"] = false;
    builder["rejectDupKeys"] = true;
    const std::unique_ptr<Json::CharReader> reader(builder.newCharReader());
    Json::Value value;
    std::string errors;
    if (!reader->parse(text.data(), text.data() + text.size(), &value, &errors) || !value.isObject())
        throw ParserException("serialized parameter values are not a JSON object");
    return value;
}

} // namespace

boost::shared_ptr<ApplySerializedParameterValuesToMediaCmd>
ApplySerializedParameterValuesToMediaCmd::create(const MediaPtr& media, const std::string& serialized) {
    if (!media) throw VelaMediaLibException("no clip to apply parameter values to");
    const Json::Value values = parseObject(serialized);
    const std::vector<std::string> names = media->parameterNames();
    for (const std::string& name : values.getMemberNames())
        if (!std::binary_search(names.begin(), names.end(), name))
            throw VelaMediaLibException("the clip has no parameter \"" + name + "\"");
    boost::shared_ptr<ApplySerializedParameterValuesToMediaCmd> command(
        new ApplySerializedParameterValuesToMediaCmd(media, serialized));
    command->setName("Apply Parameter Values");
    return command;
}

// Every value is read into a copy before any parameter takes one, so a value
// that does not read leaves every curve as it was.
bool ApplySerializedParameterValuesToMediaCmd::edit() {
    const Json::Value values = parseObject(serialized_);
    std::vector<std::pair<ParameterPtr, ParameterPtr>> read;
    for (const std::string& name : values.getMemberNames()) {
        const ParameterPtr parameter = track(media_, name);
        read.emplace_back(parameter, parameter->readCopyFromJSON(values[name]));
    }
    for (const auto& entry : read) {
        if (!entry.first->takeStateOf(*entry.second)) return false;
        entry.first->notify();
    }
    return true;
}

} // namespace VelaMediaLib
