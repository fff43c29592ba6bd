#include "HomePlatform/Json/JsonByteCheck.h"

#include "HomePlatform/Json/JsonValue.h"

namespace nidus {
namespace {

[[noreturn]] void failBeyond(std::string place, const std::string& what, std::size_t bytes) {
  throw JsonError{std::move(place), what + " is longer than " + std::to_string(bytes) + " bytes"};
}

}  // namespace

void JsonByteCheck::failDocument() const { failBeyond("", "the document", limits_.documentBytes); }

void JsonByteCheck::failZero() const {
  throw JsonError{"", "byte " + std::to_string(bytes_) + ": zero byte"};
}

void JsonByteCheck::failLength() const {
  if (kind_ == Kind::text) failBeyond(path_.place(), "the text", limits_.textBytes);
  if (kind_ == Kind::number) failBeyond(path_.place(), "the number", limits_.numberBytes);
  failBeyond(path_.place(), "the white space", limits_.spaceBytes);
}

}  // namespace nidus
