#include "PlatformModel/System/NDArray.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(NDArrayTest, DefaultIsEmpty) {
  const NDArray<int> none;
  EXPECT_TRUE(none.empty());
  EXPECT_EQ(none.size(), 0U);
  EXPECT_EQ(none.begin(), none.end());
}

TEST(NDArrayTest, KeepsOrderAndDuplicates) {
  const auto one = std::make_shared<int>(1);
  const auto two = std::make_shared<int>(2);
  const NDArray<int> list = {two, one, two};
  ASSERT_EQ(list.size(), 3U);
  EXPECT_EQ(list[0], two);
  EXPECT_EQ(list[1], one);
  EXPECT_EQ(list[2], two);
}

TEST(NDArrayTest, CopiesShareElementsAndKeepThem) {
  std::weak_ptr<int> element;
  NDArray<int> copy;
  {
    const NDArray<int> list = {std::make_shared<int>(7)};
    element = list[0];
    copy = list;
    EXPECT_EQ(copy.begin(), list.begin());
  }
  EXPECT_FALSE(element.expired());
  copy = {};
  EXPECT_TRUE(element.expired());
}

}  // namespace
}  // namespace nidus
