#include "nidus/Answers/Answer.h"

#include <gmock/gmock.h>

#include "nidus/Answers/AnswerTest.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;
using ::testing::StartsWith;

const Order kGetBrightness = orderOf(Order::Kind::get, "BRIGHTNESS");

TEST_F(AnswerTest, ShowsObjectsWithValuesAndOutcomes) {
  const NDDictionary reply =
      replyOf({{.name = "Ceiling Light", .value = integerForm(65, "PERCENTAGE")},
               {.name = "Café Lamp", .outcome = "UNREACHABLE", .room = "Café Corner"}});
  EXPECT_EQ(answer(kGetBrightness, {{reply}}),
            "OBJECT         ROOM         HOME   BRIGHTNESS  OUTCOME\n"
            "Ceiling Light  Kitchen      Cabin  65 %        ok\n"
            "Café Lamp      Café Corner  Cabin              unreachable\n"
            "1 light read, 1 unreachable: Café Lamp\n");
}

TEST_F(AnswerTest, TellsNamesakesOfTwoHomesApart) {
  const NDDictionary reply =
      replyOf({{.name = "Lamp", .value = integerForm(1), .home = "Cabin"},
               {.name = "Lamp", .value = integerForm(2), .home = "Beach House"}});
  const std::string text = answer(kGetBrightness, {{reply}});
  EXPECT_THAT(text, HasSubstr("Lamp    Kitchen  Cabin        1 %"));
  EXPECT_THAT(text, HasSubstr("Lamp    Kitchen  Beach House  2 %"));
}

TEST_F(AnswerTest, LeavesOutWhatNoObjectHas) {
  const NDDictionary reply = replyOf(
      {{.name = "Soirée", .value = booleanForm(true), .room = "", .home = "", .type = "SCENE"}});
  EXPECT_EQ(answer(orderOf(Order::Kind::run, "ENABLED"), {{reply}}),
            "OBJECT  OUTCOME\n"
            "Soirée  ok\n"
            "1 scene run\n");
}

TEST_F(AnswerTest, NamesWhatHasNoName) {
  EXPECT_THAT(answer(kGetBrightness, {{replyOf({{.name = ""}})}}), HasSubstr("(no name)"));
}

TEST_F(AnswerTest, ShowsNoControlCharactersOfNames) {
  const NDDictionary reply = replyOf({{.name = "La\x1b[31mmp",
                                       .outcome = "UNREACHABLE",
                                       .room = "a\nb",
                                       .home = "\xc2\x9b"
                                               "c"}});
  const std::string text = answer(kGetBrightness, {{reply}});
  EXPECT_THAT(text, HasSubstr("La\\x1b[31mmp"));
  EXPECT_THAT(text, HasSubstr("a\\x0ab"));
  EXPECT_THAT(text, HasSubstr("\\xc2\\x9bc"));
  EXPECT_THAT(text, Not(HasSubstr("\x1b")));
}

TEST_F(AnswerTest, AddsColourAndSymbolsOnATerminal) {
  const NDDictionary reply = replyOf({{.name = "Lamp"},
                                      {.name = "Bulb", .outcome = "READ_ONLY"},
                                      {.name = "Away", .outcome = "UNREACHABLE"}});
  const std::string text = answer(orderOf(Order::Kind::set), {{reply}}, {true, 80});
  EXPECT_THAT(text, HasSubstr("\x1b[1mOBJECT\x1b[0m"));
  EXPECT_THAT(text, HasSubstr("\x1b[32m✓ ok\x1b[0m"));
  EXPECT_THAT(text, HasSubstr("\x1b[33m! read-only\x1b[0m"));
  EXPECT_THAT(text, HasSubstr("\x1b[31m✗ unreachable\x1b[0m"));
}

TEST_F(AnswerTest, ShortensOnANarrowTerminal) {
  const NDDictionary reply = replyOf({{.name = "A lamp of a very long name"}});
  const std::string text = answer(orderOf(Order::Kind::set), {{reply}}, {false, 40});
  EXPECT_THAT(text, HasSubstr("A lamp of a ve…"));
}

TEST_F(AnswerTest, ShowsTwoRepliesAsTwo) {
  const NDDictionary unlock = emptyReply(VAHACommandOutcomeREQUIRES_UNLOCKValue);
  const NDDictionary results = replyOf({{.name = "Lamp"}});
  const std::string expected =
      "Reply 1 of 2\n"
      "The device must be unlocked for this; unlock it (here: leave out --locked) and try again\n"
      "\n"
      "Reply 2 of 2\n"
      "OBJECT  ROOM     HOME   OUTCOME\n"
      "Lamp    Kitchen  Cabin  ok\n"
      "1 light set\n";
  EXPECT_EQ(answer(orderOf(Order::Kind::set), {{unlock, results}}), expected);
  EXPECT_EQ(answer(orderOf(Order::Kind::set), {{results, unlock}}), expected);
}

