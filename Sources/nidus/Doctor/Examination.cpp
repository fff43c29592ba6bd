#include "nidus/Doctor/Examination.h"

#include <chrono>
#include <string>
#include <system_error>
#include <utility>

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/StoreExamination.h"
#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/Preferences.h"
#include "nidus/Session.h"

namespace nidus {
namespace {

/// How long to wait for a process that is changing the homes: a busy home is no ill one.
constexpr std::chrono::seconds kPatience{10};

Status failureOf(const std::filesystem::path& folder) {
  std::error_code error;
  const auto kind = std::filesystem::status(folder, error).type();
  if (kind == std::filesystem::file_type::not_found) return tryDataFolder(folder);
  if (kind == std::filesystem::file_type::directory) return std::nullopt;
  const std::string reason = kind == std::filesystem::file_type::none
                                 ? "it cannot be looked at: " + error.message()
                                 : "it is not a folder";
  return Failure{Failure::Kind::platform,
                 folder.string() + ": " + reason + "; give another data folder with --data DIR"};
}

void readDatabase(Examination& examination) {
  const auto file = examination.folder / kDatabaseFile;
  std::error_code ignored;
  examination.hasDatabase = std::filesystem::exists(file, ignored);
  if (!examination.hasDatabase) return;
  // Nobody replaces the file by a backup while it is open here.
  const auto lock = FolderLock::take(examination.folder);
  StoreExamination store = examineStore(file, kPatience);
  examination.databaseFailures = std::move(store.failures);
  examination.homes = std::move(store.homes);
}

void readBackups(Examination& examination) {
  for (auto& backup : backupsOf(examination.folder / kDatabaseFile)) {
    (homesOfBackup(backup) ? examination.backups : examination.badBackups)
        .push_back(std::move(backup));
  }
}

void readVocabulary(Examination& examination) {
  auto vocabulary = loadVocabulary(examination.folder / kVocabularyFile);
  if (vocabulary) {
    examination.metadata = std::make_shared<const MetadataMapper>(std::move(*vocabulary));
  } else {
    examination.vocabularyFailure = vocabulary.failure();
  }
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
  examination.metadata = std::make_shared<const MetadataMapper>(builtInVocabulary());
  const auto module = openOwnModule();
  if (!module) examination.moduleFailure = module.failure();
  examination.folderFailure = failureOf(folder);
  if (examination.folderFailure) return examination;
  readDatabase(examination);
  readBackups(examination);
  readVocabulary(examination);
  readPreferences(examination);
  return examination;
}

}  // namespace nidus
