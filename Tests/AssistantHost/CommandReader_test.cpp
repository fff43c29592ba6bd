#include "AssistantHost/CommandReader.h"

#include <gtest/gtest.h>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "PlatformModel/Assistant/VAHAValue.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {
namespace {

CommandRef commandOf(const std::string& text) {
  const auto command = readCommand(text, "test");
  EXPECT_TRUE(command) << command.failure().message;
  return command ? *command : nullptr;
}

TEST(CommandReaderTest, ReadsEverySearchField) {
  const auto command = commandOf(
      R"({"filter": {"search": {"homeName": "a", "entityType": "b", "attribute": "c",
          "serviceType": "d", "roomName": "e", "zoneName": "f", "groupName": "g",
          "serviceName": "h", "sceneName": "i"}}})");
  const auto& filter = dynamic_cast<const VAHASearchCriteriaFilter&>(*command->filter());
  EXPECT_EQ(filter.homeName(), "a");
  EXPECT_EQ(filter.entityType(), "b");
  EXPECT_EQ(filter.attribute(), "c");
  EXPECT_EQ(filter.serviceType(), "d");
  EXPECT_EQ(filter.roomName(), "e");
  EXPECT_EQ(filter.zoneName(), "f");
  EXPECT_EQ(filter.groupName(), "g");
  EXPECT_EQ(filter.serviceName(), "h");
  EXPECT_EQ(filter.sceneName(), "i");
}

TEST(CommandReaderTest, LeavesAbsentFieldsNull) {
  const auto command = commandOf(R"({"filter": {"search": {"roomName": null}}, "actions": [{}]})");
  const auto& filter = dynamic_cast<const VAHASearchCriteriaFilter&>(*command->filter());
  EXPECT_FALSE(filter.roomName());
  EXPECT_FALSE(filter.sceneName());
  ASSERT_EQ(command->actions().size(), 1U);
  EXPECT_FALSE(command->actions()[0]->actionType());
  EXPECT_FALSE(command->actions()[0]->attribute());
  EXPECT_FALSE(command->actions()[0]->value());
}

TEST(CommandReaderTest, KeepsEmptyTextsApartFromNone) {
  const auto command = commandOf(R"({"filter": {"search": {"roomName": ""}}})");
  const auto& filter = dynamic_cast<const VAHASearchCriteriaFilter&>(*command->filter());
  EXPECT_EQ(filter.roomName(), "");
}

TEST(CommandReaderTest, TakesAnEmptyCommand) {
  const auto command = commandOf("{}");
  EXPECT_FALSE(command->filter());
  EXPECT_TRUE(command->actions().empty());
  EXPECT_FALSE(commandOf(R"({"filter": null, "actions": null})")->filter());
}

