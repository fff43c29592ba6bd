#include "Assistant/ObjectURL.h"

#include <gtest/gtest.h>

#include <limits>

#include "Support/HomeBuilder.h"

namespace nidus {
namespace {

class ObjectURLTest : public ::testing::Test {
 protected:
  ObjectURLTest()
      : home_(HomeBuilder("Cabin")
                  .room("Kitchen")
                  .light("Lamp")
                  .serviceID(12)
                  .zone("Ground floor")
                  .group("Evening")
                  .scene("Good night")
                  .trigger("Sunset")
                  .build()) {}

  /// The identifier of an object whose path begins with `path`, in the home of the test.
  [[nodiscard]] NDString inHome(const std::string& path, const NDUUID& uuid) const {
    return "x-corvane-nidus://local" + path + uuid.UUIDString().str() +
           "&home=" + home_->uuid().UUIDString().str();
  }

  const std::shared_ptr<TestHome> home_;
};

TEST_F(ObjectURLTest, HomeIsNamedByItsUUID) {
  EXPECT_EQ(url(*home_).text().str(),
            "x-corvane-nidus://local/home?id=" + home_->uuid().UUIDString().str());
}

TEST_F(ObjectURLTest, UUIDIsInUpperCase) {
  EXPECT_TRUE(url(*home_).text().view().substr(32).starts_with("ABCDEF00-0000-0000-"));
}

TEST_F(ObjectURLTest, ServiceIsNamedWithinItsAccessory) {
  EXPECT_EQ(url(*home_->service("Lamp")).text(),
            inHome("/service?id=12&accessory=", home_->accessory("Lamp")->uuid()));
}

TEST_F(ObjectURLTest, OtherObjectsAreNamedInTheirHome) {
  const auto textOf = [](const auto& object) { return url(*object).text(); };
  EXPECT_EQ(textOf(home_->room("Kitchen")), inHome("/room?id=", home_->room("Kitchen")->uuid()));
  EXPECT_EQ(textOf(home_->zone("Ground floor")),
            inHome("/zone?id=", home_->zone("Ground floor")->uuid()));
  EXPECT_EQ(textOf(home_->group("Evening")), inHome("/group?id=", home_->group("Evening")->uuid()));
  EXPECT_EQ(textOf(home_->scene("Good night")),
            inHome("/actionSet?id=", home_->scene("Good night")->uuid()));
  EXPECT_EQ(textOf(home_->trigger("Sunset")),
            inHome("/trigger?id=", home_->trigger("Sunset")->uuid()));
}

TEST_F(ObjectURLTest, EachCallMakesANewObject) {
  const NDURL first = url(*home_);
  const NDURL second = url(*home_);
  EXPECT_NE(first.text().view().data(), second.text().view().data());
  EXPECT_EQ(first, second);
}

TEST_F(ObjectURLTest, LongestInstanceIDFits) {
  const auto home = HomeBuilder("Cabin")
                        .light("Lamp")
                        .serviceID(std::numeric_limits<std::int64_t>::min())
                        .build();
  EXPECT_EQ(url(*home->service("Lamp")).text(),
            inHome("/service?id=-9223372036854775808&accessory=", home->accessory("Lamp")->uuid()));
}

TEST_F(ObjectURLTest, HomeThatIsGoneReadsAsNull) {
  const auto room = HomeBuilder("Hut").room("Attic").build()->room("Attic");
  EXPECT_EQ(url(*room).text().str(),
            "x-corvane-nidus://local/room?id=" + room->uuid().UUIDString().str() + "&home=(null)");
}

}  // namespace
}  // namespace nidus
