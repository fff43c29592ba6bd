#include "nidus/VocabularyText.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <iterator>
#include <vector>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDTextMatching.h"
#include "nidus/Terminal/TextTable.h"

namespace nidus {
namespace {

using Words = std::vector<std::string>;

constexpr std::array kEntityTypes = {VAHAEntityTypeHOMEValue,   VAHAEntityTypeROOMValue,
                                     VAHAEntityTypeZONEValue,   VAHAEntityTypeSERVICEValue,
                                     VAHAEntityTypeGROUPValue,  VAHAEntityTypeSCENEValue,
                                     VAHAEntityTypeTRIGGERValue};

std::string joined(const Words& words) {
  std::string text;
  for (const std::string& word : words) text += (text.empty() ? "" : ", ") + word;
  return text;
}

bool isAnySwitch(const std::vector<ValuePair>& values) {
  return std::all_of(values.begin(), values.end(),
                     [](const ValuePair& pair) { return pair.assistant->isBoolean(); });
}

/// What can be given as a value, in a person's words.
std::string valuesOf(const CharacteristicEntry& entry) {
  if (entry.assistantName == VAHAAttributeENABLEDValue) return "on";
  if (!entry.values.empty() && !isAnySwitch(entry.values)) {
    Words words;
    for (const ValuePair& pair : entry.values) words.push_back(pair.assistant->description());
    return joined(words);
  }
  if (entry.valueType == "bool") return "on, off";
  if (entry.valueType == "float") return "a number";
  if (entry.valueType == "string") return "a text";
  const bool isWhole = entry.valueType.view().find("int") != std::string_view::npos;
  return isWhole ? "a whole number" : entry.valueType.str();
}

std::string unitOf(const CharacteristicEntry& entry) {
  if (!entry.unit) return {};
  return entry.localized ? entry.unit.str() + " (by locale)" : entry.unit.str();
}

std::string useOf(const CharacteristicEntry& entry) {
  if (entry.assistantName == VAHAAttributeENABLEDValue) return "runs a scene";
  if (entry.read && entry.write) return "read and set";
  if (entry.read) return "read";
  return entry.write ? "set" : "neither read nor set";
}

template <class Entry>
Words namesOf(const std::vector<Entry>& entries) {
  Words names;
  for (const Entry& entry : entries) names.push_back(entry.assistantName.str());
  return names;
}

/// Lists words on lines of at most `kGreatestLine` characters.
std::string paragraph(const Words& words) {
  constexpr std::size_t kGreatestLine = 78;
  std::string text;
  std::string line = " ";
  for (const std::string& word : words) {
    const std::string piece = ' ' + word + (&word == &words.back() ? "" : ",");
    if (line.size() + piece.size() > kGreatestLine) {
      text += line + '\n';
      line = " ";
    }
    line += piece;
  }
  return text + line + '\n';
}

std::string attributeTable(const std::vector<CharacteristicEntry>& entries,
                           const TerminalStyle& style) {
  TextTable table({"ATTRIBUTE", "USE", "VALUE", "UNIT"});
  for (const CharacteristicEntry& entry : entries) {
    table.addRow({entry.assistantName.str(), useOf(entry), valuesOf(entry), unitOf(entry)});
  }
  return table.text(style);
}

void addLine(std::string& text, const std::string& title, const std::string& content) {
  constexpr std::size_t kTitleWidth = 15;
  if (content.empty()) return;
  text += "  " + title + std::string(kTitleWidth - title.size(), ' ') + content + '\n';
}

std::string detailsOf(const CharacteristicEntry& entry) {
  std::string text = entry.assistantName.str() + " - an attribute\n";
  addLine(text, "use", useOf(entry));
  addLine(text, "value", valuesOf(entry));
  addLine(text, "unit", unitOf(entry));
  addLine(text, "value type", entry.valueType.str());
  addLine(text, "reads", entry.read.str());
  addLine(text, "sets", entry.write.str());
  Words sent;
  for (const ValuePair& pair : entry.values) {
    sent.push_back(pair.assistant->description() + " is " + pair.platform->description());
  }
  addLine(text, "on the device", joined(sent));
  if (entry.follows) addLine(text, "follows", "what is set can be read at once");
  return text;
}

std::string detailsOf(const ServiceEntry& entry) {
  std::string text = entry.assistantName.str() + " - a service type (--type)\n";
  addLine(text, "on the device", entry.serviceType.str());
  return text;
}

std::string detailsOf(const UnitEntry& entry) {
  std::string text = entry.assistantName.str() + " - a unit\n";
  addLine(text, "on the device", entry.unit.str());
  return text;
}

template <class Entry>
void addDetails(std::string& text, const std::vector<Entry>& entries) {
  for (const Entry& entry : entries) text += (text.empty() ? "" : "\n") + detailsOf(entry);
}

bool isNamed(const NDString& name, std::string_view word) {
  return name.view().size() == word.size() && containsIgnoringCase(name.view(), word);
}

template <class Entry>
bool containsWord(const Entry& entry, std::string_view word) {
  return containsIgnoringCase(entry.assistantName.view(), word);
}

bool containsWord(const CharacteristicEntry& entry, std::string_view word) {
  return containsIgnoringCase(entry.assistantName.view(), word) ||
         std::any_of(entry.values.begin(), entry.values.end(), [word](const ValuePair& pair) {
           return containsIgnoringCase(pair.assistant->description(), word);
         });
}

/// The entries of all lists that `isWanted` takes.
template <class Predicate>
Vocabulary selection(const Vocabulary& vocabulary, Predicate isWanted) {
  Vocabulary selected;
  const auto copy = [&isWanted](const auto& from, auto& to) {
    std::copy_if(from.begin(), from.end(), std::back_inserter(to), isWanted);
  };
  copy(vocabulary.services, selected.services);
  copy(vocabulary.characteristics, selected.characteristics);
  copy(vocabulary.units, selected.units);
  return selected;
}

}  // namespace

Vocabulary entriesMatching(const Vocabulary& vocabulary, std::string_view word) {
  Vocabulary named = selection(
      vocabulary, [word](const auto& entry) { return isNamed(entry.assistantName, word); });
  if (!named.isEmpty()) return named;
  return selection(vocabulary, [word](const auto& entry) { return containsWord(entry, word); });
}

std::vector<std::string_view> wordsOf(const Vocabulary& vocabulary) {
  std::vector<std::string_view> words;
  const auto add = [&words](const auto& entries) {
    for (const auto& entry : entries) words.push_back(entry.assistantName.view());
  };
  add(vocabulary.characteristics);
  add(vocabulary.services);
  add(vocabulary.units);
  return words;
}

std::string vocabularyText(const Vocabulary& vocabulary, const TerminalStyle& style) {
  return "Attributes; numbers can be raised and lowered, what is on or off can be toggled:\n" +
         attributeTable(vocabulary.characteristics, style) + "\nService types, for --type:\n" +
         paragraph(namesOf(vocabulary.services)) + "\nEntity types, for --entity:\n" +
         paragraph(Words(kEntityTypes.begin(), kEntityTypes.end())) +
         "\nUnits, for a value in a JSON command:\n" + paragraph(namesOf(vocabulary.units)) +
         "\nA scene is run by its name; in a JSON command by setting ENABLED to true.\n"
         "All about one word: nidus vocabulary WORD\n";
}

std::string vocabularyDetails(const Vocabulary& vocabulary) {
  std::string text;
  addDetails(text, vocabulary.characteristics);
  addDetails(text, vocabulary.services);
  addDetails(text, vocabulary.units);
  return text;
}

}  // namespace nidus
