#include "HomePlatform/Json/JsonWriter.h"

#include <ostream>

#include "HomePlatform/Json/JsonText.h"

namespace nidus {
namespace {

constexpr std::size_t kBufferLength = 65536;
constexpr std::size_t kIndentation = 2;

}  // namespace

void JsonWriter::beginObject() { open('{'); }

void JsonWriter::endObject() {
  close('}');
  if (buffer_.size() >= kBufferLength) flush();
}

JsonWriter& JsonWriter::key(std::string_view key) {
  beginValue();
  appendJsonText(buffer_, key);
  buffer_ += ": ";
  isAfterKey_ = true;
  return *this;
}

void JsonWriter::beginLines(std::string_view key) {
  levels_.back().hasLines = indent_;
  this->key(key);
  levels_.back().hasLines = false;
  open('[');
  levels_.back().hasLines = indent_;
}

void JsonWriter::endLines() {
  const bool breaks = levels_.back().hasLines && !levels_.back().isEmpty;
  levels_.pop_back();
  if (breaks) breakLine();
  buffer_ += ']';
}

void JsonWriter::text(const NDString& text) {
  beginValue();
  appendJsonText(buffer_, text.view());
}

void JsonWriter::uuid(const NDUUID& uuid) { text(uuid.UUIDString()); }

void JsonWriter::boolean(bool value) {
  beginValue();
  buffer_ += value ? "true" : "false";
}

void JsonWriter::integer(std::int64_t value) {
  beginValue();
  buffer_ += std::to_string(value);
}

void JsonWriter::value(const NDValueRef& value) {
  beginValue();
  appendJsonValue(buffer_, value);
}

void JsonWriter::flush() {
  out_.write(buffer_.data(), static_cast<std::streamsize>(buffer_.size()));
  buffer_.clear();
}

void JsonWriter::beginValue() {
  if (isAfterKey_) {
    isAfterKey_ = false;
    return;
  }
  if (levels_.empty()) return;
  Level& level = levels_.back();
  if (!level.isEmpty) buffer_ += level.hasLines ? "," : ", ";
  if (level.hasLines) breakLine();
  level.isEmpty = false;
}

void JsonWriter::open(char bracket) {
  beginValue();
  buffer_ += bracket;
  levels_.emplace_back();
}

void JsonWriter::close(char bracket) {
  levels_.pop_back();
  buffer_ += bracket;
}

void JsonWriter::breakLine() {
  buffer_ += '\n';
  buffer_.append(kIndentation * levels_.size(), ' ');
}

}  // namespace nidus
