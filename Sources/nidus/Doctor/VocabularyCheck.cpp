#include <algorithm>
#include <array>
#include <string_view>

#include "HomePlatform/System/DataFolder.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {
namespace {

/// The value types that the plug-in turns into values of the assistant.
constexpr std::array<std::string_view, 8> kValueTypes = {"bool",   "int",    "uint8", "uint16",
                                                         "uint32", "uint64", "float", "string"};

bool isKnownType(const NDString& type) {
  return std::any_of(kValueTypes.begin(), kValueTypes.end(),
                     [&type](std::string_view known) { return type == known; });
}

bool hasName(const NDString& unit, const Vocabulary& vocabulary) {
  return std::any_of(vocabulary.units.begin(), vocabulary.units.end(),
                     [&unit](const UnitEntry& entry) { return entry.unit == unit; });
}

}  // namespace

void checkVocabulary(const Examination& examination, Findings& findings) {
  if (examination.vocabularyFailure) findings.push_back(findingOf(*examination.vocabularyFailure));
  const std::string file = (examination.folder / kVocabularyFile).string();
  const Vocabulary& vocabulary = examination.metadata->vocabulary();
  for (const CharacteristicEntry& entry : vocabulary.characteristics) {
    const std::string place = file + ": " + entry.assistantName.str();
    if (!isKnownType(entry.valueType)) {
      findings.push_back(
          {Severity::attention, place,
           "its value type \"" + entry.valueType.str() +
               "\" is none that the assistant has, so it can be neither read nor set",
           "use bool, int, uint8, uint16, uint32, uint64, float or string"});
    }
    if (entry.unit && !hasName(entry.unit, vocabulary)) {
      findings.push_back({Severity::attention, place,
                          "its unit \"" + entry.unit.str() + "\" has no name for the assistant",
                          "add the unit to \"units\" in the file"});
    }
  }
}

}  // namespace nidus
