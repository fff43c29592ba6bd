#include "PlugIn/Reply.h"

namespace nidus {
namespace {

template <class Content>
const Content& contentAt(const NDDictionary& form, std::string_view key) {
  static const Content kNone;
  const NDDictionaryValue* value = form.find(key);
  const auto* content = value ? std::get_if<Content>(&value->content()) : nullptr;
  return content ? *content : kNone;
}

}  // namespace

NDString textAt(const NDDictionary& form, std::string_view key) {
  return contentAt<NDString>(form, key);
}

const NDDictionaryList& listAt(const NDDictionary& form, std::string_view key) {
  return contentAt<NDDictionaryList>(form, key);
}

const NDDictionary& formAt(const NDDictionary& form, std::string_view key) {
  return contentAt<NDDictionary>(form, key);
}

const NDDictionary& formOf(const NDDictionaryValue& value) {
  return std::get<NDDictionary>(value.content());
}

OutcomeCounts outcomesOf(const NDDictionary& reply) {
  OutcomeCounts counts;
  for (const NDDictionaryValue& result : listAt(reply, "actionResults")) {
    ++counts[textAt(formOf(result), "outcome").str()];
  }
  return counts;
}

std::string description(const OutcomeCounts& counts) {
  std::string text;
  for (const auto& [outcome, count] : counts) {
    text += (text.empty() ? "" : ", ") + std::to_string(count) + ' ' + outcome;
  }
  return text.empty() ? "none" : text;
}

}  // namespace nidus
