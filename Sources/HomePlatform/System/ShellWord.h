#pragma once

#include <string>
#include <string_view>

namespace nidus {

/// `text` as one word of a shell's command line, in quotes where it needs them.
[[nodiscard]] std::string shellWord(std::string_view text);

}  // namespace nidus
