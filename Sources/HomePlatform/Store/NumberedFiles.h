#pragma once

#include <filesystem>
#include <string_view>
#include <vector>

namespace nidus {

/// The files beside `file` that are named after it, a word and a number, such as
/// "home-backup-000001.db" beside "home.db"; the highest number first. Empty where the folder
/// cannot be read. What has no such name exactly, a temporary file for one, is none of them.
[[nodiscard]] std::vector<std::filesystem::path> numberedFiles(const std::filesystem::path& file,
                                                               std::string_view word);

/// The name that is to come next: one higher than all there are.
[[nodiscard]] std::filesystem::path nextNumberedFile(const std::filesystem::path& file,
                                                     std::string_view word);

}  // namespace nidus