TEST(CommandReaderTest, ReadsIdentifiersAsTheyStand) {
  const auto command =
      commandOf(R"({"filter": {"identifiers": ["x-corvane-nidus://a", "b", "b"]}})");
  EXPECT_EQ(command->filter()->encodedClassName(), VAHAIdentifierFilterClassIdentifier);
  const auto& filter = dynamic_cast<const VAHAIdentifierFilter&>(*command->filter());
  ASSERT_EQ(filter.identifiers().size(), 3U);
  EXPECT_EQ(filter.identifiers()[0].text(), "x-corvane-nidus://a");
  EXPECT_EQ(filter.identifiers()[2].text(), "b");
}

TEST(CommandReaderTest, KeepsTheOrderOfActions) {
  const auto command = commandOf(
      R"({"actions": [{"actionType": "GET", "attribute": "POWER"}, {"actionType": "DANCE"}]})");
  ASSERT_EQ(command->actions().size(), 2U);
  EXPECT_EQ(command->actions()[0]->actionType(), "GET");
  EXPECT_EQ(command->actions()[0]->attribute(), "POWER");
  EXPECT_EQ(command->actions()[1]->actionType(), "DANCE");
}

VAHAValueRef valueOf(const std::string& value) {
  const auto command = commandOf(R"({"actions": [{"value": )" + value + "}]}");
  return command ? command->actions()[0]->value() : nullptr;
}

TEST(CommandReaderTest, ReadsABoolean) {
  const auto value = valueOf(R"({"boolean": true})");
  EXPECT_TRUE(dynamic_cast<const VAHABooleanValue&>(*value).value());
  EXPECT_FALSE(value->units());
}

TEST(CommandReaderTest, ReadsIntegersOf64Bits) {
  EXPECT_EQ(dynamic_cast<const VAHAIntegerValue&>(*valueOf(R"({"integer": 9223372036854775807})"))
                .value(),
            INT64_MAX);
  EXPECT_EQ(dynamic_cast<const VAHAIntegerValue&>(*valueOf(R"({"integer": -9223372036854775808})"))
                .value(),
            INT64_MIN);
}

TEST(CommandReaderTest, ReadsFloatsWithoutFractionToo) {
  EXPECT_EQ(dynamic_cast<const VAHAFloatValue&>(*valueOf(R"({"float": 21.5})")).value(), 21.5F);
  EXPECT_EQ(dynamic_cast<const VAHAFloatValue&>(*valueOf(R"({"float": 21})")).value(), 21.0F);
}

TEST(CommandReaderTest, ReadsTextWithUnits) {
  const auto value = valueOf(R"({"units": "CELSIUS", "string": "HEAT"})");
  EXPECT_EQ(dynamic_cast<const VAHAStringValue&>(*value).value(), "HEAT");
  EXPECT_EQ(value->units(), "CELSIUS");
}

struct BadCommand {
  const char* label;
  const char* text;
  const char* place;
};

TEST(CommandReaderTest, NamesThePlaceOfWhatIsWrong) {
  const BadCommand table[] = {
      {"a list", "[]", ""},
      {"a number", "5", ""},
      {"unknown key", R"({"filters": {}})", "/filters"},
      {"filter is a text", R"({"filter": "all"})", "/filter"},
      {"filter of no kind", R"({"filter": {}})", "/filter"},
      {"filter of two kinds", R"({"filter": {"search": {}, "identifiers": []}})", "/filter"},
      {"filter of two kinds, one null", R"({"filter": {"search": null, "identifiers": []}})",
       "/filter"},
      {"null search", R"({"filter": {"search": null}})", "/filter/search"},
      {"unknown key beside the kind", R"({"filter": {"search": {}, "more": 1}})", "/filter/more"},
      {"unknown search key", R"({"filter": {"search": {"room": "a"}}})", "/filter/search/room"},
      {"search field no text", R"({"filter": {"search": {"roomName": 5}}})",
       "/filter/search/roomName"},
      {"identifiers no list", R"({"filter": {"identifiers": "x"}})", "/filter/identifiers"},
      {"identifier no text", R"({"filter": {"identifiers": ["x", null]}})",
       "/filter/identifiers/1"},
      {"actions no list", R"({"actions": {}})", "/actions"},
      {"action null", R"({"actions": [null]})", "/actions/0"},
      {"unknown action key", R"({"actions": [{}, {"type": "GET"}]})", "/actions/1/type"},
      {"action type no text", R"({"actions": [{"actionType": true}]})", "/actions/0/actionType"},
      {"bare value", R"({"actions": [{"value": true}]})", "/actions/0/value"},
      {"value of no kind", R"({"actions": [{"value": {"units": "CELSIUS"}}]})", "/actions/0/value"},
      {"value of two kinds", R"({"actions": [{"value": {"boolean": true, "integer": 1}}]})",
       "/actions/0/value"},
      {"unknown value key", R"({"actions": [{"value": {"boolean": true, "unit": "x"}}]})",
       "/actions/0/value/unit"},
      {"null boolean", R"({"actions": [{"value": {"boolean": null}}]})",
       "/actions/0/value/boolean"},
      {"null integer", R"({"actions": [{"value": {"integer": null}}]})",
       "/actions/0/value/integer"},
      {"null float", R"({"actions": [{"value": {"float": null}}]})",
       "/actions/0/value/float: expected a number"},
      {"null string", R"({"actions": [{"value": {"string": null}}]})", "/actions/0/value/string"},
      {"boolean as number", R"({"actions": [{"value": {"boolean": 1}}]})",
       "/actions/0/value/boolean"},
      {"integer with fraction", R"({"actions": [{"value": {"integer": 5.0}}]})",
       "/actions/0/value/integer"},
      {"integer with exponent", R"({"actions": [{"value": {"integer": 5e0}}]})",
       "/actions/0/value/integer"},
      {"float as text", R"({"actions": [{"value": {"float": "5"}}]})",
       "/actions/0/value/float: expected a number"},
      {"float as boolean", R"({"actions": [{"value": {"float": true}}]})",
       "/actions/0/value/float"},
      {"string as number", R"({"actions": [{"value": {"string": 5}}]})", "/actions/0/value/string"},
      {"units no text", R"({"actions": [{"value": {"float": 5, "units": 1}}]})",
       "/actions/0/value/units"},
      {"integer beyond 64 bits", R"({"actions": [{"value": {"integer": 9223372036854775808}}]})",
       "/actions/0/value/integer"},
      {"float beyond 32 bits", R"({"actions": [{"value": {"float": 1e39}}]})",
       "/actions/0/value/float"},
  };
  for (const BadCommand& bad : table) {
    SCOPED_TRACE(bad.label);
    const auto command = readCommand(bad.text, "test.json");
    ASSERT_FALSE(command);
    EXPECT_EQ(command.failure().kind, Failure::Kind::badInput);
    const std::string place = std::string("test.json: ") + bad.place;
    EXPECT_EQ(command.failure().message.substr(0, place.size()), place);
  }
}

TEST(CommandReaderTest, RefusesTextThatIsNoJson) {
  for (const char* text :
       {"", "{", "{} {}", "{\"filter\": {}, \"filter\": {}}", "{\"a\xff\": 1}"}) {
    const auto command = readCommand(text, "test.json");
    ASSERT_FALSE(command) << text;
    EXPECT_EQ(command.failure().message.rfind("test.json: ", 0), 0U);
  }
}

}  // namespace
}  // namespace nidus
