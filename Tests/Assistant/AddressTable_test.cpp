#include "Assistant/AddressTable.h"

#include <gtest/gtest.h>

#include <array>
#include <cstddef>

namespace nidus {
namespace {

TEST(AddressTableTest, FindsWhatWasSet) {
  std::array<int, 1000> objects{};
  AddressTable<int> table(objects.size());
  for (std::size_t i = 0; i < objects.size(); ++i) table[&objects[i]] = static_cast<int>(i) + 1;
  for (std::size_t i = 0; i < objects.size(); ++i) {
    EXPECT_EQ(table.find(&objects[i]), static_cast<int>(i) + 1);
  }
}

TEST(AddressTableTest, GivesAnEmptyValueForOthers) {
  const std::array<int, 100> objects{};
  AddressTable<int> table(50);
  for (std::size_t i = 0; i < 50; ++i) table[&objects[i]] = 1;
  for (std::size_t i = 50; i < 100; ++i) EXPECT_EQ(table.find(&objects[i]), 0);
}

TEST(AddressTableTest, KeepsOneValueOfAnObject) {
  const int object = 0;
  AddressTable<int> table(1);
  table[&object] = 1;
  table[&object] += 2;
  EXPECT_EQ(table.find(&object), 3);
}

TEST(AddressTableTest, MayHaveRoomForNothing) {
  const int object = 0;
  EXPECT_EQ(AddressTable<int>(0).find(&object), 0);
}

}  // namespace
}  // namespace nidus
