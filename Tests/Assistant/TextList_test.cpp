#include "Assistant/TextList.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <initializer_list>
#include <vector>

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST(TextListTest, IsEmptyAtFirst) {
  EXPECT_THAT(TextList(), IsEmpty());
  EXPECT_TRUE(TextList(std::initializer_list<NDString>()).empty());
}

TEST(TextListTest, KeepsOrderAndDuplicates) {
  TextList list = {"b", "a"};
  list.append("b");
  EXPECT_THAT(list, ElementsAre("b", "a", "b"));
}

TEST(TextListTest, GrowsFromNothing) {
  TextList list;
  list.append("a");
  EXPECT_THAT(list, ElementsAre("a"));
}

TEST(TextListTest, LeavesOtherCopiesAsTheyAre) {
  const TextList list = {"a"};
  TextList longer = list;
  longer.append("b");
  EXPECT_THAT(list, ElementsAre("a"));
  EXPECT_THAT(longer, ElementsAre("a", "b"));
}

TEST(TextListTest, SharesItsTexts) {
  const TextList list = {"a"};
  const std::vector<TextList> copies(2, list);
  EXPECT_EQ(copies.back().begin(), list.begin());
}

}  // namespace
}  // namespace nidus
