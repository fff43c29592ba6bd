#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string_view>
#include <utility>
#include <vector>

#include "Assistant/CommandTest.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// Keeps what it is told of the characteristics.
class ReachObserver final : public NDAssistantCommandObserver {
 public:
  void filterDidRunStep(std::string_view /*step*/, const NDDictionaryList& /*kept*/) override {}
  void actionDidReach(const std::vector<std::shared_ptr<NDCharacteristic>>& reached) override {
    reaches.push_back(reached);
  }

  std::vector<std::vector<std::shared_ptr<NDCharacteristic>>> reaches;
};

/// Reaches the characteristics of live services.
class ReachTest : public CommandTest {
 protected:
  std::shared_ptr<NDAssistantCommand> performed(
      const std::shared_ptr<TestHome>& home,
      std::shared_ptr<NDAssistantCommandObserver> observer = nullptr) {
    useHomes({home});
    auto command = makeCommand(Search(), {}, std::move(observer));
    perform(command);
    clearLog();
    return command;
  }
};

TEST_F(ReachTest, GivesOneCharacteristicOfEachService) {
  const auto home = HomeBuilder("Cottage")
                        .light("Lamp", {power(true), brightness(1), brightness(2)})
                        .light("Bulb", {power(true)})
                        .light("Strip", {brightness(3)})
                        .build();
  const auto command = performed(home);
  auto objects = command->allObjects();
  objects.erase(objects.begin());  // The home.
  EXPECT_THAT(command->filterObjects_forcharacteristicType(objects, kBrightness),
              ElementsAre(home->characteristic("Lamp", kBrightness),
                          home->characteristic("Strip", kBrightness)));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(ReachTest, KeepsDuplicates) {
  const auto home = HomeBuilder("Cottage").light("Lamp").build();
  const auto command = performed(home);
  const HomeObjectRecord* lamp = command->allObjects().back();
  EXPECT_EQ(command->filterObjects_forcharacteristicType({lamp, lamp}, kPower).size(), 2U);
}

TEST_F(ReachTest, LogsAndSkipsWhatIsNoService) {
  const auto home = HomeBuilder("Cottage").light("Lamp").room("Hall").build();
  const auto command = performed(home);
  logLevel(4);
  const auto objects = command->allObjects();
  ASSERT_EQ(objects.size(), 3U);
  EXPECT_EQ(command->filterObjects_forcharacteristicType(objects, kPower).size(), 1U);
  EXPECT_THAT(log(),
              ElementsAre("4 Filtered object " + description(*objects[0]) + " not a service",
                          "4 Filtered object " + description(*objects[2]) + " not a service"));
}

TEST_F(ReachTest, SkipsQuietlyBelowTheLevel) {
  const auto command = performed(HomeBuilder("Cottage").light("Lamp").build());
  logLevel(3);
  EXPECT_EQ(command->filterObjects_forcharacteristicType(command->allObjects(), kPower).size(), 1U);
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(ReachTest, FindsNothingForNullType) {
  const auto command = performed(HomeBuilder("Cottage").light("Lamp").build());
  EXPECT_THAT(command->filterObjects_forcharacteristicType({command->allObjects().back()}, nullptr),
              IsEmpty());
}

TEST_F(ReachTest, TellsTheObserver) {
  const auto observer = std::make_shared<ReachObserver>();
  const auto home = HomeBuilder("Cottage").light("Lamp").build();
  const auto command = performed(home, observer);
  static_cast<void>(
      command->filterObjects_forcharacteristicType({command->allObjects().back()}, kPower));
  EXPECT_THAT(observer->reaches, ElementsAre(ElementsAre(home->characteristic("Lamp", kPower))));
}

}  // namespace
}  // namespace nidus
