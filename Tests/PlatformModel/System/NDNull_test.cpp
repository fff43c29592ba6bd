#include "PlatformModel/System/NDNull.h"

#include <gtest/gtest.h>

#include "PlatformModel/System/NDArray.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {
namespace {

/// An object with one property of each kind.
class Lamp {
 public:
  [[nodiscard]] const NDString& name() const { return name_; }
  [[nodiscard]] const NDArray<int>& levels() const { return levels_; }
  [[nodiscard]] std::shared_ptr<Lamp> next() const { return next_; }
  [[nodiscard]] bool isOn() const { return true; }
  [[nodiscard]] int levelPercent() const { return 40; }

  std::shared_ptr<Lamp> next_;

 private:
  NDString name_ = "Lamp";
  NDArray<int> levels_ = {std::make_shared<int>(1)};
};

TEST(PropertyTest, NullObjectGivesNeutralValue) {
  const std::shared_ptr<Lamp> none;
  EXPECT_FALSE(property(none, &Lamp::name));
  EXPECT_TRUE(property(none, &Lamp::levels).empty());
  EXPECT_EQ(property(none, &Lamp::next), nullptr);
  EXPECT_FALSE(property(none, &Lamp::isOn));
  EXPECT_EQ(property(none, &Lamp::levelPercent), 0);
}

TEST(PropertyTest, ObjectGivesItsProperty) {
  const auto lamp = std::make_shared<Lamp>();
  EXPECT_EQ(property(lamp, &Lamp::name), "Lamp");
  EXPECT_EQ(&property(lamp, &Lamp::levels), &lamp->levels());
  EXPECT_TRUE(property(lamp, &Lamp::isOn));
  EXPECT_EQ(property(lamp, &Lamp::levelPercent), 40);
}

TEST(PropertyTest, NullPropagatesThroughChain) {
  const auto lamp = std::make_shared<Lamp>();
  lamp->next_ = std::make_shared<Lamp>();
  EXPECT_EQ(property(property(lamp, &Lamp::next), &Lamp::name), "Lamp");
  const auto afterLast = property(property(lamp, &Lamp::next), &Lamp::next);
  EXPECT_FALSE(property(property(afterLast, &Lamp::next), &Lamp::name));
}

TEST(PropertyTest, TakesPlainPointers) {
  const Lamp lamp;
  const Lamp* pointer = &lamp;
  EXPECT_EQ(property(pointer, &Lamp::levelPercent), 40);
  pointer = nullptr;
  EXPECT_EQ(property(pointer, &Lamp::levelPercent), 0);
}

}  // namespace
}  // namespace nidus
