#include "HomePlatform/Json/JsonPath.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(AppendPointerStepTest, EscapesTildeAndSlash) {
  std::string place = "/a";
  appendPointerStep(place, "x~y/z~1");
  EXPECT_EQ(place, "/a/x~0y~1z~01");
}

TEST(AppendPointerStepTest, KeepsEmptyKey) {
  std::string place;
  appendPointerStep(place, "");
  EXPECT_EQ(place, "/");
}

TEST(JsonPathTest, FollowsObjectsAndArrays) {
  JsonPath path("/base");
  EXPECT_EQ(path.place(), "/base");
  path.enterObject();
  path.setKey("list");
  path.enterArray();
  path.endValue();
  path.endValue();
  EXPECT_EQ(path.place(), "/base/list/2");
  EXPECT_EQ(path.depth(), 2U);
  path.leave();
  EXPECT_EQ(path.place(), "/base/list");
}

TEST(JsonPathTest, StandsAtObjectBetweenItsKeys) {
  JsonPath path;
  path.enterObject();
  EXPECT_EQ(path.place(), "");
  path.setKey("");
  EXPECT_EQ(path.place(), "/");
  path.endValue();
  EXPECT_EQ(path.place(), "");
  EXPECT_EQ(path.index(), 1U);
}

}  // namespace
}  // namespace nidus
