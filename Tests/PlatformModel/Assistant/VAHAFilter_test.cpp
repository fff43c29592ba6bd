#include "PlatformModel/Assistant/VAHAFilter.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(VAHASearchCriteriaFilterTest, SaysItsClassAndNothingElse) {
  const VAHASearchCriteriaFilter filter;
  EXPECT_EQ(filter.encodedClassName(), "VAHASearchCriteriaFilter");
  EXPECT_EQ(filter.description(), "VAHASearchCriteriaFilter {}");
}

TEST(VAHASearchCriteriaFilterTest, DescribesWhatIsSet) {
  VAHASearchCriteriaFilter filter;
  filter.setRoomName("Hall");
  filter.setHomeName("");
  EXPECT_EQ(filter.description(), R"(VAHASearchCriteriaFilter {homeName: "", roomName: "Hall"})");
}

TEST(VAHASearchCriteriaFilterTest, DescribesEveryField) {
  VAHASearchCriteriaFilter filter;
  filter.setHomeName("1");
  filter.setEntityType("2");
  filter.setAttribute("3");
  filter.setServiceType("4");
  filter.setRoomName("5");
  filter.setZoneName("6");
  filter.setGroupName("7");
  filter.setServiceName("8");
  filter.setSceneName("9");
  EXPECT_EQ(filter.description(),
            R"(VAHASearchCriteriaFilter {homeName: "1", entityType: "2", attribute: "3", )"
            R"(serviceType: "4", roomName: "5", zoneName: "6", groupName: "7", )"
            R"(serviceName: "8", sceneName: "9"})");
}

TEST(VAHASearchCriteriaFilterTest, DescriptionKeepsToOneLine) {
  VAHASearchCriteriaFilter filter;
  filter.setRoomName("a\nb\r\"c\"\\");
  EXPECT_EQ(filter.description(), R"(VAHASearchCriteriaFilter {roomName: "a\nb\r\"c\"\\"})");
}

TEST(VAHASearchCriteriaFilterTest, ReadsBackEachField) {
  VAHASearchCriteriaFilter filter;
  EXPECT_FALSE(filter.homeName());
  filter.setHomeName("h");
  filter.setEntityType("e");
  filter.setZoneName("z");
  EXPECT_EQ(filter.homeName(), "h");
  EXPECT_EQ(filter.entityType(), "e");
  EXPECT_EQ(filter.zoneName(), "z");
  EXPECT_FALSE(filter.sceneName());
}

TEST(VAHAIdentifierFilterTest, DescribesItsIdentifiers) {
  VAHAIdentifierFilter filter;
  EXPECT_EQ(filter.encodedClassName(), "VAHAIdentifierFilter");
  EXPECT_EQ(filter.description(), "VAHAIdentifierFilter {}");
  filter.setIdentifiers({NDURL::fromText("a:b"), NDURL::fromText("c:d")});
  EXPECT_EQ(filter.description(), R"(VAHAIdentifierFilter {"a:b", "c:d"})");
}

}  // namespace
}  // namespace nidus
