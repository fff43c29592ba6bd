#include "nidus/Answers/ReplyForm.h"

#include <utility>

#include "HomePlatform/System/OneLine.h"
#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

/// The content of `key` when it is of this type, else an empty one.
template <class Content>
Content contentAt(const NDDictionary& dictionary, std::string_view key) {
  const NDDictionaryValue* value = dictionary.find(key);
  const auto* content = value ? std::get_if<Content>(&value->content()) : nullptr;
  return content ? *content : Content();
}

ObjectResult resultForm(const NDDictionary& result) {
  const auto entity = contentAt<NDDictionary>(result, "entity");
  const std::string serviceType = textAt(entity, "serviceType");
  ObjectResult form;
  form.name = onOneLine(textAt(entity, "name"));
  form.room = onOneLine(textAt(entity, "room"));
  form.home = onOneLine(textAt(entity, "home"));
  form.type = onOneLine(serviceType.empty() ? textAt(entity, "entityType") : serviceType);
  form.outcome = onOneLine(textAt(result, "outcome"));
  form.value = contentAt<NDDictionary>(result, "resultValue");
  return form;
}

}  // namespace

bool ObjectResult::isSuccess() const { return outcome == VAHAActionOutcomeSUCCESSValue; }

std::string textAt(const NDDictionary& dictionary, std::string_view key) {
  return contentAt<NDString>(dictionary, key).str();
}

ReplyForm replyForm(const NDDictionary& reply) {
  ReplyForm form;
  form.outcome = onOneLine(textAt(reply, "commandOutcome"));
  for (const NDDictionaryValue& result : contentAt<NDDictionaryList>(reply, "actionResults")) {
    const auto* dictionary = std::get_if<NDDictionary>(&result.content());
    if (dictionary) form.results.push_back(resultForm(*dictionary));
  }
  return form;
}

}  // namespace nidus
