#pragma once

#include <filesystem>
#include <fstream>
#include <istream>
#include <string>

#include "HomePlatform/Result.h"

namespace nidus {

/// Opens a file for reading. A file that is missing, unreadable or a folder is bad input.
[[nodiscard]] Result<std::ifstream> openInput(const std::filesystem::path& file);

/// Reads all that is left of `in`, which `name` stands for in the failure.
[[nodiscard]] Result<std::string> readAll(std::istream& in, const std::string& name);

}  // namespace nidus
