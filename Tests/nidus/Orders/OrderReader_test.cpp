#include <gtest/gtest.h>

#include <vector>

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "nidus/Orders/OrderTexts.h"

namespace nidus {
namespace {

struct OrderCase {
  std::string line;
  std::string expected;
};

void expectActions(const std::vector<OrderCase>& cases) {
  for (const OrderCase& tried : cases) {
    SCOPED_TRACE(tried.line);
    EXPECT_EQ(actionsOf(tried.line), tried.expected);
  }
}

void expectFilters(const std::vector<OrderCase>& cases) {
  for (const OrderCase& tried : cases) {
    SCOPED_TRACE(tried.line);
    EXPECT_EQ(filterOf(tried.line), tried.expected);
  }
}

TEST(OrderReaderTest, ReadsEachVerb) {
  expectActions({
      {"get brightness", "GET BRIGHTNESS"},
      {"get", "GET"},
      {"get brightness --target", "GET_TARGET_VALUE BRIGHTNESS"},
      {"get power is on", "GET POWER boolean 1"},
      {"set power off", "SET POWER boolean 0"},
      {"set brightness minimum", "SET_TO_MINIMUM BRIGHTNESS"},
      {"set brightness Max", "SET_TO_MAXIMUM BRIGHTNESS"},
      {"raise brightness", "INCREASE BRIGHTNESS"},
      {"raise brightness 10%", "INCREASE BRIGHTNESS 10"},
      {"lower hue 7.5", "DECREASE HUE float 7.5"},
      {"toggle power", "TOGGLE POWER"},
      {"limits hue", "GET_MINIMUM HUE; GET_MAXIMUM HUE; GET_STEP_VALUE HUE"},
      {"run Soirée", "SET ENABLED boolean 1"},
  });
}

TEST(OrderReaderTest, TellsTheKindOfOrder) {
  const std::vector<std::pair<std::string, Order::Kind>> cases = {
      {"get power", Order::Kind::get},       {"get power is on", Order::Kind::ask},
      {"set power on", Order::Kind::set},    {"raise hue", Order::Kind::raise},
      {"lower hue", Order::Kind::lower},     {"toggle power", Order::Kind::toggle},
      {"limits hue", Order::Kind::limits},   {"run Soirée", Order::Kind::run},
      {"set hue maximum", Order::Kind::set},
  };
  for (const auto& [line, kind] : cases) {
    SCOPED_TRACE(line);
    const auto order = readOrder(orderWords(line), builtInVocabulary(), true);
    ASSERT_TRUE(order);
    EXPECT_EQ(order->kind, kind);
  }
}

TEST(OrderReaderTest, TakesAttributesHoweverTheyAreWritten) {
  expectActions({
      {"get POWER", "GET POWER"},
      {"get Air_Quality", "GET AIR_QUALITY"},
      {"get air-quality", "GET AIR_QUALITY"},
      {"get air quality", "GET AIR_QUALITY"},
      {"set climate mode heat", "SET CLIMATE_MODE text HEAT"},
      {"get air quality is good", "GET AIR_QUALITY text GOOD"},
  });
}

TEST(OrderReaderTest, RefusesWhatIsNoOrder) {
  expectActions({
      {"dim power", "dim: an order begins with get, set, raise, lower, toggle, limits or run"},
      {"set", "set: name the attribute; nidus vocabulary lists them"},
      {"set BRIGTNESS 3", "BRIGTNESS: did you mean BRIGHTNESS?"},
      {"get hug", "hug: did you mean HUE?"},
      {"get xyzzy", "xyzzy: there is no such attribute; see nidus vocabulary"},
      {"set power", "set POWER: name the value"},
      {"get power on", "on: to ask which objects have it, write get POWER is on"},
      {"get brightness was 3", "was 3: to ask which objects have it, write get BRIGHTNESS is 3"},
      {"get power somehow", "somehow: to ask which objects have it, write get POWER is VALUE"},
      {"get power is", "get POWER is: name the value"},
      {"get power is on --target",
       "--target: a question compares what is, not what was set; leave one out"},
      {"set power on --target", "--target: only get asks for the value that was set"},
      {"toggle power now", "now: nothing is expected after toggle POWER"},
      {"limits hue now", "now: nothing is expected after limits HUE"},
      {"toggle hue", "toggle HUE: it is not on or off; use nidus set"},
      {"raise power", "raise POWER: it is no number that can be raised or lowered; use nidus set"},
      {"lower climate_mode",
       "lower CLIMATE_MODE: it is no number that can be raised or lowered; use nidus set"},
      {"set motion on", "set MOTION: it can only be read; use nidus get"},
      {"get identify", "get IDENTIFY: it can only be set"},
      {"get motion --target", "get MOTION: it is never set; ask without --target"},
      {"run", "run: name the scene; nidus home show lists them"},
      {"run Soirée --scene Soirée", "run: name the scene once"},
  });
}

TEST(OrderReaderTest, NamesTheObjects) {
  expectFilters({
      {"get power", "entity=SERVICE"},
      {"get power --home Hut --room Hall --zone Up", "home=Hut room=Hall zone=Up entity=SERVICE"},
      {"get power --group Evening --service Lamp", "group=Evening service=Lamp entity=SERVICE"},
      {"get power --type air-purifier", "type=AIR_PURIFIER entity=SERVICE"},
      {"get --entity Room", "entity=ROOM"},
      {"set enabled on --scene Soirée", "scene=Soirée entity=SCENE"},
      {"run Soirée --home Hut", "home=Hut scene=Soirée entity=SCENE"},
      {"run --scene Soirée", "scene=Soirée entity=SCENE"},
  });
}

TEST(OrderReaderTest, RunsASceneOfSeveralWords) {
  OrderWords words;
  words.verb = "run";
  words.words = {"Good", "Night"};
  const auto order = readOrder(words, builtInVocabulary(), true);
  ASSERT_TRUE(order);
  EXPECT_EQ(
      dynamic_cast<const VAHASearchCriteriaFilter&>(*order->commands.front()->filter()).sceneName(),
      "Good Night");
}

TEST(OrderReaderTest, RefusesUnknownTypes) {
  expectFilters({
      {"get power --type ligth", "ligth: did you mean LIGHT?"},
      {"get power --type xyzzy", "xyzzy: there is no such type of service; see nidus vocabulary"},
      {"get --entity rom", "rom: did you mean ROOM?"},
      {"get --entity xyzzy",
       "xyzzy: there is no such kind of object; --entity takes home, room, zone, group, service, "
       "scene or trigger"},
      {"run Soirée --type ligth", "ligth: did you mean LIGHT?"},
  });
}

TEST(OrderReaderTest, ShowsAnEmptyWord) {
  OrderWords words;
  words.verb = "set";
  words.words = {""};
  const auto withoutAttribute = readOrder(words, builtInVocabulary(), true);
  ASSERT_FALSE(withoutAttribute);
  EXPECT_EQ(withoutAttribute.failure().message.find("\"\": there is no such attribute"), 0U);
  words.words = {"power", ""};
  const auto withoutValue = readOrder(words, builtInVocabulary(), true);
  ASSERT_FALSE(withoutValue);
  EXPECT_EQ(withoutValue.failure().message.find("\"\": POWER takes on or off"), 0U);
}

}  // namespace
}  // namespace nidus
