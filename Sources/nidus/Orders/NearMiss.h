#pragma once

#include <string_view>
#include <vector>

namespace nidus {

/// Gives the one of `known` that somebody who wrote `word` most likely meant: the nearest one, the
/// first of equals, when few letters differ for its length; empty when none is near. Accents
/// and the case of letters make no difference.
[[nodiscard]] std::string_view nearMiss(std::string_view word,
                                        const std::vector<std::string_view>& known);

}  // namespace nidus
