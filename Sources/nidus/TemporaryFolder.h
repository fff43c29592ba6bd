#pragma once

#include <filesystem>
#include <utility>

#include "HomePlatform/Result.h"

namespace nidus {

/// A folder of one's own for a while; removed with all that is in it when this is destroyed,
/// unless it is kept.
class TemporaryFolder {
 public:
  /// Makes one in the folder for temporary files (TMPDIR, else /tmp), unless others could exchange
  /// it.
  [[nodiscard]] static Result<TemporaryFolder> make();
  TemporaryFolder(TemporaryFolder&& other) noexcept
      : path_(std::exchange(other.path_, {})), isKept_(other.isKept_) {}
  TemporaryFolder& operator=(TemporaryFolder&&) = delete;
  ~TemporaryFolder();

  /// Leaves the folder where it is when this is destroyed.
  void keep() noexcept { isKept_ = true; }
  [[nodiscard]] const std::filesystem::path& path() const noexcept { return path_; }

 private:
  explicit TemporaryFolder(std::filesystem::path path) : path_(std::move(path)) {}

  std::filesystem::path path_;
  bool isKept_ = false;
};

}  // namespace nidus
