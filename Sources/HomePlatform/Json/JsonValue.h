#pragma once

#include <cstddef>
#include <cstdint>
#include <iosfwd>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "HomePlatform/Json/JsonLimits.h"
#include "HomePlatform/Result.h"

namespace nidus {

/// A JSON value as it was read, numbers already told apart: without fraction and exponent an
/// integer, otherwise a 32-bit float.
struct JsonValue {
  using Array = std::vector<JsonValue>;
  using Member = std::pair<std::string, JsonValue>;
  using Object = std::vector<Member>;  ///< In the order of the text; no key stands twice.
  std::variant<std::nullptr_t, bool, std::int64_t, float, std::string, Array, Object> content =
      nullptr;
  friend bool operator==(const JsonValue&, const JsonValue&) = default;
};

/// Something wrong with a document: thrown inside the readers, turned into a `Failure` at their
/// edge.
struct JsonError {
  std::string place;    ///< A JSON pointer, empty for the whole document.
  std::string message;  ///< What was expected.
};

/// Makes the failure that people see: `file: place: message`, on one line.
[[nodiscard]] Failure failureOf(const JsonError& error, const std::string& fileName);

/// Reads one JSON text whole. Strict: throws `JsonError` for anything but one value of valid UTF-8,
/// for a key that stands twice, an integer beyond 64 bits, a float beyond 32-bit range, and for
/// what is beyond one of the `limits`. A number that is too small for a float becomes 0.0; a byte
/// order mark before the text is passed over. The message of a syntax error names line and column.
[[nodiscard]] JsonValue parseJson(std::string_view text, const JsonLimits& limits = {});
[[nodiscard]] JsonValue parseJson(std::istream& in, const JsonLimits& limits = {});

}  // namespace nidus
