#pragma once

#include <filesystem>
#include <memory>
#include <optional>
#include <vector>

#include "HomePlatform/Json/JsonValue.h"
#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// All that the doctor's checks look at, read once.
struct Examination {
  std::filesystem::path folder;  ///< The data folder, which may be missing.
  /// Why no files can be kept there: then none is looked for, and there is nothing to say of them.
  Status folderFailure;
  bool hasDatabase = false;                       ///< Whether there is a database file.
  std::vector<Failure> databaseFailures;          ///< What is wrong with it.
  std::vector<std::filesystem::path> backups;     ///< Those of it that are good, newest first.
  std::vector<std::filesystem::path> badBackups;  ///< The others.
  /// The homes of the database; none when there is none or it cannot be read.
  std::optional<std::vector<HomeData>> homes;
  Status moduleFailure;
  Status vocabularyFailure;
  /// The words that are in use, the built-in ones where the user's cannot be read; never null.
  std::shared_ptr<const MetadataMapper> metadata;
  Status preferencesFailure;
  JsonValue::Object preferences;  ///< Empty when they cannot be read.
};

/// Reads what there is in a data folder and finds the module. Leaves all as it was.
[[nodiscard]] Examination examine(const std::filesystem::path& folder);

}  // namespace nidus
