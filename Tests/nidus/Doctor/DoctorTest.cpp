#include "nidus/Doctor/DoctorTest.h"

#include <memory>
#include <ostream>
#include <sstream>

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/Store/HomeDocument.h"

namespace nidus {

void PrintTo(const Finding& finding, std::ostream* out) {
  *out << (finding.severity == Severity::note ? "note: " : "attention: ") << finding.place << ": "
       << finding.message << "; " << finding.remedy;
}

DoctorCheckTest::DoctorCheckTest() {
  examination_.folder = "/data";
  examination_.hasDatabase = true;
  examination_.metadata = std::make_shared<const MetadataMapper>(builtInVocabulary());
  examination_.preferences = {{"kHomesConfigured", JsonValue{true}}};
}

Findings DoctorCheckTest::findingsOf(Check check) const {
  Findings findings;
  check(examination_, findings);
  return findings;
}

void DoctorCheckTest::setHomes(const std::string& homes) {
  std::istringstream document(R"({"format": "nidus-home/1", "homes": )" + homes + '}');
  auto read = readHomeDocument(document, "test");
  ASSERT_TRUE(read) << read.failure().message;
  examination_.homes = std::move(*read);
}

void DoctorCheckTest::addWords(const std::string& vocabulary) {
  auto merged = mergeVocabulary(examination_.metadata->vocabulary(), vocabulary, "test");
  ASSERT_TRUE(merged) << merged.failure().message;
  examination_.metadata = std::make_shared<const MetadataMapper>(std::move(*merged));
}

}  // namespace nidus
