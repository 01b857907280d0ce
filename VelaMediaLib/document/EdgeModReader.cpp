#include <VelaMediaLib/document/EdgeModReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/document/format/detail/JSONTreeAccess.h>
#include <VelaMediaLib/model/media/EdgeModification.h>
#include <VelaMediaLib/model/media/Media.h>

#include <boost/make_shared.hpp>

namespace VelaMediaLib {

EdgeModReader::EdgeModReader(const boost::shared_ptr<ReadContext>& context, Media& media)
    : JSONReader(context), media_(media) {}

boost::shared_ptr<EdgeModification> EdgeModReader::readEdgeMod(const Json::Value& value) {
    documentObject(value, "an edge modification object");
    const Json::Value& func =
        documentObject(requiredMember(value, "func", "an edge modification"), "a func object");
    const std::string name = jsonValueAsString(requiredMember(func, "name", "an edge modification func"));
    if (name != EdgeModification::fadeToValueFunctionName())
        throw ParserException("Unknown edge mod func " + name);
    const Json::Value* target = optionalMember(func, "value");
    const Json::Value* duration = optionalMember(value, "duration");
    const Json::Value* group = optionalMember(value, "group");
    const long long length = duration ? jsonValueAsVelaTime(*duration) : 0;
    if (length < 0) refuseDocument("edge modification of negative duration " + std::to_string(length));
    const auto modification =
        boost::make_shared<EdgeModification>(length, group ? jsonValueAsString(*group) : std::string(),
                                             target ? jsonValueAsDouble(*target) : 0.0, name);
    if (const Json::Value* parameters = optionalMember(value, "parameters"))
        modification->setParameters(
            jsonTreeFromValue(documentObject(*parameters, "an object of parameters")));
    return modification;
}

bool EdgeModReader::read(const Json::Value& modifications) {
    setValue(modifications);
    for (const Json::Value& entry : documentArray(modifications, "an array of edge modifications"))
        add(readEdgeMod(entry));
    return true;
}

void LeftEdgeModReader::add(const boost::shared_ptr<EdgeModification>& m) {
    media().addLeftEdgeModification(m);
}
void RightEdgeModReader::add(const boost::shared_ptr<EdgeModification>& m) {
    media().addRightEdgeModification(m);
}

} // namespace VelaMediaLib
