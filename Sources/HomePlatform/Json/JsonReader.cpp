#include "HomePlatform/Json/JsonReader.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <istream>
#include <iterator>
#include <limits>
#include <nlohmann/json.hpp>
#include <system_error>
#include <unordered_set>

#include "HomePlatform/Json/JsonByteCheck.h"

namespace nidus {
namespace {

/// Bytes on their way into the parser, each seen by the check first.
template <class Base>
class CheckedBytes {
 public:
  using iterator_category = std::input_iterator_tag;
  using value_type = char;
  using difference_type = std::ptrdiff_t;
  using pointer = const char*;
  using reference = char;

  CheckedBytes(Base base, JsonByteCheck& check) : base_(base), check_(&check) {}

  char operator*() const {
    const char byte = *base_;
    check_->take(byte);
    return byte;
  }
  CheckedBytes& operator++() {
    ++base_;
    return *this;
  }
  friend bool operator==(const CheckedBytes& a, const CheckedBytes& b) {
    return a.base_ == b.base_;
  }
  friend bool operator!=(const CheckedBytes& a, const CheckedBytes& b) { return !(a == b); }

 private:
  Base base_;
  JsonByteCheck* check_;
};

/// The keys that one object has had so far. Nearly all objects have a handful, for which a plain
/// list is the quickest.
class SeenKeys {
 public:
  /// Says whether `key` is new.
  bool add(const std::string& key) {
    if (many_.empty() && few_.size() < kFew) {
      if (std::find(few_.begin(), few_.end(), key) != few_.end()) return false;
      few_.push_back(key);
      return true;
    }
    if (many_.empty()) many_.insert(few_.begin(), few_.end());
    return many_.insert(key).second;
  }

 private:
  static constexpr std::size_t kFew = 16;
  std::vector<std::string> few_;
  std::unordered_set<std::string> many_;
};

bool isInteger(std::string_view number) {
  return number.find_first_of(".,eE") == std::string_view::npos;
}

/// "line 2, column 7: unexpected …" out of the parser's message, without the text that it read
/// last, which may be anything.
std::string syntaxMessage(std::string_view what) {
  const std::size_t line = what.find("line ");
  if (line != std::string_view::npos) what.remove_prefix(line);
  return std::string(what.substr(0, what.find("; last read: ")));
}

/// Takes the parser's events, checks what the parser leaves unchecked, and passes them on.
class CheckingHandler {
 public:
  using number_integer_t = nlohmann::json::number_integer_t;
  using number_unsigned_t = nlohmann::json::number_unsigned_t;
  using number_float_t = nlohmann::json::number_float_t;
  using string_t = nlohmann::json::string_t;
  using binary_t = nlohmann::json::binary_t;

  CheckingHandler(JsonEvents& events, const JsonLimits& limits, JsonPath& path)
      : events_(events), limits_(limits), path_(path) {}

  // NOLINTBEGIN(readability-identifier-naming): the parser calls these by its own names
  bool null() { return scalar({nullptr}); }
  bool boolean(bool value) { return scalar({value}); }
  bool number_integer(number_integer_t value) { return scalar({std::int64_t{value}}); }
  bool number_unsigned(number_unsigned_t value) {
    if (value > static_cast<number_unsigned_t>(std::numeric_limits<std::int64_t>::max())) {
      failBeyondRange(true);
    }
    return scalar({static_cast<std::int64_t>(value)});
  }
  /// The parser's own value is a 64-bit float, and rounding twice may miss the nearest one: the
  /// text decides.
  bool number_float(number_float_t roughly, const string_t& text) {
    if (isInteger(text)) failBeyondRange(true);
    std::string number = text;
    std::replace(number.begin(), number.end(), ',', '.');  // the parser writes the locale's point
    return scalar({nearestFloat(number, roughly)});
  }
  bool string(string_t& text) { return scalar({std::move(text)}); }
  bool binary(binary_t&) { return false; }

