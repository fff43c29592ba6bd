#include "PlatformModel/Home/NDLookUp.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

/// Something with both kinds of identifiers.
class Thing {
 public:
  Thing(std::uint8_t number, std::int64_t instanceID) : instanceID_(instanceID) {
    uuid_ = NDUUID({number});
  }
  [[nodiscard]] const NDUUID& uuid() const { return uuid_; }
  [[nodiscard]] std::int64_t instanceID() const { return instanceID_; }

 private:
  NDUUID uuid_;
  std::int64_t instanceID_;
};

/// A characteristic that has nothing but its type.
class TypedCharacteristic : public NDCharacteristic {
 public:
  explicit TypedCharacteristic(NDString type) : type_(std::move(type)) {}
  [[nodiscard]] std::int64_t instanceID() const override { return 1; }
  [[nodiscard]] const NDString& characteristicType() const override { return type_; }
  [[nodiscard]] const std::vector<NDString>& properties() const override { return properties_; }
  [[nodiscard]] const std::shared_ptr<const NDCharacteristicMetadata>& metadata() const override {
    return metadata_;
  }
  [[nodiscard]] NDValueRef value() const override { return nullptr; }
  [[nodiscard]] std::shared_ptr<NDService> service() const override { return nullptr; }

 private:
  NDString type_;
  std::vector<NDString> properties_;
  std::shared_ptr<const NDCharacteristicMetadata> metadata_;
};

const NDArray<Thing>& things() {
  static const NDArray<Thing> kThings = {
      std::make_shared<Thing>(std::uint8_t{1}, 8), std::make_shared<Thing>(std::uint8_t{2}, 9),
      std::make_shared<Thing>(std::uint8_t{2}, 9), std::make_shared<Thing>(std::uint8_t{3}, -9)};
  return kThings;
}

TEST(FindInArrayByUUIDTest, GivesTheFirstMatch) {
  EXPECT_EQ(findInArrayByUUID(things(), NDUUID({2})), things()[1]);
  EXPECT_EQ(findInArrayByUUID(things(), NDUUID({3})), things()[3]);
}

TEST(FindInArrayByUUIDTest, GivesNullWithoutMatch) {
  EXPECT_EQ(findInArrayByUUID(things(), NDUUID({4})), nullptr);
  EXPECT_EQ(findInArrayByUUID(things(), std::nullopt), nullptr);
  EXPECT_EQ(findInArrayByUUID(NDArray<Thing>(), NDUUID({1})), nullptr);
}

TEST(FindInArrayByInstanceIDTest, GivesTheFirstMatch) {
  EXPECT_EQ(findInArrayByInstanceID(things(), 9), things()[1]);
  EXPECT_EQ(findInArrayByInstanceID(things(), -9), things()[3]);
}

TEST(FindInArrayByInstanceIDTest, GivesNullWithoutMatch) {
  EXPECT_EQ(findInArrayByInstanceID(things(), 0), nullptr);
  EXPECT_EQ(findInArrayByInstanceID(things(), std::nullopt), nullptr);
  EXPECT_EQ(findInArrayByInstanceID(NDArray<Thing>(), 8), nullptr);
}

TEST(FindInArrayByCharacteristicTypeTest, ComparesTypesExactly) {
  const NDArray<NDCharacteristic> list = {std::make_shared<TypedCharacteristic>("power"),
                                          std::make_shared<TypedCharacteristic>("level"),
                                          std::make_shared<TypedCharacteristic>("level")};
  EXPECT_EQ(findInArrayByCharacteristicType(list, "level"), list[1]);
  EXPECT_EQ(findInArrayByCharacteristicType(list, "Level"), nullptr);
  EXPECT_EQ(findInArrayByCharacteristicType(list, nullptr), nullptr);
}

}  // namespace
}  // namespace nidus
