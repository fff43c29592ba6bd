#include "HomePlatform/Objects/HomeObject.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "HomePlatform/Drivers/PlatformErrors.h"
#include "HomePlatform/PlatformProbe.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "Support/TestCharacteristic.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class HomeObjectTest : public testing::Test {
 protected:
  void open(const HomeData& home) {
    ASSERT_FALSE(platform_->importHomes({home}, false));
    home_ = platform_.homes()[0];
  }

  std::vector<PlatformCall> calls_;
  OpenPlatform platform_{{.drainsOnCaller = true,
                          .callObserver = [this](const auto& call) { calls_.push_back(call); }}};
  std::shared_ptr<NDHome> home_;
};

TEST_F(HomeObjectTest, ShowsWhatTheDatabaseHas) {
  HomeData data = sampleHome();
  data.primary = true;
  data.triggers.push_back({uuidOf(kRoomID), "At sunset"});
  open(data);
  EXPECT_EQ(home_->uuid(), uuidOf(kHomeID));
  EXPECT_EQ(home_->name(), "Cabin");
  EXPECT_TRUE(home_->isPrimary());
  EXPECT_EQ(home_->rooms()[0]->name(), "Kitchen");
  EXPECT_EQ(home_->accessories()[1]->name(), "Door");
  EXPECT_EQ(home_->actionSets()[0]->uuid(), uuidOf(kSceneID));
  EXPECT_EQ(home_->triggers()[0]->name(), "At sunset");
}

TEST_F(HomeObjectTest, ShowsServicesWithCharacteristics) {
  HomeData data = sampleHome();
  lampOf(data).services[0].associatedServiceType = "plugged";
  open(data);
  const auto service = home_->accessories()[0]->services()[0];
  EXPECT_EQ(service->instanceID(), 8);
  EXPECT_EQ(service->serviceType(), "com.corvane.nidus.service.light");
  EXPECT_EQ(service->associatedServiceType(), "plugged");
  const auto brightness = service->characteristics()[1];
  EXPECT_EQ(brightness->instanceID(), 10);
  EXPECT_THAT(brightness->properties(), ElementsAre("readable", "writable"));
  EXPECT_EQ(brightness->metadata()->units(), "percentage");
  EXPECT_EQ(description(brightness->metadata()->maximumValue()), "100");
  EXPECT_EQ(description(brightness->value()), "40");
}

TEST_F(HomeObjectTest, TellsMissingMetadataFromEmpty) {
  HomeData data = sampleHome();
  powerOf(data).metadata.reset();
  brightnessOf(data).metadata = MetadataData();
  open(data);
  EXPECT_FALSE(characteristicAt(home_, powerAddress())->metadata());
  ASSERT_TRUE(characteristicAt(home_, brightnessAddress())->metadata());
  EXPECT_FALSE(characteristicAt(home_, brightnessAddress())->metadata()->format());
}

TEST_F(HomeObjectTest, ZonesAndGroupsShareObjects) {
  HomeData data = sampleHome();
  data.zones.push_back({uuidOf(kLampID), "Downstairs", {uuidOf(kRoomID)}});
  data.serviceGroups.push_back({uuidOf(kDoorID), "Corner", {{uuidOf(kDoorID), 8}}});
  open(data);
  EXPECT_EQ(home_->zones()[0]->rooms()[0], home_->rooms()[0]);
  EXPECT_EQ(home_->serviceGroups()[0]->services()[0], home_->accessories()[1]->services()[0]);
}

TEST_F(HomeObjectTest, PartsAreFoundInWhateverOrderTheirNumbersAre) {
  HomeData data = sampleHome();
  AccessoryData& lamp = lampOf(data);
  ServiceData second = lamp.services[0];
  lamp.services[0].instanceID = 20;
  std::swap(lamp.services[0].characteristics[0], lamp.services[0].characteristics[1]);
  second.instanceID = 4;
  second.characteristics.resize(1);
  second.characteristics[0].instanceID = 1;
  lamp.services.push_back(second);
  data.serviceGroups.push_back(
      {uuidOf(kDoorID), "All", {{uuidOf(kLampID), 4}, {uuidOf(kLampID), 20}}});
  open(data);
  const auto& services = home_->accessories()[0]->services();
  const auto& members = home_->serviceGroups()[0]->services();
  ASSERT_EQ(members.size(), 2U);
  EXPECT_EQ(members[0], services[1]);
  EXPECT_EQ(members[1], services[0]);
  const NDUUID id = uuidOf(kLampID);
  EXPECT_THAT(read(*platform_, home_, {{id, 20, 9}, {id, 4, 1}, {id, 20, 10}}).codes,
              ElementsAre(0, 0, 0));
}

