#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace nidus {

/// How text is shown on a stream: plain in a pipe or a file.
struct TerminalStyle {
  bool hasColour = false;   ///< Colour and symbols; only on a terminal that has them.
  std::size_t columns = 0;  ///< The width of the terminal in cells; 0 for one without limits.
};

/// What suits standard output and standard error: nothing of a terminal in a pipe, no colour where
/// the environment variable NO_COLOR has a text or TERM is missing or "dumb".
[[nodiscard]] TerminalStyle standardOutputStyle();
[[nodiscard]] TerminalStyle standardErrorStyle();

/// What a text is to stand out as.
enum class Colour { none, title, faint, good, warning, bad };

/// `text` in a colour, where the style has colours; without one it stays as it is.
[[nodiscard]] std::string coloured(std::string_view text, Colour colour,
                                   const TerminalStyle& style);

/// How many cells of a terminal `text`, UTF-8 on one line, takes: wide characters two, combining
/// ones none.
[[nodiscard]] std::size_t cellsOf(std::string_view text);

/// The beginning of `text` with an ellipsis in at most `cells` cells, or all of it where it fits. A
/// character stays together with what combines with it.
[[nodiscard]] std::string shortened(std::string_view text, std::size_t cells);

/// The lines of at most `cells` cells that `text` takes when it is broken at its blanks; all on one
/// line for 0. What has no blank is not broken. At least one line.
[[nodiscard]] std::vector<std::string> wrapped(std::string_view text, std::size_t cells);

}  // namespace nidus
