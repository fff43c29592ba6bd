#pragma once

#include <sys/types.h>

#include <filesystem>

namespace nidus {

/// The permissions of a file or folder; 0 when there is none.
[[nodiscard]] mode_t permissionsOf(const std::filesystem::path& path);

/// Sets the process' file creation mask as long as it lives.
class FileCreationMask {
 public:
  explicit FileCreationMask(mode_t mask);
  ~FileCreationMask();
  FileCreationMask(const FileCreationMask&) = delete;
  FileCreationMask& operator=(const FileCreationMask&) = delete;

 private:
  const mode_t before_;
};

}  // namespace nidus
