#pragma once

#include <string>
#include <string_view>

namespace nidus {

/// `text` on one line: its control characters, both sets of them, are shown as escapes such as
/// "\\x0a", so that no text can pass for a line of its own or command a terminal.
[[nodiscard]] std::string onOneLine(std::string_view text);

}  // namespace nidus
