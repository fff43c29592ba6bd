#include "nidus/Orders/NearMiss.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(NearMissTest, FindsTheNearestWord) {
  struct Case {
    std::string_view word;
    std::string_view nearest;
  };
  const std::vector<std::string_view> known = {"HUE", "POWER", "HEAT", "HEATER", "BRIGHTNESS"};
  for (const Case& tried :
       {Case{"BRIGTNESS", "BRIGHTNESS"}, Case{"POWRE", "POWER"}, Case{"HET", "HEAT"},
        Case{"HEATE", "HEAT"}, Case{"HEATR", "HEAT"}, Case{"POWERR", "POWER"}, Case{"COLOUR", ""},
        Case{"X", ""}, Case{"", ""}}) {
    SCOPED_TRACE(tried.word);
    EXPECT_EQ(nearMiss(tried.word, known), tried.nearest);
  }
}

TEST(NearMissTest, PassesOverAccentsAndCase) {
  const std::vector<std::string_view> known = {"Study", "Café Corner", "Soirée", "Élan"};
  EXPECT_EQ(nearMiss("soiree", known), "Soirée");
  EXPECT_EQ(nearMiss("cafe corner", known), "Café Corner");
  EXPECT_EQ(nearMiss("CAFE CORNR", known), "Café Corner");
  EXPECT_EQ(nearMiss("élna", known), "Élan");
}

TEST(NearMissTest, KnowsNoWordAmongNone) { EXPECT_EQ(nearMiss("HEAT", {}), ""); }

}  // namespace
}  // namespace nidus
