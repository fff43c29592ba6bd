#pragma once

#include <cstddef>
#include <string>

#include "HomePlatform/Json/JsonLimits.h"
#include "HomePlatform/Json/JsonPath.h"

namespace nidus {

/// Looks at each byte of a JSON text before the parser does and refuses what is too long while it
/// is read: the parser would keep a text, a number or white space whole. Both references must
/// outlive it.
class JsonByteCheck {
 public:
  JsonByteCheck(const JsonLimits& limits, const JsonPath& path) : limits_(limits), path_(path) {}

  /// Takes the next byte. Throws a `JsonError` with the place that `path` says.
  void take(char byte) {
    if (++bytes_ > limits_.documentBytes) failDocument();
    if (byte == '\0') failZero();
    const Kind kind = kindOf(byte);
    length_ = kind == kind_ ? length_ + 1 : 1;
    kind_ = kind;
    if (length_ > most(kind)) failLength();
  }

 private:
  enum class Kind { text, number, space, other };

  Kind kindOf(char byte) {
    if (isInText_) {
      isInText_ = isEscaped_ || byte != '"';
      isEscaped_ = !isEscaped_ && byte == '\\';
      return Kind::text;
    }
    if (byte == '"') {
      isInText_ = true;
      return Kind::text;
    }
    if (byte == ' ' || byte == '\n' || byte == '\r' || byte == '\t') return Kind::space;
    const bool isDigit = byte >= '0' && byte <= '9';
    return isDigit || byte == '-' || byte == '+' || byte == '.' ? Kind::number : Kind::other;
  }

  [[nodiscard]] std::size_t most(Kind kind) const {
    constexpr std::size_t kQuotes = 2;
    if (kind == Kind::text) return limits_.textBytes + kQuotes;
    if (kind == Kind::number) return limits_.numberBytes;
    return kind == Kind::space ? limits_.spaceBytes : limits_.documentBytes;
  }

  [[noreturn]] void failDocument() const;
  [[noreturn]] void failZero() const;
  [[noreturn]] void failLength() const;

  const JsonLimits& limits_;
  const JsonPath& path_;
  std::size_t bytes_ = 0;
  std::size_t length_ = 0;  ///< How many bytes of `kind_` came one after the other.
  Kind kind_ = Kind::other;
  bool isInText_ = false;
  bool isEscaped_ = false;  ///< Within a text, the next byte follows a backslash.
};

}  // namespace nidus
