#pragma once

#include <string>
#include <vector>

namespace nidus {

/// Gives the names of the symbols that a shared object (a 64-bit ELF file of this machine) defines
/// for others, sorted; throws `std::runtime_error` for any other file.
[[nodiscard]] std::vector<std::string> exportedSymbols(const std::string& file);

}  // namespace nidus
