#pragma once

#include <string>
#include <string_view>

namespace nidus {

/// Appends `text` to `out` as a part of one line: line ends are written as "\n" and "\r", and each
/// backslash, as well as each of the `special` characters, stands behind a backslash.
inline void appendOnOneLine(std::string& out, std::string_view text,
                            std::string_view special = {}) {
  for (const char c : text) {
    if (c == '\n') {
      out += "\\n";
    } else if (c == '\r') {
      out += "\\r";
    } else {
      if (c == '\\' || special.find(c) != std::string_view::npos) out += '\\';
      out += c;
    }
  }
}

}  // namespace nidus
