#include "HomePlatform/Json/JsonValue.h"

#include "HomePlatform/Json/JsonBuilder.h"
#include "HomePlatform/Json/JsonReader.h"
#include "HomePlatform/System/OneLine.h"

namespace nidus {
namespace {

/// Whether a character of UTF-8 begins, or the text ends, at `index`.
bool isBoundary(const std::string& text, std::size_t index) {
  return index >= text.size() || (static_cast<unsigned char>(text[index]) & 0xC0) != 0x80;
}

/// A text that may hold what a document says, short enough for a message.
std::string shortened(const std::string& text) {
  constexpr std::size_t kMost = 1000;
  constexpr std::size_t kBeginning = 600;
  constexpr std::size_t kEnd = 300;
  if (text.size() <= kMost) return text;
  std::size_t begin = kBeginning;
  while (!isBoundary(text, begin)) ++begin;
  std::size_t end = text.size() - kEnd;
  while (!isBoundary(text, end)) ++end;
  return text.substr(0, begin) + " [...] " + text.substr(end);
}

}  // namespace

Failure failureOf(const JsonError& error, const std::string& fileName) {
  std::string message = fileName + ": ";
  if (!error.place.empty()) message += shortened(error.place) + ": ";
  return {Failure::Kind::badInput, onOneLine(message + shortened(error.message))};
}

JsonValue parseJson(std::string_view text, const JsonLimits& limits) {
  JsonBuilder builder(limits.valuesInMemory);
  readJson(text, builder, limits);
  return builder.take();
}

JsonValue parseJson(std::istream& in, const JsonLimits& limits) {
  JsonBuilder builder(limits.valuesInMemory);
  readJson(in, builder, limits);
  return builder.take();
}

}  // namespace nidus
