#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace nidus {

/// `texts`, each on one line, side by side in columns of one width that fit into `cells`, read from
/// top to bottom; below each other where `cells` is 0.
[[nodiscard]] std::string inColumns(const std::vector<std::string>& texts, std::size_t cells);

}  // namespace nidus
