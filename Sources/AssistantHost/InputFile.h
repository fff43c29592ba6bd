#pragma once

#include <cstddef>
#include <filesystem>
#include <fstream>
#include <istream>
#include <string>

#include "HomePlatform/Result.h"

namespace nidus {

/// Opens a file for reading. A file that is missing, unreadable, a folder or a named pipe is
/// bad input.
[[nodiscard]] Result<std::ifstream> openInput(const std::filesystem::path& file);

/// Reads what is left of `in`, but no more than `mostBytes`. `name` stands for it in the failure.
[[nodiscard]] Result<std::string> readUpTo(std::size_t mostBytes, std::istream& in,
                                           const std::string& name);

}  // namespace nidus
