#pragma once

#include <filesystem>

#include "HomePlatform/Result.h"

namespace nidus {

/// Makes the folder of `file` and an empty `file` where they are missing, for their owner alone,
/// and checks that both may be written. Gives none when all is well.
[[nodiscard]] Status prepareDatabaseFile(const std::filesystem::path& file);

/// Lets one process at a time open, make or migrate the databases of a folder: held from
/// construction to destruction, released by the system when the process dies. Waits without limit.
class FolderLock {
 public:
  explicit FolderLock(const std::filesystem::path& folder);
  ~FolderLock();
  FolderLock(const FolderLock&) = delete;
  FolderLock& operator=(const FolderLock&) = delete;

 private:
  int folder_;
};

}  // namespace nidus
