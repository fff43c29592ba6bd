#include "AssistantHost/Transcript.h"

#include <gtest/gtest.h>

#include "AssistantHost/JsonLine.h"

namespace nidus {
namespace {

const NDUUID kHome = *NDUUID::fromText("AA00AA00-0000-4000-8000-000000000001");
const NDUUID kAccessory = *NDUUID::fromText("DD00DD00-0000-4000-8000-00000000000d");

PlatformCall callOf(PlatformCall::Kind kind) {
  PlatformCall call;
  call.kind = kind;
  call.home = kHome;
  return call;
}

TEST(TranscriptTest, WritesAReadInOrder) {
  PlatformCall call = callOf(PlatformCall::Kind::read);
  call.characteristics = {{kAccessory, 8, 10}, {kAccessory, 8, 9}};
  EXPECT_EQ(
      jsonLine(transcriptOf(call)),
      R"({"call": "read", "home": "AA00AA00-0000-4000-8000-000000000001", "characteristics": [)"
      R"({"accessory": "DD00DD00-0000-4000-8000-00000000000D", "service": 8, "characteristic": 10}, )"
      R"({"accessory": "DD00DD00-0000-4000-8000-00000000000D", "service": 8, "characteristic": 9}]})"
      "\n");
}

struct WrittenValue {
  NDValueRef value;
  const char* json;
};

TEST(TranscriptTest, WritesValuesAsTheyWerePassed) {
  const WrittenValue table[] = {
      {nullptr, "null"},
      {NDValue::boolean(true), "true"},
      {NDValue::integer(45), "45"},
      {NDValue::floating(45.0F), "45.0"},
      {NDValue::text("45"), "\"45\""},
  };
  for (const WrittenValue& written : table) {
    SCOPED_TRACE(written.json);
    PlatformCall call = callOf(PlatformCall::Kind::write);
    call.characteristics = {{kAccessory, 8, 9}};
    call.values = {written.value};
    EXPECT_EQ(
        jsonLine(transcriptOf(call)),
        std::string(
            R"({"call": "write", "home": "AA00AA00-0000-4000-8000-000000000001", "writes": [)"
            R"({"accessory": "DD00DD00-0000-4000-8000-00000000000D", "service": 8, "characteristic": 9, )"
            R"("value": )") +
            written.json + "}]}\n");
  }
}

TEST(TranscriptTest, WritesTheSceneThatRan) {
  PlatformCall call = callOf(PlatformCall::Kind::execute);
  call.actionSet = kAccessory;
  EXPECT_EQ(jsonLine(transcriptOf(call)),
            R"({"call": "execute", "home": "AA00AA00-0000-4000-8000-000000000001", )"
            R"("actionSet": "DD00DD00-0000-4000-8000-00000000000D"})"
            "\n");
}

TEST(TranscriptTest, WritesAMessageWithoutItsText) {
  NDSystemLogMessage message;
  message.set("Facility", "f");
  message.set("Level", "3");
  EXPECT_EQ(jsonLine(transcriptOf(message)), "{\"Level\": \"3\", \"Facility\": \"f\"}\n");
  message.set("Message", "");
  EXPECT_EQ(jsonLine(transcriptOf(message)),
            "{\"Level\": \"3\", \"Facility\": \"f\", \"Message\": \"\"}\n");
}

TEST(TranscriptTest, WritesTheEndMarker) {
  EXPECT_EQ(jsonLine(transcriptOf(SyncChange{"2", nullptr, "2"})),
            "{\"after\": \"2\", \"object\": null, \"postAnchor\": \"2\"}\n");
  EXPECT_EQ(jsonLine(transcriptOf(SyncChange{nullptr, nullptr, nullptr})),
            "{\"after\": null, \"object\": null, \"postAnchor\": null}\n");
}

}  // namespace
}  // namespace nidus
