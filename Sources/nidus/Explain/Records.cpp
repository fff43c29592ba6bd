#include "nidus/Explain/Records.h"

#include <algorithm>
#include <unordered_set>

#include "HomePlatform/System/OneLine.h"
#include "nidus/Answers/ReplyForm.h"

namespace nidus {
namespace {

const NDDictionary& fieldsOf(const NDDictionaryValue& record) {
  return std::get<NDDictionary>(record.content());
}

/// Collects texts, each once.
class Collection {
 public:
  void add(const NDDictionaryValue& value) {
    if (const auto* text = std::get_if<NDString>(&value.content())) addText(text->str());
    if (const auto* list = std::get_if<NDDictionaryList>(&value.content())) {
      for (const NDDictionaryValue& each : *list) add(each);
    }
  }

  [[nodiscard]] DistinctTexts take() { return std::move(texts_); }

 private:
  void addText(std::string text) {
    if (known_.insert(text).second) texts_.push_back(std::move(text));
  }

  std::unordered_set<std::string> known_;
  DistinctTexts texts_;
};

}  // namespace

DistinctTexts textsUnder(std::string_view key, const NDDictionaryList& records) {
  Collection texts;
  for (const NDDictionaryValue& record : records) {
    if (const NDDictionaryValue* value = fieldsOf(record).find(key)) texts.add(*value);
  }
  return texts.take();
}

NDDictionaryList recordsOfType(std::string_view type, const NDDictionaryList& records) {
  NDDictionaryList those;
  std::copy_if(records.begin(), records.end(), std::back_inserter(those),
               [type](const NDDictionaryValue& record) {
                 return textAt(fieldsOf(record), "objectType") == type;
               });
  return those;
}

std::string namesOf(const NDDictionaryList& records) {
  std::vector<std::string> names;
  names.reserve(records.size());
  for (const NDDictionaryValue& record : records) {
    const std::string name = textAt(fieldsOf(record), "objectName");
    names.push_back(name.empty() ? "(no name)" : name);
  }
  return enumeration(names);
}

std::string enumeration(const std::vector<std::string>& texts) {
  constexpr std::size_t kUsualCount = 12;
  // The name of a single one takes no more room than that there is one more.
  const std::size_t count = texts.size() > kUsualCount + 1 ? kUsualCount : texts.size();
  std::string text;
  for (std::size_t i = 0; i < count; ++i) text += (i == 0 ? "" : ", ") + onOneLine(texts[i]);
  if (count == texts.size()) return text;
  return text + " and " + std::to_string(texts.size() - count) + " more";
}

}  // namespace nidus
