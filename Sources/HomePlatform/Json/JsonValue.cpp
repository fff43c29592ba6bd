#include "HomePlatform/Json/JsonValue.h"

#include "HomePlatform/Json/JsonBuilder.h"
#include "HomePlatform/Json/JsonReader.h"
#include "HomePlatform/System/OneLine.h"

namespace nidus {
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
