#include "HomePlatform/Json/JsonReader.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cfloat>
#include <cmath>
#include <fstream>
#include <limits>
#include <sstream>
#include <string>

#include "HomePlatform/Json/JsonBuilder.h"
#include "HomePlatform/Json/JsonText.h"
#include "HomePlatform/Json/JsonValue.h"

namespace nidus {
namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;

JsonError errorOf(const std::string& text) {
  try {
    (void)parseJson(text);
  } catch (const JsonError& error) {
    return error;
  }
  ADD_FAILURE() << "was accepted: " << text;
  return {};
}

template <class Kind>
Kind number(const std::string& text) {
  return std::get<Kind>(parseJson(text).content);
}

TEST(ParseJsonTest, ReadsEachKindOfValue) {
  const JsonValue value = parseJson(R"({"a": [null, true, -5, 2.5, "é"], "b": {}})");
  const JsonValue::Array elements{{nullptr}, {true}, {std::int64_t{-5}}, {2.5F}, {"é"}};
  const JsonValue expected{JsonValue::Object{{"a", {elements}}, {"b", {JsonValue::Object()}}}};
  EXPECT_EQ(value, expected);
}

TEST(ParseJsonTest, KeepsKeysInTheirOrder) {
  std::string text;
  appendJson(text, parseJson(R"({"z": 1, "a": 2, "m": 3})"));
  EXPECT_EQ(text, R"({"z": 1, "a": 2, "m": 3})");
}

TEST(ParseJsonTest, RefusesWhatIsNoJson) {
  struct Case {
    const char* label;
    std::string text;
    const char* message;
  };
  const Case cases[] = {
      {"nothing", "", "the document is empty"},
      {"spaces", " \n\t", "the document is empty"},
      {"byte order mark alone", "\xEF\xBB\xBF", "the document is empty"},
      {"half an object", R"({"a": 1)", "line 1, column 8: "},
      {"trailing text", "1 2", "line 1, column 3: "},
      {"second line", "[1,\n 2,\n x]", "line 3, column 2: "},
      {"trailing comma", "[1,]", "line 1, column 4: "},
      {"leading zero", "01", "line 1, column 2: "},
      {"leading plus", "+1", "line 1, column 1: "},
      {"not a number", "NaN", "line 1, column 1: "},
      {"comment", "/* */ 1", "line 1, column 1: "},
      {"single quotes", "'a'", "line 1, column 1: "},
      {"bad escape", R"("\x41")", "line 1, column 3: "},
      {"half a surrogate", R"("\ud800")", "surrogate"},
      {"line end in a text", "\"a\nb\"", "must be escaped"},
      {"invalid UTF-8", "\"a\xFFz\"", "ill-formed UTF-8"},
      {"overlong UTF-8", "\"\xC0\x80\"", "ill-formed UTF-8"},
      {"cut UTF-8", "\"\xE2\x82\"", "ill-formed UTF-8"},
      {"zero byte after the end", std::string("1\0 2", 4), "byte 2: zero byte"},
      {"zero byte in a text", std::string("\"a\0b\"", 5), "byte 3: zero byte"},
  };
  for (const auto& [label, text, message] : cases) {
    SCOPED_TRACE(label);
    const JsonError error = errorOf(text);
    EXPECT_THAT(error.message, HasSubstr(message));
    EXPECT_EQ(error.place, "");
  }
}

TEST(ParseJsonTest, ExpectsNothingAfterTheDocument) {
  for (const char* text : {"1 2", "{} x", "[] }", "null nul"}) {
    EXPECT_THAT(errorOf(text).message, EndsWith("; expected end of input")) << text;
  }
  EXPECT_THAT(errorOf("[1, x").message, Not(HasSubstr("end of input")));
}

TEST(ParseJsonTest, LeavesReadTextOutOfMessages) {
  EXPECT_EQ(errorOf("\"\xFF\"").message.find('\xFF'), std::string::npos);
}

TEST(ParseJsonTest, PassesOverByteOrderMark) {
  EXPECT_EQ(number<std::int64_t>("\xEF\xBB\xBF 7"), 7);
}

TEST(ParseJsonTest, NamesPlaceOfRefusedValues) {
  struct Case {
    const char* text;
    const char* place;
    const char* message;
  };
  const Case cases[] = {
      {R"({"a": {"b": 1, "b": 2}})", "/a/b", "the key stands twice"},
      {R"([0, {"x": 9223372036854775808}])", "/1/x", "the integer is beyond 64 bits"},
      {R"([-9223372036854775809])", "/0", "the integer is beyond 64 bits"},
      {R"({"~/": 1e39})", "/~0~1", "the number is beyond the range of a 32-bit float"},
      {R"([1, -3.5e38])", "/1", "the number is beyond the range of a 32-bit float"},
      {R"([1e400])", "/0", "the number is beyond the range of a 32-bit float"},
      {R"([1.0, 3.4028235677973367e38])", "/1", "the number is beyond the range of a 32-bit float"},
  };
  for (const auto& [text, place, message] : cases) {
    SCOPED_TRACE(text);
    const JsonError error = errorOf(text);
    EXPECT_EQ(error.place, place);
    EXPECT_EQ(error.message, message);
  }
}

TEST(ParseJsonTest, RefusesIntegerOfManyDigits) {
  const JsonError error = errorOf('[' + std::string(400, '9') + ']');
  EXPECT_EQ(error.place, "/0");
  EXPECT_EQ(error.message, "the integer is beyond 64 bits");
}

TEST(ParseJsonTest, FindsKeyThatStandsTwiceAmongMany) {
  std::string text = "{";
  for (int i = 0; i < 40; ++i) text += "\"k" + std::to_string(i) + "\": 0, ";
  EXPECT_EQ(errorOf(text + "\"k3\": 1}").place, "/k3");
  EXPECT_EQ(errorOf(text + "\"k35\": 1}").place, "/k35");
}

TEST(ParseJsonTest, AllowsOneKeyInSeveralObjects) {
  EXPECT_NO_THROW((void)parseJson(R"([{"a": {"a": 1}}, {"a": 2}])"));
}

TEST(ParseJsonTest, ReadsIntegersToTheirEnds) {
  EXPECT_EQ(number<std::int64_t>("9223372036854775807"), std::numeric_limits<std::int64_t>::max());
  EXPECT_EQ(number<std::int64_t>("-9223372036854775808"), std::numeric_limits<std::int64_t>::min());
  EXPECT_EQ(number<std::int64_t>("-0"), 0);
}

TEST(ParseJsonTest, RoundsStraightToFloats) {
  struct Case {
    const char* text;
    float expected;
  };
  const Case cases[] = {
      {"0.1", 0.1F},
      {"72.0", 72.0F},
      {"1E2", 100.0F},
      {"3.4028234663852886e38", FLT_MAX},
      {"3.4028235677973366e38", FLT_MAX},
      // Just above the middle of two floats; by way of a 64-bit float it would become the middle
      // itself and then the even one below.
      {"1.00000005960464477540", 1.0000001F},
      {"1.00000005960464477539", 1.0F},
      {"1e-45", 1e-45F},
      {"1e-60", 0.0F},
      {"1e-400", 0.0F},
  };
  for (const auto& [text, expected] : cases) {
    SCOPED_TRACE(text);
    EXPECT_EQ(number<float>(text), expected);
  }
}

TEST(ParseJsonTest, KeepsSignOfZero) {
  EXPECT_TRUE(std::signbit(number<float>("-0.0")));
  EXPECT_TRUE(std::signbit(number<float>("-1e-60")));
}

TEST(ReadJsonTest, ReadsStreamsLikeTexts) {
  std::istringstream in(R"({"a": [1, {"b": "c"}]})");
  JsonBuilder builder;
  readJson(in, builder);
  EXPECT_TRUE(builder.isComplete());
  EXPECT_EQ(builder.take(), parseJson(R"({"a": [1, {"b": "c"}]})"));
}

TEST(ReadJsonTest, FindsTrailingTextInStreams) {
  std::istringstream in("{} x");
  JsonBuilder builder;
  EXPECT_THROW(readJson(in, builder), JsonError);
}

TEST(ReadJsonTest, SaysWhyAFolderCannotBeRead) {
  std::ifstream in("/");
  JsonBuilder builder;
  try {
    readJson(in, builder);
    FAIL() << "was accepted";
  } catch (const JsonError& error) {
    EXPECT_EQ(error.message, "cannot be read: Is a directory");
  }
}

TEST(ReadJsonTest, SaysWhenAStreamCannotBeRead) {
  std::ifstream in("/nowhere/home.json");
  JsonBuilder builder;
  try {
    readJson(in, builder);
    FAIL() << "was accepted";
  } catch (const JsonError& error) {
    EXPECT_EQ(error.message, "cannot be read");
  }
}

TEST(JsonBuilderTest, RefusesMoreValuesThanAllowed) {
  JsonBuilder enough(4);
  EXPECT_NO_THROW(readJson("[1, 2, 3]", enough));
  JsonBuilder tooFew(3);
  try {
    readJson("[1, 2, 3]", tooFew);
    FAIL() << "was accepted";
  } catch (const JsonError& error) {
    EXPECT_EQ(error.place, "/2");
    EXPECT_EQ(error.message, "there are more than 3 values here");
  }
}

TEST(JsonBuilderTest, CountsWhatWasGivenAway) {
  JsonBuilder builder(4);
  readJson("[1, 2]", builder);
  EXPECT_EQ(builder.take(), parseJson("[1, 2]"));
  EXPECT_THROW(readJson("[1, 2]", builder), JsonError);
}

TEST(FailureOfTest, NamesFileAndPlaceOnOneLine) {
  const Failure failure = failureOf(JsonError{"/a\nb\xc2\x9b", "expected a text"}, "home.json");
  EXPECT_EQ(failure.message, "home.json: /a\\x0ab\\xc2\\x9b: expected a text");
  EXPECT_EQ(failure.kind, Failure::Kind::badInput);
}

TEST(FailureOfTest, ShortensWhatTheDocumentMadeLong) {
  std::string message = "x";
  for (int i = 0; i < 500; ++i) message += "\xC3\xA9";
  EXPECT_EQ(failureOf(JsonError{"", message.substr(0, 999)}, "f").message,
            "f: " + message.substr(0, 999));
  const std::string cut = failureOf(JsonError{"/" + message, message}, "f").message;
  EXPECT_LT(cut.size(), 2000U);
  EXPECT_THAT(cut, HasSubstr("\xA9 [...] \xC3"));
  EXPECT_THAT(cut, Not(HasSubstr("x\xA9")));
}

TEST(FailureOfTest, LeavesOutPlaceOfWholeDocument) {
  EXPECT_EQ(failureOf(JsonError{"", "the document is empty"}, "x").message,
            "x: the document is empty");
}

}  // namespace
}  // namespace nidus
