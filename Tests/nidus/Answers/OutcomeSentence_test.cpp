#include "nidus/Answers/AnswerTest.h"

namespace nidus {
namespace {

using OutcomeSentenceTest = AnswerTest;

ResultSpec unreachable(const std::string& name) { return {.name = name, .outcome = "UNREACHABLE"}; }

VAHAValueRef on() {
  const auto value = VAHABooleanValue::booleanValue();
  value->setValue(true);
  return value;
}

struct SentenceCase {
  Order order;
  std::vector<ResultSpec> results;
  const char* sentence;
};

TEST_F(OutcomeSentenceTest, SaysWhatBecameOfEachKindOfOrder) {
  const SentenceCase table[] = {
      {orderOf(Order::Kind::get), {{.name = "A"}}, "1 light read"},
      {orderOf(Order::Kind::set), {{.name = "A"}, {.name = "B"}}, "2 lights set"},
      {orderOf(Order::Kind::raise), {{.name = "A"}}, "1 light raised"},
      {orderOf(Order::Kind::lower), {{.name = "A"}}, "1 light lowered"},
      {orderOf(Order::Kind::toggle), {{.name = "A"}}, "1 light toggled"},
      {orderOf(Order::Kind::run), {{.name = "A", .type = "SCENE"}}, "1 scene run"},
      {orderOf(Order::Kind::ask, "POWER", on()),
       {{.name = "A"}, {.name = "B"}, unreachable("C")},
       "2 lights whose POWER is on, 1 unreachable: C"},
      {orderOf(Order::Kind::ask, "LOCKED", on()),
       {{.name = "A", .type = "LOCK"}},
       "1 lock whose LOCKED is yes"},
      {orderOf(Order::Kind::ask, "POWER", on()),
       {unreachable("C")},
       "No light whose POWER is on, 1 unreachable: C"},
  };
  for (const SentenceCase& item : table) {
    EXPECT_EQ(sentence(item.order, replyOf(item.results)), item.sentence);
  }
}

TEST_F(OutcomeSentenceTest, NamesWhatDidNotSucceed) {
  const ResultSpec readOnly = {.name = "B", .outcome = "READ_ONLY"};
  const ResultSpec failed = {.name = "F", .outcome = "FAILURE"};
  const ResultSpec strange = {.name = "S", .outcome = "TOO_LATE"};
  const SentenceCase table[] = {
      {orderOf(Order::Kind::set),
       {{.name = "A"}, {.name = "D"}, {.name = "E"}, unreachable("Café lamp")},
       "3 lights set, 1 unreachable: Café lamp"},
      {orderOf(Order::Kind::set), {unreachable("Away")}, "No light set, 1 unreachable: Away"},
      {orderOf(Order::Kind::set),
       {failed, readOnly, unreachable("X"), unreachable("Y"), {.name = "A"}},
       "1 light set, 2 unreachable: X, Y, 1 read-only: B, 1 failed: F"},
      {orderOf(Order::Kind::toggle), {strange}, "No light toggled, 1 too late: S"},
      {orderOf(Order::Kind::set),
       {unreachable("1"), unreachable("2"), unreachable("3"), unreachable("4"), unreachable("5"),
        unreachable("6")},
       "No light set, 6 unreachable: 1, 2, 3, 4 and 2 more"},
  };
  for (const SentenceCase& item : table) {
    EXPECT_EQ(sentence(item.order, replyOf(item.results)), item.sentence);
  }
}

TEST_F(OutcomeSentenceTest, PointsToTheLimitsOfARefusedNumber) {
  const ResultSpec failed = {.name = "F", .outcome = "FAILURE"};
  const SentenceCase table[] = {
      {orderOf(Order::Kind::set, "BRIGHTNESS"),
       {{.name = "A"}, failed, unreachable("U")},
       "1 light set, 1 unreachable: U, 1 failed: F; the value may be beyond the limits, see nidus "
       "limits BRIGHTNESS"},
      {orderOf(Order::Kind::set, "BRIGHTNESS"),
       {unreachable("U")},
       "No light set, 1 unreachable: U"},
      {orderOf(Order::Kind::set, "POWER"), {failed}, "No light set, 1 failed: F"},
      {orderOf(Order::Kind::get, "BRIGHTNESS"), {failed}, "No light read, 1 failed: F"},
  };
  for (const SentenceCase& item : table) {
    EXPECT_EQ(sentence(item.order, replyOf(item.results)), item.sentence);
  }
}

struct NounCase {
  std::vector<const char*> types;
  const char* sentence;
};

TEST_F(OutcomeSentenceTest, CountsInPlainEnglish) {
  const NounCase table[] = {
      {{"SWITCH", "SWITCH"}, "2 switches read"},
      {{"BATTERY", "BATTERY"}, "2 batteries read"},
      {{"GARAGE_DOOR"}, "1 garage door read"},
      {{"GARAGE_DOOR", "GARAGE_DOOR"}, "2 garage doors read"},
      {{"TRAY", "TRAY"}, "2 trays read"},
      {{"LIGHT", "OUTLET"}, "2 objects read"},
      {{"CUSTOM", "CUSTOM"}, "2 objects read"},
      {{""}, "1 service read"},
  };
  for (const NounCase& item : table) {
    std::vector<ResultSpec> results;
    for (const char* type : item.types) results.push_back({.name = "A", .type = type});
    EXPECT_EQ(sentence(orderOf(Order::Kind::get), replyOf(results)), item.sentence);
  }
}

struct OutcomeCase {
  Order order;
  std::string_view outcome;
  const char* sentence;
};

TEST_F(OutcomeSentenceTest, SaysEachOutcomeWithARemedy) {
  const OutcomeCase table[] = {
      {orderOf(Order::Kind::get), VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue,
       "Nothing matches; see why with nidus explain and the same words"},
      {orderOf(Order::Kind::ask, "POWER", on()), VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue,
       "Nothing matches whose POWER is on; see why with nidus explain and the same words"},
      {orderOf(Order::Kind::toggle), VAHACommandOutcomeCOMMAND_FAILUREValue,
       "The plug-in refused the order; when there are several homes and none is primary, name one "
       "with --home"},
      {orderOf(Order::Kind::set), VAHACommandOutcomeREQUIRES_UNLOCKValue,
       "The device must be unlocked for this; unlock it (here: leave out --locked) and try again"},
      {orderOf(Order::Kind::set), VAHACommandOutcomeCOMMAND_SUCCESSValue,
       "No object gave a result"},
      {orderOf(Order::Kind::set), "LATER",
       "The plug-in answered with an outcome unknown here: LATER"},
  };
  for (const OutcomeCase& item : table) {
    EXPECT_EQ(sentence(item.order, emptyReply(item.outcome)), item.sentence);
  }
}

}  // namespace
}  // namespace nidus