TEST_F(AnswerTest, SaysThatTheSecondReplyIsEmpty) {
  const std::string text =
      answer(orderOf(Order::Kind::set),
             {{replyOf({}), emptyReply(VAHACommandOutcomeREQUIRES_UNLOCKValue)}});
  EXPECT_THAT(text, HasSubstr("Reply 2 of 2\nNo object gave a result\n"));
  EXPECT_THAT(text, Not(HasSubstr("Nothing matches")));
}

TEST_F(AnswerTest, SaysSilence) {
  EXPECT_THAT(answer(orderOf(Order::Kind::run), {{}}), StartsWith("The plug-in gave no reply"));
  EXPECT_THAT(answer(orderOf(Order::Kind::limits), {{}, {}, {}}),
              StartsWith("The plug-in gave no reply"));
}

TEST_F(AnswerTest, CopesWithAReplyThatHasNothing) {
  const std::string text = answer(kGetBrightness, {{NDDictionary()}});
  EXPECT_THAT(text, StartsWith("The plug-in answered with an outcome unknown here"));
}

TEST_F(AnswerTest, BringsLimitsIntoOneTable) {
  const auto limit = [](const char* name, float value) {
    return ResultSpec{.name = name, .value = floatForm(value, "celsius"), .type = "THERMOSTAT"};
  };
  const std::vector<Replies> replies = {{replyOf({limit("Hall", 10), limit("Bath", 12)})},
                                        {replyOf({limit("Hall", 30)})},
                                        {replyOf({limit("Bath", 0.5F), limit("Hall", 0.5F)})}};
  EXPECT_EQ(answer(orderOf(Order::Kind::limits, "TEMPERATURE"), replies),
            "OBJECT  ROOM     HOME   MINIMUM  MAXIMUM  STEP\n"
            "Hall    Kitchen  Cabin  10 °C    30 °C    0.5 °C\n"
            "Bath    Kitchen  Cabin  12 °C    none     0.5 °C\n"
            "2 thermostats with limits\n");
}

TEST_F(AnswerTest, KeepsLimitsOfNamesakesApart) {
  const auto limits = [](std::int64_t first, std::int64_t second) {
    return Replies{replyOf({{.name = "Lamp", .value = integerForm(first)},
                            {.name = "Lamp", .value = integerForm(second)}})};
  };
  EXPECT_EQ(answer(orderOf(Order::Kind::limits, "BRIGHTNESS"),
                   {limits(0, 1), limits(100, 99), limits(5, 2)}),
            "OBJECT  ROOM     HOME   MINIMUM  MAXIMUM  STEP\n"
            "Lamp    Kitchen  Cabin  0 %      100 %    5 %\n"
            "Lamp    Kitchen  Cabin  1 %      99 %     2 %\n"
            "2 lights with limits\n");
}

TEST_F(AnswerTest, CountsWhatHasNoLimitsApart) {
  const ResultSpec sensor = {.name = "Sensor"};
  const ResultSpec lamp = {.name = "Lamp", .value = integerForm(1)};
  const Replies replies = {replyOf({lamp, sensor})};
  EXPECT_EQ(answer(orderOf(Order::Kind::limits, "BRIGHTNESS"), {replies, replies, replies}),
            "OBJECT  ROOM     HOME   MINIMUM  MAXIMUM  STEP\n"
            "Lamp    Kitchen  Cabin  1 %      1 %      1 %\n"
            "Sensor  Kitchen  Cabin  none     none     none\n"
            "1 light with limits, 1 without limits: Sensor\n");
}

TEST_F(AnswerTest, SaysThatThereAreNoLimits) {
  EXPECT_EQ(answer(orderOf(Order::Kind::limits), {{replyOf({})}, {replyOf({})}, {replyOf({})}}),
            "Nothing with limits matches; see why with nidus explain and the same words\n");
}

TEST_F(AnswerTest, SaysOnceThatLimitsWereRefused) {
  const Replies refusal = {emptyReply(VAHACommandOutcomeCOMMAND_FAILUREValue)};
  EXPECT_EQ(answer(orderOf(Order::Kind::limits), {refusal, refusal, refusal}),
            "The plug-in refused the order; when there are several homes and none is primary, "
            "name one with --home\n");
}

}  // namespace
}  // namespace nidus
