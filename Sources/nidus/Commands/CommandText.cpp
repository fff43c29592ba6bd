#include "nidus/Commands/CommandText.h"

#include <cstddef>
#include <string>

#include "AssistantHost/CommandReader.h"
#include "HomePlatform/Json/JsonValue.h"

namespace nidus {
namespace {

bool isJson(std::string_view text) {
  try {
    static_cast<void>(parseJson(text, kCommandLimits));
    return true;
  } catch (const JsonError&) {
    return false;
  }
}

/// Takes the first line, without its end, off `text`.
std::string_view takeLine(std::string_view& text) {
  const std::size_t end = text.find('\n');
  const std::string_view line = text.substr(0, end);
  text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
  return line;
}

bool leavesBracketOpen(std::string_view line) {
  int open = 0;
  bool isInText = false;
  for (std::size_t i = 0; i < line.size(); ++i) {
    const char c = line[i];
    if (isInText && c == '\\') {
      ++i;
    } else if (c == '"') {
      isInText = !isInText;
    } else if (!isInText && (c == '{' || c == '[')) {
      ++open;
    } else if (!isInText && (c == '}' || c == ']')) {
      --open;
    }
  }
  return open > 0;
}

}  // namespace

bool isBlank(std::string_view line) {
  return line.find_first_not_of(" \t\r\n") == std::string_view::npos;
}

bool isOneDocument(std::string_view text) {
  if (isJson(text)) return true;
  std::string_view first;
  for (std::string_view rest = text; !rest.empty();) {
    const std::string_view line = takeLine(rest);
    if (first.empty() && !isBlank(line)) first = line;
    if (readCommand(line, "")) return false;
  }
  return leavesBracketOpen(first);
}

}  // namespace nidus
