#pragma once

#include <filesystem>

namespace nidus {

/// Writes what `temporary` holds through to the disk and gives it the name `file`, in place of what
/// has that name. After a power cut there is the old file or the whole new one. Gives 0, or the
/// error of the system, and then both are as they were.
[[nodiscard]] int putInPlace(const std::filesystem::path& temporary,
                             const std::filesystem::path& file);

/// Makes names that were given or taken in `folder` last, as far as the file system can.
void syncFolder(const std::filesystem::path& folder);

}  // namespace nidus
