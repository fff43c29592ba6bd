#include "nidus/Answers/ValueText.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>

#include "HomePlatform/System/OneLine.h"
#include "PlatformModel/System/NDNumberText.h"
#include "nidus/Answers/ReplyForm.h"

namespace nidus {
namespace {

struct UnitSign {
  std::string_view unit;
  std::string_view sign;
};

constexpr std::array kUnitSigns = {
    UnitSign{"percentage", " %"}, UnitSign{"celsius", " °C"}, UnitSign{"fahrenheit", " °F"},
    UnitSign{"arcdegrees", "°"},  UnitSign{"lux", " lx"},
};

/// The attributes that are switched on and off; of the others a boolean says whether it is so.
constexpr std::array<std::string_view, 5> kSwitches = {"POWER", "ACTIVE", "SWING", "MUTE",
                                                       "ENABLED"};

std::string lowerCase(std::string_view text) {
  std::string lower(text);
  std::transform(lower.begin(), lower.end(), lower.begin(), [](char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
  });
  return lower;
}

/// Words of the vocabulary are shown as people write them.
std::string wordText(const std::string& word, const CharacteristicEntry* entry) {
  const auto isWord = [&word](const ValuePair& pair) {
    return pair.assistant->isText() && pair.assistant->description() == word;
  };
  const bool isKnown = entry && std::any_of(entry->values.begin(), entry->values.end(), isWord);
  return onOneLine(isKnown ? lowerCase(word) : word);
}

/// Makes the text of each kind of value.
struct ContentText {
  std::string_view attribute;
  const CharacteristicEntry* entry;
  std::string suffix;

  std::string operator()(bool value) const { return booleanText(value, attribute); }
  std::string operator()(std::int64_t value) const { return numberText(value) + suffix; }
  std::string operator()(float value) const { return shortNumberText(value) + suffix; }
  std::string operator()(const NDString& value) const { return wordText(value.str(), entry); }
  template <class Other>
  std::string operator()(const Other&) const {
    return "unknown";
  }
};

std::string contentText(const NDDictionary& value, ContentText text) {
  if (const std::string units = textAt(value, "units"); !units.empty()) {
    text.suffix = unitSuffix(units);
  }
  for (const auto& [key, content] : value) {
    if (key != "units") return std::visit(text, content.content());
  }
  return {};
}

}  // namespace

std::string unitSuffix(std::string_view unit) {
  if (unit.empty()) return {};
  const std::string name = lowerCase(unit);
  const auto* const sign = std::find_if(kUnitSigns.begin(), kUnitSigns.end(),
                                        [&name](const UnitSign& s) { return s.unit == name; });
  return sign == kUnitSigns.end() ? ' ' + onOneLine(name) : std::string(sign->sign);
}

std::string booleanText(bool value, std::string_view attribute) {
  const bool isSwitch = std::find(kSwitches.begin(), kSwitches.end(), attribute) != kSwitches.end();
  if (isSwitch) return value ? "on" : "off";
  return value ? "yes" : "no";
}

std::string shortNumberText(float number) {
  constexpr float kLeast = 0.01F;
  constexpr float kGreatest = 1e7F;
  constexpr int kDigits = 2;
  const float size = std::fabs(number);
  if (!(size >= kLeast && size < kGreatest)) return numberText(number);
  std::array<char, 16> digits{};
  const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number,
                                 std::chars_format::fixed, kDigits);
  std::string text(digits.data(), end.ptr);
  text.erase(text.find_last_not_of('0') + 1);
  if (text.back() == '.') text.pop_back();
  return text;
}

const CharacteristicEntry* entryOfAttribute(const Vocabulary& vocabulary,
                                            std::string_view attribute) {
  const auto& entries = vocabulary.characteristics;
  const auto entry = std::find_if(
      entries.begin(), entries.end(),
      [attribute](const CharacteristicEntry& e) { return e.assistantName == attribute; });
  return entry == entries.end() ? nullptr : &*entry;
}

std::string valueText(const NDDictionary& value, std::string_view attribute,
                      const Vocabulary& vocabulary) {
  const CharacteristicEntry* const entry = entryOfAttribute(vocabulary, attribute);
  const bool hasUnit = entry && !entry->localized;
  return contentText(value, {attribute, entry, hasUnit ? unitSuffix(entry->unit.view()) : ""});
}

std::string limitText(const NDDictionary& limit, std::string_view attribute,
                      const Vocabulary& vocabulary) {
  const CharacteristicEntry* const entry = entryOfAttribute(vocabulary, attribute);
  return contentText(limit, {attribute, entry, entry ? unitSuffix(entry->unit.view()) : ""});
}

}  // namespace nidus
