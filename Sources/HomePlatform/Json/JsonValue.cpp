#include "HomePlatform/Json/JsonValue.h"

#include "HomePlatform/Json/JsonBuilder.h"
#include "HomePlatform/Json/JsonReader.h"

namespace nidus {
namespace {

/// Keys and file names may hold line ends; a message is one line.
std::string onOneLine(const std::string& text) {
  constexpr unsigned char kFirstPrintable = 0x20;
  constexpr char kHexDigits[] = "0123456789abcdef";
  std::string line;
  for (const char c : text) {
    const auto byte = static_cast<unsigned char>(c);
    if (byte < kFirstPrintable || byte == 0x7F) {
      line += {'\\', 'x', kHexDigits[byte >> 4], kHexDigits[byte & 0xF]};
    } else {
      line += c;
    }
  }
  return line;
}

}  // namespace

Failure failureOf(const JsonError& error, const std::string& fileName) {
  std::string message = fileName + ": ";
  if (!error.place.empty()) message += error.place + ": ";
  return {Failure::Kind::badInput, onOneLine(message + error.message)};
}

JsonValue parseJson(std::string_view text) {
  JsonBuilder builder;
  readJson(text, builder);
  return builder.take();
}

}  // namespace nidus
