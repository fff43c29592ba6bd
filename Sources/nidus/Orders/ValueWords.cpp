#include "nidus/Orders/ValueWords.h"

#include <array>

#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "nidus/Orders/Temperature.h"
#include "nidus/Orders/WordChoice.h"

namespace nidus {
namespace {

struct BooleanWords {
  std::string_view attribute;  ///< Empty: every attribute.
  std::string_view yes;
  std::string_view no;
};

constexpr std::array<BooleanWords, 7> kBooleanWords = {{
    {"LOCKED", "locked", "unlocked"},
    {"OPEN", "open", "closed"},
    {"CONTACT", "closed", "open"},
    {"MUTE", "muted", "unmuted"},
    {"", "on", "off"},
    {"", "yes", "no"},
    {"", "true", "false"},
}};

bool isFor(const BooleanWords& words, std::string_view attribute) {
  return words.attribute.empty() || words.attribute == attribute;
}

std::string booleanExpectation(std::string_view attribute) {
  std::string expectation;
  for (const BooleanWords& words : kBooleanWords) {
    if (!isFor(words, attribute)) continue;
    if (!expectation.empty()) expectation += ", ";
    expectation.append(words.yes).append(" or ").append(words.no);
  }
  return expectation;
}

std::string textExpectation(const CharacteristicEntry& entry) {
  std::string list;
  for (const std::string_view text : textsOf(entry)) {
    list.append(list.empty() ? "one of " : ", ").append(text);
  }
  return list.empty() ? "any text" : list;
}

std::string numberExpectation(const CharacteristicEntry& entry) {
  if (isTemperature(entry)) return "a temperature, such as 21.5C, 70F or 21.5";
  const bool isFloat = entry.valueType == NDCharacteristicMetadataFormatFloat;
  const bool isPercentage = entry.unit == NDCharacteristicMetadataUnitsPercentage;
  return std::string(isFloat ? "a number" : "a whole number") + ", such as 40" +
         (isPercentage ? " or 40%" : "") + (isFloat ? " or 40.5" : "");
}

}  // namespace

std::optional<bool> booleanOf(std::string_view word, std::string_view attribute) {
  for (const BooleanWords& words : kBooleanWords) {
    if (!isFor(words, attribute)) continue;
    if (vocabularyWord(word) == vocabularyWord(words.yes)) return true;
    if (vocabularyWord(word) == vocabularyWord(words.no)) return false;
  }
  return std::nullopt;
}

std::vector<std::string_view> textsOf(const CharacteristicEntry& entry) {
  std::vector<std::string_view> texts;
  for (const ValuePair& pair : entry.values) {
    if (pair.assistant->isText()) texts.push_back(pair.assistant->stringValue().view());
  }
  return texts;
}

std::string expectationOf(const CharacteristicEntry& entry) {
  if (entry.valueType == NDCharacteristicMetadataFormatBool) {
    return booleanExpectation(entry.assistantName.view());
  }
  if (entry.valueType == NDCharacteristicMetadataFormatString) return textExpectation(entry);
  return numberExpectation(entry);
}

}  // namespace nidus
