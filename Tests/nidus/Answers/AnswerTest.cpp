#include "nidus/Answers/AnswerTest.h"

namespace nidus {
namespace {

NDDictionary valueForm(const char* kind, NDDictionaryValue content, const char* units) {
  NDDictionary value;
  value.set(kind, std::move(content));
  value.setIfPresent("units", units);
  return value;
}

void setText(NDDictionary& dictionary, const char* key, const std::string& text) {
  if (!text.empty()) dictionary.set(key, NDDictionaryValue(NDString(text)));
}

NDDictionary resultOf(const ResultSpec& spec) {
  NDDictionary entity;
  setText(entity, "name", spec.name);
  const bool isScene = spec.type == VAHAEntityTypeSCENEValue;
  setText(entity, "entityType", isScene ? spec.type : std::string(VAHAEntityTypeSERVICEValue));
  if (!isScene) setText(entity, "serviceType", spec.type);
  setText(entity, "room", spec.room);
  setText(entity, "home", spec.home);
  NDDictionary result;
  setText(result, "outcome", spec.outcome);
  if (!spec.value.empty()) result.set("resultValue", NDDictionaryValue(spec.value));
  result.set("entity", NDDictionaryValue(entity));
  return result;
}

CommandRef commandOf(VAHAValueRef value) {
  const auto action = std::make_shared<VAHAAction>();
  action->setValue(std::move(value));
  const auto command = std::make_shared<VAHACommand>();
  command->setActions({action});
  return command;
}

}  // namespace

NDDictionary booleanForm(bool value) {
  return valueForm("boolean", NDDictionaryValue(value), nullptr);
}
NDDictionary integerForm(std::int64_t value, const char* units) {
  return valueForm("integer", NDDictionaryValue(value), units);
}
NDDictionary floatForm(float value, const char* units) {
  return valueForm("float", NDDictionaryValue(value), units);
}

NDDictionary replyOf(const std::vector<ResultSpec>& results) {
  NDDictionary reply =
      emptyReply(results.empty() ? VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue
                                 : VAHACommandOutcomeCOMMAND_SUCCESSValue);
  NDDictionaryList list;
  for (const ResultSpec& result : results) list.emplace_back(resultOf(result));
  reply.set("actionResults", NDDictionaryValue(std::move(list)));
  return reply;
}

NDDictionary emptyReply(std::string_view outcome) {
  NDDictionary reply;
  reply.set("commandOutcome", NDDictionaryValue(NDString(outcome)));
  reply.set("actionResults", NDDictionaryValue(NDDictionaryList()));
  return reply;
}

Order orderOf(Order::Kind kind, const std::string& attribute, VAHAValueRef value) {
  const std::size_t count = kind == Order::Kind::limits ? 3 : 1;
  return {kind, attribute, std::vector<CommandRef>(count, commandOf(std::move(value)))};
}

std::string AnswerTest::sentence(const Order& order, const NDDictionary& reply) const {
  std::string text = answer(order, {{reply}});
  text.pop_back();
  return text.substr(text.rfind('\n') + 1);
}

}  // namespace nidus