TEST_F(HomeObjectTest, ChildrenFindTheirParents) {
  open(sampleHome());
  const auto characteristic = characteristicAt(home_, powerAddress());
  EXPECT_EQ(characteristic->service(), home_->accessories()[0]->services()[0]);
  EXPECT_EQ(characteristic->service()->accessory(), home_->accessories()[0]);
  EXPECT_EQ(characteristic->service()->accessory()->home(), home_);
  EXPECT_EQ(home_->accessories()[0]->room(), home_->rooms()[0]);
}

TEST_F(HomeObjectTest, ChildOutlivesItsHome) {
  open(sampleHome());
  const auto characteristic = characteristicAt(home_, powerAddress());
  const auto room = home_->rooms()[0];
  home_.reset();
  ASSERT_FALSE(platform_->importHomes({}, false));
  EXPECT_TRUE(platform_.homes().empty());
  EXPECT_FALSE(characteristic->service());
  EXPECT_FALSE(room->home());
  EXPECT_EQ(room->name(), "Kitchen");
}

TEST_F(HomeObjectTest, RoomlessAccessoryStandsInDefaultRoom) {
  HomeData data = sampleHome();
  lampOf(data).room.reset();
  open(data);
  const auto room = home_->accessories()[0]->room();
  EXPECT_EQ(room->name(), "Cabin");
  EXPECT_EQ(room->home(), home_);
  EXPECT_EQ(home_->rooms().size(), 1U);
}

TEST_F(HomeObjectTest, HomeFaultAnswersWholeRead) {
  HomeData data = sampleHome();
  data.faults = {51, 52};
  powerOf(data).faults.read = 71;
  open(data);
  const auto answer = read(*platform_, home_, {powerAddress(), brightnessAddress()});
  EXPECT_EQ(answer.error, 51);
  EXPECT_THAT(answer.codes, IsEmpty());
  EXPECT_EQ(answer.calls, 1);
}

TEST_F(HomeObjectTest, HomeFaultAnswersWholeWrite) {
  HomeData data = sampleHome();
  data.faults = {51, 52};
  open(data);
  const auto answer = write(*platform_, home_, {{powerAddress(), NDValue::boolean(true)}});
  EXPECT_EQ(answer.error, 52);
  EXPECT_THAT(answer.codes, IsEmpty());
  EXPECT_EQ(storedValues(*platform_, powerAddress()), "0/0");
}

TEST_F(HomeObjectTest, NeverAnswersInsideTheCall) {
  open(sampleHome());
  bool isAnswered = false;
  home_->readCharacteristicValues_withCompletionHandler(
      {characteristicAt(home_, powerAddress())},
      [&isAnswered](const auto&, const auto&) { isAnswered = true; });
  EXPECT_FALSE(isAnswered);
  platform_->drain();
  EXPECT_TRUE(isAnswered);
}

TEST_F(HomeObjectTest, ResponsesNameWhatWasAsked) {
  open(sampleHome());
  const auto asked = characteristicAt(home_, brightnessAddress());
  std::shared_ptr<NDCharacteristic> answered;
  home_->readCharacteristicValues_withCompletionHandler(
      {asked}, [&answered](const auto&, const auto& responses) {
        answered = responses.at(0).characteristic;
      });
  platform_->drain();
  EXPECT_EQ(answered, asked);
}

TEST_F(HomeObjectTest, CharacteristicOfAnotherMakeWithoutHomeIsUnreachable) {
  open(sampleHome());
  const auto foreign = std::make_shared<TestCharacteristic>(CharacteristicSpec("another.make"),
                                                            powerAddress().characteristic,
                                                            std::weak_ptr<NDService>());
  std::vector<std::int64_t> codes;
  home_->readCharacteristicValues_withCompletionHandler(
      {foreign, characteristicAt(home_, powerAddress())},
      [&codes](const auto&, const auto& responses) {
        for (const auto& response : responses) {
          codes.push_back(response.error ? response.error->code : 0);
        }
      });
  platform_->drain();
  EXPECT_THAT(codes, ElementsAre(kNDErrorUnreachable, 0));
}

