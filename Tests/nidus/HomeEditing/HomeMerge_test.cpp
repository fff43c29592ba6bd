#include "nidus/HomeEditing/HomeMerge.h"

#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

/// Three editions of the sample homes: as exported, as a person edited them, as they are by then.
class MergeEditTest : public ::testing::Test {
 protected:
  static CharacteristicData& brightness(std::vector<HomeData>& homes) {
    return homes[0].accessories[0].services[0].characteristics[1];
  }
  static void setBrightness(std::vector<HomeData>& homes, const NDValueRef& value) {
    brightness(homes).value = value;
    brightness(homes).deviceValue = value;
  }
  [[nodiscard]] std::string mergedBrightness() const {
    auto merged = mergeEdit(exported_, edited_, current_);
    if (!merged) return merged.failure().message;
    return description(brightness(*merged).value) + '/' +
           description(brightness(*merged).deviceValue);
  }

  std::vector<HomeData> exported_ = sampleHomes();
  std::vector<HomeData> edited_ = sampleHomes();
  std::vector<HomeData> current_ = sampleHomes();
};

TEST_F(MergeEditTest, GivesTheEditedHomes) {
  edited_[0].rooms[0].name = "Galley";
  edited_.pop_back();
  const auto merged = mergeEdit(exported_, edited_, current_);
  ASSERT_TRUE(merged) << merged.failure().message;
  EXPECT_EQ(textOf(*merged), textOf(edited_));
}

TEST_F(MergeEditTest, KeepsValuesThatChangedMeanwhile) {
  setBrightness(current_, NDValue::integer(77));
  EXPECT_EQ(mergedBrightness(), "77/77");
}

TEST_F(MergeEditTest, KeepsEachOfTheTwoValues) {
  brightness(current_).deviceValue = NDValue::integer(77);
  brightness(edited_).value = NDValue::integer(5);
  EXPECT_EQ(mergedBrightness(), "5/77");
}

TEST_F(MergeEditTest, TakesTheValueThatThePersonWrote) {
  setBrightness(edited_, NDValue::integer(5));
  EXPECT_EQ(mergedBrightness(), "5/5");
  setBrightness(current_, NDValue::integer(77));
  EXPECT_EQ(mergedBrightness(), "5/5");
}

TEST_F(MergeEditTest, KeepsValuesInANewFormat) {
  brightness(edited_).metadata->format = "float";
  setBrightness(edited_, NDValue::floating(40));
  setBrightness(current_, NDValue::integer(77));
  const auto merged = mergeEdit(exported_, edited_, current_);
  ASSERT_TRUE(merged);
  EXPECT_TRUE((*merged)[0].accessories[0].services[0].characteristics[1].value->isFloating());
  EXPECT_EQ(mergedBrightness(), "77/77");
}

TEST_F(MergeEditTest, KeepsTheEditWhereANewFormatCanNotHoldTheValue) {
  brightness(edited_).metadata->format = "uint8";
  setBrightness(current_, NDValue::integer(1000));
  EXPECT_EQ(mergedBrightness(), "40/40");
}

TEST_F(MergeEditTest, KeepsThatAValueWasForgotten) {
  setBrightness(current_, nullptr);
  EXPECT_EQ(mergedBrightness(), "(null)/(null)");
}

TEST_F(MergeEditTest, LeavesNewObjectsAsTheyAreWritten) {
  setBrightness(current_, NDValue::integer(77));
  edited_[0].uuid = NDUUID();
  EXPECT_EQ(mergedBrightness(), "40/40");
}

TEST_F(MergeEditTest, RefusesOtherChangesMeanwhile) {
  edited_[0].rooms[0].name = "Galley";
  current_[1].rooms.clear();
  EXPECT_THAT(mergeEdit(exported_, edited_, current_),
              IsBadInput("the homes were changed meanwhile (1 room removed); edit them again"));
  current_ = sampleHomes();
  std::swap(current_[0].rooms[0], current_[0].rooms[1]);
  EXPECT_THAT(mergeEdit(exported_, edited_, current_), IsBadInput("in another order"));
}

}  // namespace
}  // namespace nidus
