#pragma once
// What every reader does with a parsed value: find members, check their
// types, take attributes, and turn the model's own refusals into one
// ParserException that says where the document was wrong.

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/document/JSONReader.h>

#include <json/value.h>

#include <exception>
#include <vector>
#include <new>
#include <string>

namespace VelaMediaLib {

class Attributable;
class SubTimeline;

/// The value, when it is an object; refused otherwise ("expected <what>").
const Json::Value& documentObject(const Json::Value& value, const char* what);
/// The value, when it is an array; refused otherwise.
const Json::Value& documentArray(const Json::Value& value, const char* what);
/// The member, or null when the object has none (a JSON null counts as none).
const Json::Value* optionalMember(const Json::Value& object, const char* key);
/// The member; throws "Invalid project json - missing member \"<key>\" in <what>".
const Json::Value& requiredMember(const Json::Value& object, const char* key, const char* what);

/// Each member of the object becomes an attribute: an attribute the object
/// already has keeps its type, a new one takes the JSON value's (boolean,
/// integer, real number, string). `skipped` names members read elsewhere.
void readAttributeMembers(const Json::Value& attributes, Attributable& target,
                          const std::vector<const char*>& skipped = {});
/// The one member, when the object has it, as readAttributeMembers takes it.
void readAttributeMember(const Json::Value& object, const char* key, Attributable& target);
/// A "parameters", "effects" and "metadata" member of the value, onto the object.
void readParametersEffectsAndMetaData(const Json::Value& value, SubTimeline& object);

inline std::string whereText(const std::string& where) { return where; }
template <typename Describe>
auto whereText(const Describe& describe) -> decltype(describe()) {
    return describe();
}

/// Runs the step, turning whatever but a ParserException (or a lack of
/// memory) it throws into ParserException "Invalid project json - " and the
/// text `describe` makes of the exception's.
template <typename Describe, typename Step>
auto refusingOtherFaults(const Describe& describe, const Step& step) -> decltype(step()) {
    try {
        return step();
    } catch (const ParserException&) {
        throw;
    } catch (const std::bad_alloc&) {
        throw;
    } catch (const std::exception& e) {
        refuseDocument(describe(e.what()));
    }
}

/// As refusingOtherFaults, the text being "<where>: <what>". `where` is the
/// text or a function giving it, called only on failure (loads run this per clip).
template <typename Where, typename Step>
auto readingWhere(const Where& where, const Step& step) -> decltype(step()) {
    return refusingOtherFaults([&](const char* what) { return whereText(where) + ": " + what; }, step);
}

/// Counts one level of composite nesting for as long as it lives; refuses
/// "Invalid project json - nesting too deep" past kMaxReadNesting.
class NestingGuard {
public:
    explicit NestingGuard(ReadContext& context);
    ~NestingGuard() { --context_.depth; }
    NestingGuard(const NestingGuard&) = delete;
    NestingGuard& operator=(const NestingGuard&) = delete;

private:
    ReadContext& context_;
};

} // namespace VelaMediaLib
