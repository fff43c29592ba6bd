#include <algorithm>
#include <variant>

#include "AssistantHost/CommandReader.h"
#include "Support/CommandText.h"
#include "Support/Finding.h"
#include "Support/Refusal.h"

// Commands: what is refused is refused well; what is read says all that stands in the text, and
// survives.

namespace nidus {
namespace {

bool isNothing(const JsonValue& value) {
  const auto* list = std::get_if<JsonValue::Array>(&value.content);
  return (list && list->empty()) || std::holds_alternative<std::nullptr_t>(value.content);
}

/// Says whether `said` has all that `given` has: each key that is not null, each element.
bool saysAll(const JsonValue& said, const JsonValue& given);

bool saysMember(const JsonValue::Object& said, const JsonValue::Member& given) {
  if (isNothing(given.second)) return true;
  return std::any_of(said.begin(), said.end(), [&given](const JsonValue::Member& member) {
    return member.first == given.first && saysAll(member.second, given.second);
  });
}

bool saysAll(const JsonValue& said, const JsonValue& given) {
  if (const auto* object = std::get_if<JsonValue::Object>(&given.content)) {
    const auto* other = std::get_if<JsonValue::Object>(&said.content);
    return other && std::all_of(object->begin(), object->end(),
                                [other](const auto& member) { return saysMember(*other, member); });
  }
  if (const auto* list = std::get_if<JsonValue::Array>(&given.content)) {
    const auto* other = std::get_if<JsonValue::Array>(&said.content);
    return other && std::equal(list->begin(), list->end(), other->begin(), other->end(),
                               [](const auto& a, const auto& b) { return saysAll(b, a); });
  }
  const auto* integer = std::get_if<std::int64_t>(&given.content);
  const auto* number = std::get_if<float>(&said.content);
  if (integer && number)
    return static_cast<float>(*integer) == *number;  // a float without fraction
  return said == given;
}

void tryCommand(std::string_view text) {
  const auto command = readCommand(text, "line 7");
  if (!command) return checkRefusal(command.failure(), "line 7");
  checkCommandSurvives(**command);
  const std::string read = commandText(**command);
  if (!saysAll(parseJson(read), parseJson(text))) {
    reportFinding("A command is not read whole, but as " + read);
  }
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  nidus::tryCommand(nidus::textOf(data, size));
  return 0;
}
