#include <sstream>

#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/Metadata/VocabularyWriter.h"
#include "Support/DataText.h"
#include "Support/Finding.h"
#include "Support/Refusal.h"

// Vocabularies, alone and on top of the built-in one: what is refused is refused well, what is read
// survives, and the mapper finds each entry by each of its names.

namespace nidus {
namespace {

std::string documentOf(const Vocabulary& vocabulary) {
  std::ostringstream out;
  writeVocabulary(out, vocabulary);
  return out.str();
}

void checkSurvives(const Vocabulary& vocabulary) {
  const std::string document = documentOf(vocabulary);
  const auto again = mergeVocabulary({}, document, "written");
  if (!again) {
    reportFinding("A vocabulary that was written is refused: " + again.failure().message + '\n' +
                  document);
  }
  const std::string expected = dataText(vocabulary);
  expectSameText("A vocabulary changes when it is written and read", expected, dataText(*again));
  const auto twice = mergeVocabulary(vocabulary, document, "twice");
  if (!twice) reportFinding("A vocabulary refuses itself: " + twice.failure().message);
  expectSameText("A vocabulary changes under itself", expected, dataText(*twice));
}

void expectSame(std::string_view what, const NDString& expected, const NDString& actual) {
  if (!(expected == actual)) reportFinding(std::string(what) + " of \"" + expected.str() + '"');
}

void checkMapping(const Vocabulary& vocabulary) {
  const MetadataMapper mapper(vocabulary);
  for (const ServiceEntry& entry : vocabulary.services) {
    expectSame("service type", entry.serviceType,
               mapper.mapFromAssistantServiceName(entry.assistantName));
    expectSame("service name", entry.assistantName,
               mapper.mapToAssistantServiceName(entry.serviceType));
  }
  for (const UnitEntry& entry : vocabulary.units) {
    expectSame("unit", entry.unit, mapper.mapFromAssistantUnitName(entry.assistantName));
    expectSame("unit name", entry.assistantName, mapper.mapToAssistantUnitName(entry.unit));
  }
  for (const CharacteristicEntry& entry : vocabulary.characteristics) {
    const NDString& name = entry.assistantName;
    expectSame("type to read", entry.read, mapper.mapReadCharcteristicFromAssistantName(name));
    expectSame("type to write", entry.write, mapper.mapWriteCharcteristicFromAssistantName(name));
    expectSame("value type", entry.valueType, mapper.mapCharacteristicValueType(name));
    if (entry.read) expectSame("name", name, mapper.mapToAssistantCharacteristicName(entry.read));
    if (entry.write) expectSame("name", name, mapper.mapToAssistantCharacteristicName(entry.write));
  }
}

void tryVocabulary(const Vocabulary& base, std::string_view text) {
  const auto vocabulary = mergeVocabulary(base, text, "vocabulary.json");
  if (!vocabulary) return checkRefusal(vocabulary.failure(), "vocabulary.json");
  checkSurvives(*vocabulary);
  checkMapping(*vocabulary);
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const nidus::Vocabulary kBuiltIn = nidus::builtInVocabulary();
  nidus::tryVocabulary({}, nidus::textOf(data, size));
  nidus::tryVocabulary(kBuiltIn, nidus::textOf(data, size));
  return 0;
}
