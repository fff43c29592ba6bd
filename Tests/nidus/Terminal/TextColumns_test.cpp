#include "nidus/Terminal/TextColumns.h"

#include <gmock/gmock.h>

namespace nidus {
namespace {

TEST(TextColumnsTest, FillsTheWidthFromTopToBottom) {
  EXPECT_EQ(inColumns({"one", "two", "three", "four", "five"}, 16),
            "one    four\ntwo    five\nthree\n");
  EXPECT_EQ(inColumns({"one", "two"}, 80), "one  two\n");
}

TEST(TextColumnsTest, CountsCellsNotBytes) {
  EXPECT_EQ(inColumns({"Café", "Bar"}, 10), "Café  Bar\n");
}

TEST(TextColumnsTest, PutsTextsBelowEachOtherWithoutRoom) {
  EXPECT_EQ(inColumns({"one", "two"}, 0), "one\ntwo\n");
  EXPECT_EQ(inColumns({"one", "two"}, 4), "one\ntwo\n");
  EXPECT_EQ(inColumns({}, 80), "");
}

}  // namespace
}  // namespace nidus
