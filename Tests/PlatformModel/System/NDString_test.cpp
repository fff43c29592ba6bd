#include "PlatformModel/System/NDString.h"

#include <gtest/gtest.h>

#include <string>
#include <unordered_set>

#include "PlatformModel/RunOnThreads.h"

namespace nidus {
namespace {

TEST(NDStringTest, NullDiffersFromEmptyText) {
  const NDString none;
  const NDString empty = "";
  EXPECT_FALSE(none);
  EXPECT_TRUE(empty);
  EXPECT_FALSE(none == empty);
  EXPECT_EQ(none.view(), empty.view());
}

TEST(NDStringTest, NullPointersMakeNull) {
  const char* const noCharacters = nullptr;
  EXPECT_FALSE(NDString(noCharacters));
  EXPECT_FALSE(NDString(nullptr));
  EXPECT_TRUE(NDString(std::string_view()));
}

TEST(NDStringTest, NullPointersEqualNullAlone) {
  const NDString none;
  EXPECT_TRUE(none == nullptr);
  EXPECT_FALSE(NDString("") == nullptr);
  EXPECT_FALSE(none == "");
}

TEST(NDStringTest, KeepsEveryCharacter) {
  const std::string text("a\0b\xFF", 4);
  EXPECT_EQ(NDString(text).str(), text);
  EXPECT_EQ(NDString(text).view().size(), 4U);
}

TEST(NDStringTest, CopiesShareTheCharacters) {
  const NDString original = "Kitchen";
  const NDString copy = original;  // NOLINT(performance-unnecessary-copy-initialization): the test
  EXPECT_EQ(copy.view().data(), original.view().data());
}

TEST(NDStringTest, CharactersOutliveTheOriginal) {
  NDString copy;
  std::string_view view;
  {
    const NDString original = std::string(100, 'x');
    view = original.view();
    copy = original;
  }
  EXPECT_EQ(view, std::string(100, 'x'));
}

TEST(NDStringTest, MovedFromTextIsNull) {
  NDString source = "Hall";
  const NDString constructed = std::move(source);
  EXPECT_FALSE(source);  // NOLINT(bugprone-use-after-move): the test
  NDString assigned = "Kitchen";
  source = "Attic";
  assigned = std::move(source);
  EXPECT_FALSE(source);  // NOLINT(bugprone-use-after-move): the test
  EXPECT_EQ(constructed, "Hall");
  EXPECT_EQ(assigned, "Attic");
}

TEST(NDStringTest, AssignmentToItselfKeepsText) {
  NDString text = "Hall";
  NDString& same = text;
  text = same;
  EXPECT_EQ(text, "Hall");
  text = std::move(same);
  EXPECT_EQ(text, "Hall");
}

TEST(NDStringTest, EqualityComparesCodePoints) {
  EXPECT_EQ(NDString("Caf\u00E9"), NDString("Caf\u00E9"));
  EXPECT_FALSE(NDString("Caf\u00E9") == NDString("Cafe\u0301"));
  EXPECT_FALSE(NDString("Hall") == NDString("hall"));
  EXPECT_EQ(NDString(), NDString());
}

TEST(NDStringTest, NullEqualsNoCharacters) {
  const char* const noText = "";
  EXPECT_FALSE(NDString() == noText);
  const std::string_view noCharacters;
  // NOLINTNEXTLINE(readability-container-size-empty): the comparison is what is tested
  EXPECT_FALSE(NDString() == noCharacters);
  EXPECT_EQ(NDString(""), "");
}

TEST(NDStringTest, EqualTextsHashAlike) {
  const std::unordered_set<NDString> names = {"Hall", "Attic"};
  EXPECT_EQ(names.count(std::string("Hall")), 1U);
  EXPECT_EQ(names.count("Cellar"), 0U);
}

TEST(NDStringTest, ThreadsCopyAndReleaseTogether) {
  const NDString text = "Kitchen";
  runOnThreads(4, [text](std::size_t) {
    for (int round = 0; round < 1000; ++round) {
      NDString copy;
      copy = text;
      ASSERT_EQ(copy, "Kitchen");
    }
  });
}

}  // namespace
}  // namespace nidus