void addScene(HomeData& home, std::vector<SceneActionData> actions) {
  home.actionSets[0].actions = std::move(actions);
}

TEST_F(HomeObjectTest, SceneWritesItsValues) {
  HomeData data = sampleHome();
  addScene(data,
           {{powerAddress(), NDValue::integer(1)}, {lockTargetAddress(), NDValue::boolean(true)}});
  open(data);
  EXPECT_EQ(execute(*platform_, home_), 0);
  EXPECT_EQ(storedValues(*platform_, powerAddress()), "1/1");
  EXPECT_EQ(storedValues(*platform_, lockStateAddress()), "1/1");
  EXPECT_TRUE(characteristicAt(home_, powerAddress())->value()->isBoolean());
}

TEST_F(HomeObjectTest, SceneAnswersFirstErrorAndGoesOn) {
  HomeData data = sampleHome();
  addScene(data, {{lockTargetAddress(), NDValue::text("no")},
                  {brightnessAddress(), NDValue::integer(500)},
                  {powerAddress(), NDValue::boolean(true)}});
  open(data);
  EXPECT_EQ(execute(*platform_, home_), kNDErrorWrongType);
  EXPECT_EQ(storedValues(*platform_, powerAddress()), "1/1");
}

TEST_F(HomeObjectTest, SceneIgnoresWriteFaultOfHome) {
  HomeData data = sampleHome();
  data.faults.write = 52;
  addScene(data, {{powerAddress(), NDValue::boolean(true)}});
  open(data);
  EXPECT_EQ(execute(*platform_, home_), 0);
}

TEST_F(HomeObjectTest, SceneFaultIsTheAnswer) {
  HomeData data = sampleHome();
  data.actionSets[0].executeFault = 81;
  addScene(data, {{powerAddress(), NDValue::boolean(true)}});
  open(data);
  EXPECT_EQ(execute(*platform_, home_), 81);
  EXPECT_EQ(storedValues(*platform_, powerAddress()), "0/0");
}

TEST_F(HomeObjectTest, GoneSceneIsUnreachable) {
  open(sampleHome());
  HomeData data = sampleHome();
  data.actionSets.clear();
  ASSERT_FALSE(platform_->importHomes({data}, false));
  EXPECT_EQ(execute(*platform_, home_), kNDErrorUnreachable);
}

TEST_F(HomeObjectTest, EmptySceneSucceeds) {
  open(sampleHome());
  EXPECT_EQ(execute(*platform_, home_), 0);
}

TEST_F(HomeObjectTest, ObserverHearsOfRead) {
  HomeData data = sampleHome();
  data.faults.read = 51;
  open(data);
  static_cast<void>(read(*platform_, home_, {brightnessAddress(), powerAddress()}));
  ASSERT_EQ(calls_.size(), 1U);
  EXPECT_EQ(calls_[0].kind, PlatformCall::Kind::read);
  EXPECT_EQ(calls_[0].home, uuidOf(kHomeID));
  EXPECT_THAT(calls_[0].characteristics, ElementsAre(brightnessAddress(), powerAddress()));
}

TEST_F(HomeObjectTest, ObserverHearsValuesAsPassed) {
  open(sampleHome());
  const NDValueRef value = NDValue::floating(45.0F);
  static_cast<void>(write(*platform_, home_, {{brightnessAddress(), value}, {powerAddress(), {}}}));
  ASSERT_EQ(calls_.size(), 1U);
  EXPECT_EQ(calls_[0].kind, PlatformCall::Kind::write);
  EXPECT_THAT(calls_[0].values, ElementsAre(value, nullptr));
}

TEST_F(HomeObjectTest, ObserverHearsSceneButNotItsWrites) {
  HomeData data = sampleHome();
  addScene(data, {{powerAddress(), NDValue::boolean(true)}});
  open(data);
  static_cast<void>(execute(*platform_, home_));
  ASSERT_EQ(calls_.size(), 1U);
  EXPECT_EQ(calls_[0].kind, PlatformCall::Kind::execute);
  EXPECT_EQ(calls_[0].actionSet, uuidOf(kSceneID));
}

}  // namespace
}  // namespace nidus
