#include "HomePlatform/Json/JsonWriter.h"

#include <gtest/gtest.h>

#include <sstream>

namespace nidus {
namespace {

std::string written(bool indent) {
  std::ostringstream out;
  JsonWriter writer(out, indent);
  writer.beginObject();
  writer.key("name").text("Flat");
  writer.beginLines("rooms");
  for (const std::int64_t number : {1, 2}) {
    writer.beginObject();
    writer.key("number").integer(number);
    writer.key("open").boolean(true);
    writer.endObject();
  }
  writer.endLines();
  writer.beginLines("none");
  writer.endLines();
  writer.key("words").beginArray();
  writer.text("a");
  writer.value(NDValue::floating(2));
  writer.endArray();
  writer.endObject();
  writer.flush();
  return out.str();
}

TEST(JsonWriterTest, WritesOneLine) {
  EXPECT_EQ(written(false), R"({"name": "Flat", "rooms": [{"number": 1, "open": true}, )"
                            R"({"number": 2, "open": true}], "none": [], "words": ["a", 2.0]})");
}

TEST(JsonWriterTest, GivesEachPartALine) {
  EXPECT_EQ(written(true), R"({"name": "Flat",
  "rooms": [
    {"number": 1, "open": true},
    {"number": 2, "open": true}
  ],
  "none": [], "words": ["a", 2.0]})");
}

TEST(JsonWriterTest, HandsLongDocumentsOnInPieces) {
  std::ostringstream out;
  JsonWriter writer(out, false);
  writer.beginObject();
  writer.beginLines("texts");
  for (int i = 0; i < 100; ++i) {
    writer.beginObject();
    writer.key("text").text(std::string(10'000, 'x'));
    writer.endObject();
  }
  EXPECT_GT(out.str().size(), 900'000U);
}

}  // namespace
}  // namespace nidus
