#include "HomePlatform/Json/JsonText.h"

#include <array>
#include <charconv>
#include <cmath>

namespace nidus {
namespace {

constexpr std::size_t kNumberLength = 32;

void appendInteger(std::string& out, std::int64_t value) {
  std::array<char, kNumberLength> digits;
  const auto written = std::to_chars(digits.data(), digits.data() + digits.size(), value);
  out.append(digits.data(), written.ptr);
}

void appendControl(std::string& out, char control) {
  constexpr char kHexDigits[] = "0123456789abcdef";
  switch (control) {
    case '\b':
      out += "\\b";
      return;
    case '\f':
      out += "\\f";
      return;
    case '\n':
      out += "\\n";
      return;
    case '\r':
      out += "\\r";
      return;
    case '\t':
      out += "\\t";
      return;
    default:
      out += "\\u00";
      out += kHexDigits[control >> 4];
      out += kHexDigits[control & 0xF];
  }
}

/// One writer for the two trees of plain values, which differ in the type of a text alone.
struct Writer {
  std::string& out;

  void operator()(std::nullptr_t) const { out += "null"; }
  void operator()(bool value) const { out += value ? "true" : "false"; }
  void operator()(std::int64_t value) const { appendInteger(out, value); }
  void operator()(float value) const { appendJsonFloat(out, value); }
  void operator()(const NDString& text) const { appendJsonText(out, text.view()); }
  void operator()(const std::string& text) const { appendJsonText(out, text); }
  void operator()(const NDDictionaryList& list) const { appendList(list); }
  void operator()(const JsonValue::Array& list) const { appendList(list); }
  void operator()(const NDDictionary& dictionary) const { appendMembers(dictionary); }
  void operator()(const JsonValue::Object& object) const { appendMembers(object); }

  template <class List>
  void appendList(const List& list) const {
    out += '[';
    const char* separator = "";
    for (const auto& element : list) {
      out += separator;
      appendJson(out, element);
      separator = ", ";
    }
    out += ']';
  }

  template <class Members>
  void appendMembers(const Members& members) const {
    out += '{';
    const char* separator = "";
    for (const auto& [key, value] : members) {
      out += separator;
      appendJsonText(out, key);
      out += ": ";
      appendJson(out, value);
      separator = ", ";
    }
    out += '}';
  }
};

}  // namespace

void appendJsonText(std::string& out, std::string_view text) {
  constexpr unsigned char kFirstUnescaped = 0x20;
  out += '"';
  for (const char c : text) {
    if (static_cast<unsigned char>(c) < kFirstUnescaped) {
      appendControl(out, c);
      continue;
    }
    if (c == '"' || c == '\\') out += '\\';
    out += c;
  }
  out += '"';
}

void appendJsonFloat(std::string& out, float value) {
  if (!std::isfinite(value)) {
    out += "null";
    return;
  }
  std::array<char, kNumberLength> digits;
  const auto written = std::to_chars(digits.data(), digits.data() + digits.size(), value);
  const std::string_view text(digits.data(), static_cast<std::size_t>(written.ptr - digits.data()));
  out += text;
  if (text.find_first_of(".e") == std::string_view::npos) out += ".0";
}

void appendJsonValue(std::string& out, const NDValueRef& value) {
  if (!value) {
    out += "null";
  } else if (value->isBoolean()) {
    out += value->boolValue() ? "true" : "false";
  } else if (value->isInteger()) {
    appendInteger(out, value->integerValue());
  } else if (value->isFloating()) {
    appendJsonFloat(out, value->floatValue());
  } else {
    appendJsonText(out, value->stringValue().view());
  }
}

void appendJson(std::string& out, const NDDictionaryValue& value) {
  std::visit(Writer{out}, value.content());
}

void appendJson(std::string& out, const NDDictionary& dictionary) { Writer{out}(dictionary); }

void appendJson(std::string& out, const JsonValue& value) {
  std::visit(Writer{out}, value.content);
}

}  // namespace nidus
