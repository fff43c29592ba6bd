#include "nidus/Terminal/Terminal.h"

#include <sys/ioctl.h>
#include <unigbrk.h>
#include <unistd.h>
#include <uniwidth.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>

#include "nidus/SystemLibrary.h"

namespace nidus {
namespace {

constexpr std::string_view kEllipsis = "…";
constexpr std::size_t kEllipsisCells = 1;

/// The functions of the library that knows all characters; most texts need none of them.
struct CharacterLibrary {
  const SystemLibrary library{NIDUS_UNISTRING_NAME};
  decltype(&u8_width) width = library.function<decltype(u8_width)>("u8_width");
  decltype(&u8_grapheme_breaks) graphemeBreaks =
      library.function<decltype(u8_grapheme_breaks)>("u8_grapheme_breaks");
};

const CharacterLibrary& characterLibrary() {
  static const CharacterLibrary kLibrary;
  return kLibrary;
}

/// Whether each byte of `text` is a character that takes one cell.
bool isPlain(std::string_view text) {
  return std::all_of(text.begin(), text.end(), [](char c) { return c >= ' ' && c <= '~'; });
}

const std::uint8_t* unitsOf(std::string_view text) {
  return reinterpret_cast<const std::uint8_t*>(text.data());
}

bool wantsColour() {
  const char* const refusal = std::getenv("NO_COLOR");
  const char* const terminal = std::getenv("TERM");
  const bool isRefused = refusal && *refusal != '\0';
  return !isRefused && terminal && *terminal != '\0' && std::string_view(terminal) != "dumb";
}

TerminalStyle styleOf(int file) {
  if (isatty(file) == 0) return {};
  winsize size = {};
  const bool isSizeKnown = ioctl(file, TIOCGWINSZ, &size) == 0;
  return {wantsColour(), isSizeKnown ? size.ws_col : std::size_t{0}};
}

std::string_view codeOf(Colour colour) {
  switch (colour) {
    case Colour::title:
      return "\x1b[1m";
    case Colour::faint:
      return "\x1b[2m";
    case Colour::good:
      return "\x1b[32m";
    case Colour::warning:
      return "\x1b[33m";
    case Colour::bad:
      return "\x1b[31m";
    case Colour::none:
      break;
  }
  return {};
}

/// How many bytes of `text` are whole characters, with all that combines with them, and take at
/// most `cells` cells.
std::size_t fittingSize(std::string_view text, std::size_t cells) {
  if (isPlain(text)) return std::min(text.size(), cells);
  std::vector<char> isStart(text.size());
  characterLibrary().graphemeBreaks(unitsOf(text), text.size(), isStart.data());
  std::size_t fitting = 0;
  for (std::size_t end = 1; end < text.size(); ++end) {
    if (isStart[end] == 0) continue;
    if (cellsOf(text.substr(0, end)) > cells) break;
    fitting = end;
  }
  return fitting;
}

}  // namespace

TerminalStyle standardOutputStyle() { return styleOf(STDOUT_FILENO); }

TerminalStyle standardErrorStyle() { return styleOf(STDERR_FILENO); }

std::string coloured(std::string_view text, Colour colour, const TerminalStyle& style) {
  if (!style.hasColour || colour == Colour::none || text.empty()) return std::string(text);
  return std::string(codeOf(colour)).append(text).append("\x1b[0m");
}

std::size_t cellsOf(std::string_view text) {
  if (isPlain(text)) return text.size();
  const int cells = characterLibrary().width(unitsOf(text), text.size(), "UTF-8");
  return cells > 0 ? static_cast<std::size_t>(cells) : 0;
}

std::string shortened(std::string_view text, std::size_t cells) {
  if (cellsOf(text) <= cells) return std::string(text);
  if (cells == 0) return {};
  const std::string_view kept = text.substr(0, fittingSize(text, cells - kEllipsisCells));
  return std::string(kept.substr(0, kept.find_last_not_of(' ') + 1)).append(kEllipsis);
}

std::vector<std::string> wrapped(std::string_view text, std::size_t cells) {
  std::vector<std::string> lines = {{}};
  while (!text.empty()) {
    const std::string_view word = text.substr(0, text.find(' ', 1));  // with the blank before it
    std::string& line = lines.back();
    const bool isFull = !line.empty() && cellsOf(line) + cellsOf(word) > cells;
    if (cells > 0 && isFull) {
      lines.emplace_back(word.substr(1));
    } else {
      line += word;
    }
    text.remove_prefix(word.size());
  }
  return lines;
}

}  // namespace nidus
