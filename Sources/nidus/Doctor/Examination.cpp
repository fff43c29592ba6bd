#include "nidus/Doctor/Examination.h"

#include <chrono>
#include <system_error>
#include <utility>

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/Store/StoreExamination.h"
#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/Preferences.h"
#include "nidus/Session.h"

namespace nidus {
namespace {

/// How long to wait for a process that is changing the homes: a busy home is no ill one.
constexpr std::chrono::seconds kPatience{10};

void readDatabase(Examination& examination) {
  const auto file = examination.folder / kDatabaseFile;
  std::error_code ignored;
  examination.hasDatabase = std::filesystem::exists(file, ignored);
  if (!examination.hasDatabase) return;
  StoreExamination store = examineStore(file, kPatience);
  examination.databaseFailures = std::move(store.failures);
  examination.homes = std::move(store.homes);
}

void readVocabulary(Examination& examination) {
  auto vocabulary = loadVocabulary(examination.folder / kVocabularyFile);
  if (!vocabulary) examination.vocabularyFailure = vocabulary.failure();
  examination.metadata = std::make_shared<const MetadataMapper>(vocabulary ? std::move(*vocabulary)
                                                                           : builtInVocabulary());
}

void readPreferences(Examination& examination) {
  auto preferences = PreferencesFile(examination.folder / Preferences::kFileName).read();
  if (preferences) {
    examination.preferences = std::move(preferences->values);
  } else {
    examination.preferencesFailure = preferences.failure();
  }
}

}  // namespace

Examination examine(const std::filesystem::path& folder) {
  Examination examination;
  examination.folder = folder;
  readDatabase(examination);
  const auto module = openOwnModule();
  if (!module) examination.moduleFailure = module.failure();
  readVocabulary(examination);
  readPreferences(examination);
  return examination;
}

}  // namespace nidus
