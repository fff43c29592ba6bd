#pragma once

#include <string>
#include <string_view>

#include "HomePlatform/Json/JsonText.h"

namespace nidus {

/// Something in dictionary form (a reply, a record, an entity) as one line of JSON with its line
/// end.
[[nodiscard]] inline std::string jsonLine(const NDDictionary& dictionary) {
  std::string line;
  appendJson(line, dictionary);
  line += '\n';
  return line;
}

}  // namespace nidus
