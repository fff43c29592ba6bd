#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace nidus {

/// How text is shown on a stream: plain in a pipe or a file.
struct TerminalStyle {
  bool hasColour = false;   ///< Colour and symbols; only on a terminal that has them.
  std::size_t columns = 0;  ///< The width of the terminal in cells; 0 for one without limits.
};

/// What suits standard output: nothing of a terminal in a pipe, no colour where the environment
/// variable NO_COLOR is set or TERM is "dumb".
[[nodiscard]] TerminalStyle standardOutputStyle();

/// How many cells of a terminal `text`, UTF-8 on one line, takes: wide characters two, combining
/// ones none.
[[nodiscard]] std::size_t cellsOf(std::string_view text);

}  // namespace nidus
