#include "HomePlatform/Json/JsonLimits.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <istream>
#include <streambuf>
#include <string>
#include <utility>

#include "HomePlatform/Json/JsonBuilder.h"
#include "HomePlatform/Json/JsonReader.h"

namespace nidus {
namespace {

using testing::HasSubstr;

constexpr JsonLimits kSmall{.documentBytes = 60,
                            .depth = 3,
                            .textBytes = 8,
                            .keyBytes = 4,
                            .numberBytes = 6,
                            .spaceBytes = 5,
                            .arrayElements = 4,
                            .objectKeys = 3,
                            .valuesInMemory = 9};

std::string refusalOf(const std::string& text) {
  try {
    (void)parseJson(text, kSmall);
  } catch (const JsonError& error) {
    return error.place + ": " + error.message;
  }
  return "accepted";
}

TEST(JsonLimitsTest, HoldOnBothSides) {
  struct Case {
    const char* label;
    std::string inside;
    std::string outside;
    const char* error;
  };
  const std::string sixtyBytes = R"(["12345678",     "12345678",     "12345678",     "12345678"])";
  const Case cases[] = {
      {"document", sixtyBytes, sixtyBytes + ' ', ": the document is longer than 60 bytes"},
      {"depth", "[[{}]]", "[[{\"a\": []}]]", "/0/0/a: nested deeper than 3 levels"},
      {"text", R"(["12345678"])", R"([0, "123456789"])", "/1: the text is longer than 8 bytes"},
      {"escapes", R"(["123456\""])", R"(["1234567\""])", "/0: the text is longer than 8 bytes"},
      {"last backslash", R"(["123456\\"])", R"(["1234567\\"])",
       "/0: the text is longer than 8 bytes"},
      {"text in object", R"({"a": "12345678"})", R"({"a": "123456789"})",
       "/a: the text is longer than 8 bytes"},
      {"key", R"({"1234": 1})", R"({"a": {"b": 1, "12345": 1}})",
       "/a: a key is longer than 4 bytes"},
      {"key as text", R"({"\u0041": 1})", R"({"a": [{"\u0041\u0042": 1}]})",
       "/a/0: the text is longer than 8 bytes"},
      {"number", "[123456]", "[1, -123456]", "/1: the number is longer than 6 bytes"},
      {"white space", "[     1\n, 2]", "[      1]", "/0: the white space is longer than 5 bytes"},
      {"elements", "[1, [], {}, 2]", "[1, [], {}, 2, 3]", ": an array has at most 4 elements"},
      {"inner elements", "[[1, 2, 3, 4], [5]]", "[[1], [1, 2, 3, 4, []]]",
       "/1/4: an array has at most 4 elements"},
      {"keys", R"({"a": 1, "b": 2, "c": 3})", R"({"a": 1, "b": 2, "c": 3, "d": 4})",
       ": an object has at most 3 keys"},
      {"values", "[[1, 2, 3, 4], [1, 2]]", "[[1, 2, 3, 4], [1, 2, 3]]",
       "/1/2: there are more than 9 values here"},
  };
  for (const auto& [label, inside, outside, error] : cases) {
    SCOPED_TRACE(label);
    EXPECT_EQ(refusalOf(inside), "accepted");
    EXPECT_THAT(refusalOf(outside), HasSubstr(error));
  }
}

/// A beginning, and then the same bytes again and again without an end.
class EndlessBuffer final : public std::streambuf {
 public:
  EndlessBuffer(std::string beginning, std::string bytes)
      : next_(std::move(beginning)), bytes_(std::move(bytes)) {}
  [[nodiscard]] std::size_t given() const { return given_; }

 protected:
  int_type underflow() override {
    now_ = std::exchange(next_, bytes_);
    given_ += now_.size();
    setg(now_.data(), now_.data(), now_.data() + now_.size());
    return traits_type::to_int_type(now_.front());
  }

 private:
  std::string now_;
  std::string next_;
  const std::string bytes_;
  std::size_t given_ = 0;
};

TEST(JsonLimitsTest, EndReadingOfWhatNeverEnds) {
  struct Case {
    const char* beginning;
    const char* bytes;
    const char* error;
  };
  const Case cases[] = {
      {"\"", "a", "the text is longer"},
      {"[\"", "\\\"", "the text is longer"},
      {"[1", "1", "the number is longer"},
      {"[", " ", "the white space is longer"},
      {"[", "[", "nested deeper"},
      {"[0", ", 0", "an array has at most"},
      {"[", "{", "expected string literal"},
      {"{\"", "k", "the text is longer"},
      {"1", " \n", "the white space is longer"},
  };
  for (const auto& [beginning, bytes, message] : cases) {
    SCOPED_TRACE(std::string(beginning) + bytes);
    EndlessBuffer buffer(beginning, bytes);
    std::istream in(&buffer);
    JsonBuilder builder;
    try {
      readJson(in, builder, kSmall);
      ADD_FAILURE() << "was accepted";
    } catch (const JsonError& error) {
      EXPECT_THAT(error.message, HasSubstr(message));
    }
    EXPECT_LT(buffer.given(), 30U);
  }
}

TEST(JsonLimitsTest, RefuseLongTextBeforeItsEnd) {
  EXPECT_EQ(refusalOf(R"({"a": "12345678901234567890)"), "/a: the text is longer than 8 bytes");
}

TEST(JsonLimitsTest, AllowOrdinaryDepthWithoutBeingTold) {
  const auto nested = [](std::size_t depth) {
    return std::string(depth, '[') + std::string(depth, ']');
  };
  EXPECT_NO_THROW((void)parseJson(nested(64)));
  EXPECT_THROW((void)parseJson(nested(65)), JsonError);
}

}  // namespace
}  // namespace nidus