  bool start_object(std::size_t) {
    beginValue();
    checkDepth();
    events_.beginObject(path_);
    path_.enterObject();
    openObjects_.emplace_back();
    return true;
  }
  bool key(string_t& key) {
    checkKey(key);
    path_.setKey(key);
    if (!openObjects_.back().add(key)) throw JsonError{path_.place(), "the key stands twice"};
    events_.key(key, path_);
    return true;
  }
  bool end_object() {
    openObjects_.pop_back();
    path_.leave();
    events_.endObject(path_);
    path_.endValue();
    return true;
  }
  bool start_array(std::size_t) {
    beginValue();
    checkDepth();
    events_.beginArray(path_);
    path_.enterArray();
    return true;
  }
  bool end_array() {
    path_.leave();
    events_.endArray(path_);
    path_.endValue();
    return true;
  }
  bool parse_error(std::size_t, const std::string& token, const nlohmann::json::exception& error) {
    constexpr int kNumberOverflow = 406;
    if (error.id == kNumberOverflow) failBeyondRange(isInteger(token));
    std::string message = syntaxMessage(error.what());
    if (isComplete() && message.find("expected end of input") == std::string::npos) {
      message += "; expected end of input";
    }
    if (isEmpty_ && message.find("unexpected end of input") != std::string::npos) {
      throw JsonError{"", "the document is empty"};
    }
    throw JsonError{"", message};
  }
  // NOLINTEND(readability-identifier-naming)

 private:
  /// Whether the document has ended, so that what follows is too much.
  [[nodiscard]] bool isComplete() const { return !isEmpty_ && path_.depth() == 0; }

  bool scalar(JsonValue value) {
    beginValue();
    events_.scalar(std::move(value), path_);
    path_.endValue();
    return true;
  }

  void beginValue() {
    isEmpty_ = false;
    if (!path_.isInArray() || path_.index() < limits_.arrayElements) return;
    fail("an array has at most " + std::to_string(limits_.arrayElements) + " elements");
  }

  void checkKey(const std::string& key) const {
    if (key.size() > limits_.keyBytes) {
      fail("a key is longer than " + std::to_string(limits_.keyBytes) + " bytes");
    }
    if (path_.index() < limits_.objectKeys) return;
    fail("an object has at most " + std::to_string(limits_.objectKeys) + " keys");
  }

  void checkDepth() const {
    if (path_.depth() < limits_.depth) return;
    fail("nested deeper than " + std::to_string(limits_.depth) + " levels");
  }

  [[nodiscard]] float nearestFloat(const std::string& text, double roughly) const {
    float value = 0;
    const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
    if (read.ec == std::errc()) return value;
    if (std::abs(roughly) >= 1) failBeyondRange(false);
    return std::signbit(roughly) ? -0.0F : 0.0F;  // too small for a float
  }

  [[noreturn]] void failBeyondRange(bool isInteger) const {
    fail(isInteger ? "the integer is beyond 64 bits"
                   : "the number is beyond the range of a 32-bit float");
  }

  [[noreturn]] void fail(const std::string& message) const {
    throw JsonError{path_.place(), message};
  }

  JsonEvents& events_;
  const JsonLimits& limits_;
  JsonPath& path_;
  std::vector<SeenKeys> openObjects_;
  bool isEmpty_ = true;
};

template <class Bytes>
void readBytes(Bytes begin, Bytes end, JsonEvents& events, const JsonLimits& limits) {
  JsonPath path;
  JsonByteCheck check(limits, path);
  CheckingHandler handler(events, limits, path);
  nlohmann::json::sax_parse(CheckedBytes(begin, check), CheckedBytes(end, check), &handler);
}

}  // namespace

void readJson(std::string_view text, JsonEvents& events, const JsonLimits& limits) {
  readBytes(text.data(), text.data() + text.size(), events, limits);
}

void readJson(std::istream& in, JsonEvents& events, const JsonLimits& limits) {
  if (!in) throw JsonError{"", "cannot be read"};
  try {
    readBytes(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>(), events, limits);
  } catch (const std::ios_base::failure& failure) {
    throw JsonError{"", "cannot be read: " + failure.code().message()};
  }
}

}  // namespace nidus
