#pragma once

#include <chrono>
#include <filesystem>
#include <optional>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// What a thorough look at a database has found.
struct StoreExamination {
  /// What is wrong with it, each with the file and the remedy; empty when it is sound.
  std::vector<Failure> failures = {};
  /// The homes as they would be after its migration; none when they cannot be read.
  std::optional<std::vector<HomeData>> homes = std::nullopt;
  /// Whether its contents are what is wrong with it, and not, for example, its version or a lock.
  bool isDamaged = false;
};

/// Looks at every page, index and reference of the database in `file`, and at its version; changes
/// and makes nothing. Reads all of the file. Waits up to `lockTimeout` for other processes.
[[nodiscard]] StoreExamination examineStore(const std::filesystem::path& file,
                                            std::chrono::milliseconds lockTimeout);

}  // namespace nidus
