#pragma once

#include <filesystem>

#include "HomePlatform/Result.h"
#include "HomePlatform/System/FileDescriptor.h"

namespace nidus {

/// The files of a data folder, beside that of the preferences.
inline constexpr const char* kDatabaseFile = "home.db";
inline constexpr const char* kVocabularyFile = "vocabulary.json";

/// Makes sure that `folder` is there and may be written: it is made, open to its owner alone, when
/// it is missing. Fails when others may change it, one of its files or what leads there. The
/// files and an empty folder are closed to others; a folder that holds something is left as it is.
[[nodiscard]] Status prepareDataFolder(const std::filesystem::path& folder);

/// Why a folder that is missing could not be made; none when it could. Tries it with another one in
/// the same place, which is gone on return.
[[nodiscard]] Status tryDataFolder(const std::filesystem::path& folder);

/// Keeps other processes and threads that lock the same folder out until it is destroyed.
class FolderLock {
 public:
  /// Waits for the lock. `folder` must exist.
  [[nodiscard]] static Result<FolderLock> take(const std::filesystem::path& folder);

 private:
  explicit FolderLock(FileDescriptor folder) : folder_(std::move(folder)) {}

  FileDescriptor folder_;
};

}  // namespace nidus
