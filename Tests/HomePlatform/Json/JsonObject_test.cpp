#include "HomePlatform/Json/JsonObject.h"

#include <gtest/gtest.h>

#include <functional>
#include <limits>
#include <string>

namespace nidus {
namespace {

struct ErrorText {
  std::string place;
  std::string message;
};

ErrorText errorOf(const std::function<void()>& read) {
  try {
    read();
  } catch (const JsonError& error) {
    return {error.place, error.message};
  }
  return {"none", "none"};
}

TEST(JsonPlacedTest, SaysWhatWasExpected) {
  const JsonValue text{std::string("x")};
  const JsonValue number{2.5F};
  const JsonPlaced placedText(text, "/t");
  const JsonPlaced placedNumber(number, "/n");
  struct Case {
    const char* label;
    std::function<void()> read;
    const char* place;
    const char* message;
  };
  const Case cases[] = {
      {"boolean", [&] { (void)placedText.boolean(); }, "/t", "expected true or false"},
      {"integer", [&] { (void)placedNumber.integer(1, 5); }, "/n",
       "expected an integer from 1 to 5"},
      {"text", [&] { (void)placedNumber.text(); }, "/n", "expected a text"},
      {"UUID of another kind", [&] { (void)placedNumber.uuid(); }, "/n",
       "expected a UUID such as \"9E01A3C4-0000-4000-8000-000000000001\""},
      {"malformed UUID", [&] { (void)placedText.uuid(); }, "/t",
       "expected a UUID such as \"9E01A3C4-0000-4000-8000-000000000001\""},
      {"array", [&] { (void)placedText.array(); }, "/t", "expected an array"},
      {"object", [&] { JsonObject object(placedText); }, "/t", "expected an object"},
  };
  for (const auto& [label, read, place, message] : cases) {
    SCOPED_TRACE(label);
    const ErrorText error = errorOf(read);
    EXPECT_EQ(error.place, place);
    EXPECT_EQ(error.message, message);
  }
}

TEST(JsonPlacedTest, ChecksRangeOfIntegers) {
  const JsonValue value = parseJson("5");
  const JsonPlaced placed(value, "");
  EXPECT_EQ(placed.integer(5, 5), 5);
  EXPECT_THROW((void)placed.integer(6, 9), JsonError);
  EXPECT_THROW((void)placed.integer(1, 4), JsonError);
}

TEST(JsonPlacedTest, BoxesEachKind) {
  const JsonValue values = parseJson(R"([true, 1, 1.0, "1"])");
  const auto placed = JsonPlaced(values, "").array();
  EXPECT_TRUE(placed[0].boxed()->isBoolean());
  EXPECT_TRUE(placed[1].boxed()->isInteger());
  EXPECT_TRUE(placed[2].boxed()->isFloating());
  EXPECT_TRUE(placed[3].boxed()->isText());
}

TEST(JsonPlacedTest, BoxesNeitherNullNorLists) {
  const JsonValue values = parseJson("[null, [], {}]");
  for (const JsonPlaced& placed : JsonPlaced(values, "").array()) {
    EXPECT_THROW((void)placed.boxed(), JsonError) << placed.place();
  }
}

TEST(JsonPlacedTest, ReadsUUIDInEitherCase) {
  const JsonValue value = parseJson(R"("9e01a3c4-0000-4000-8000-00000000000f")");
  EXPECT_EQ(JsonPlaced(value, "").uuid().UUIDString(), "9E01A3C4-0000-4000-8000-00000000000F");
}

TEST(JsonObjectTest, PlacesMembersAndElements) {
  const JsonValue value = parseJson(R"({"a/b": [10, 20]})");
  JsonObject object(JsonPlaced(value, "/x"));
  const auto elements = object.required("a/b").array();
  EXPECT_EQ(elements[1].place(), "/x/a~1b/1");
  EXPECT_EQ(elements[1].integer(0, 99), 20);
}

TEST(JsonObjectTest, NamesMissingKey) {
  const JsonValue value = parseJson(R"({"name": "x"})");
  JsonObject object(JsonPlaced(value, "/homes/0"));
  const ErrorText error = errorOf([&] { (void)object.required("uuid"); });
  EXPECT_EQ(error.place, "/homes/0");
  EXPECT_EQ(error.message, "missing required key \"uuid\"");
}

TEST(JsonObjectTest, TakesNullForAbsent) {
  const JsonValue value = parseJson(R"({"room": null, "name": "x"})");
  JsonObject object(JsonPlaced(value, ""));
  EXPECT_FALSE(object.optional("room"));
  EXPECT_FALSE(object.optional("zone"));
  EXPECT_TRUE(object.optional("name"));
}

TEST(JsonObjectTest, KeepsNullOfRequiredKey) {
  const JsonValue value = parseJson(R"({"value": null})");
  JsonObject object(JsonPlaced(value, ""));
  EXPECT_TRUE(object.required("value").isNull());
}

TEST(JsonObjectTest, RefusesUnknownKeyWithTheKnown) {
  const JsonValue value = parseJson(R"({"name": "x", "nmae": "y", "rooms": []})");
  JsonObject object(JsonPlaced(value, "/homes/0"));
  (void)object.required("name");
  (void)object.optional("uuid");
  object.allow("rooms");
  const ErrorText error = errorOf([&] { object.refuseUnknownKeys(); });
  EXPECT_EQ(error.place, "/homes/0/nmae");
  EXPECT_EQ(error.message, "no such key; expected one of name, uuid, rooms");
}

TEST(JsonObjectTest, RefusesAnyKeyWhereNoneIsKnown) {
  const JsonValue value = parseJson(R"({"x": 1})");
  const JsonObject object(JsonPlaced(value, ""));
  EXPECT_EQ(errorOf([&] { object.refuseUnknownKeys(); }).message, "no such key; expected none");
}

}  // namespace
}  // namespace nidus
