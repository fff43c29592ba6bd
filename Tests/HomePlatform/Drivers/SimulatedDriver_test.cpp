#include "HomePlatform/Drivers/SimulatedDriver.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <limits>

#include "HomePlatform/PlatformProbe.h"

namespace nidus {
namespace {

using testing::ElementsAre;

struct PrecedenceCase {
  const char* label;
  std::vector<std::function<void(HomeData&)>> obstacles;  ///< The first is the one that decides.
  std::int64_t code;
};

class SimulatedDriverTest : public testing::Test {
 protected:
  void open(const HomeData& home) {
    ASSERT_FALSE(platform_->importHomes({home}, false));
    home_ = platform_.homes()[0];
  }
  [[nodiscard]] BatchAnswer readOne(const CharacteristicAddress& target) {
    return read(*platform_, home_, {target});
  }
  [[nodiscard]] BatchAnswer writeOne(const CharacteristicAddress& target, NDValueRef value) {
    return write(*platform_, home_, {{target, std::move(value)}});
  }
  [[nodiscard]] std::string cached(const CharacteristicAddress& address) {
    return description(characteristicAt(home_, address)->value());
  }
  [[nodiscard]] std::string stored(const CharacteristicAddress& address) {
    return storedValues(*platform_, address);
  }

  OpenPlatform platform_{{.locked = true, .drainsOnCaller = true}};
  std::shared_ptr<NDHome> home_;
};

void faultCharacteristic(HomeData& home) { brightnessOf(home).faults = {71, 72}; }
void faultAccessory(HomeData& home) { lampOf(home).faults = {61, 62}; }
void makeUnreachable(HomeData& home) { lampOf(home).reachable = false; }
void requireUnlock(HomeData& home) { lampOf(home).requiresUnlock = true; }
void forbidAll(HomeData& home) { brightnessOf(home).properties.clear(); }

TEST_F(SimulatedDriverTest, JudgesReadsByFirstObstacle) {
  const PrecedenceCase cases[] = {
      {"characteristic's fault",
       {faultCharacteristic, faultAccessory, makeUnreachable, requireUnlock, forbidAll},
       71},
      {"accessory's fault", {faultAccessory, makeUnreachable, requireUnlock, forbidAll}, 61},
      {"unreachable", {makeUnreachable, requireUnlock, forbidAll}, 4},
      {"locked", {requireUnlock, forbidAll}, 82},
      {"not readable", {forbidAll}, 6},
      {"none", {}, 0},
  };
  for (const auto& [label, obstacles, code] : cases) {
    SCOPED_TRACE(label);
    HomeData home = sampleHome();
    for (const auto& obstacle : obstacles) obstacle(home);
    open(home);
    EXPECT_THAT(readOne(brightnessAddress()).codes, ElementsAre(code));
  }
}

TEST_F(SimulatedDriverTest, JudgesWritesByFirstObstacle) {
  const PrecedenceCase cases[] = {
      {"characteristic's fault",
       {faultCharacteristic, faultAccessory, makeUnreachable, requireUnlock, forbidAll},
       72},
      {"accessory's fault", {faultAccessory, makeUnreachable, requireUnlock, forbidAll}, 62},
      {"unreachable", {makeUnreachable, requireUnlock, forbidAll}, 4},
      {"locked", {requireUnlock, forbidAll}, 82},
      {"not writable", {forbidAll}, 5},
      {"wrong type", {}, 43},
  };
  for (const auto& [label, obstacles, code] : cases) {
    SCOPED_TRACE(label);
    HomeData home = sampleHome();
    for (const auto& obstacle : obstacles) obstacle(home);
    open(home);
    EXPECT_THAT(writeOne(brightnessAddress(), NDValue::text("full")).codes, ElementsAre(code));
  }
}

TEST_F(SimulatedDriverTest, ReadFaultsLeaveWritesAlone) {
  HomeData home = sampleHome();
  home.faults.read = 51;
  lampOf(home).faults.read = 52;
  brightnessOf(home).faults.read = 53;
  open(home);
  EXPECT_THAT(writeOne(brightnessAddress(), NDValue::integer(5)).codes, ElementsAre(0));
}

TEST_F(SimulatedDriverTest, WriteFaultsLeaveReadsAlone) {
  HomeData home = sampleHome();
  home.faults.write = 51;
  lampOf(home).faults.write = 52;
  brightnessOf(home).faults.write = 53;
  open(home);
  EXPECT_THAT(readOne(brightnessAddress()).codes, ElementsAre(0));
}

TEST_F(SimulatedDriverTest, UnlockedDeviceOpensAccessories) {
  HomeData home = sampleHome();
  requireUnlock(home);
  open(home);
  platform_->setLocked(false);
  EXPECT_THAT(readOne(brightnessAddress()).codes, ElementsAre(0));
  platform_->setLocked(true);
  EXPECT_THAT(writeOne(brightnessAddress(), NDValue::integer(5)).codes, ElementsAre(82));
}

TEST_F(SimulatedDriverTest, WritesWithinLimits) {
  struct Case {
    const char* label;
    NDValueRef value;
    std::int64_t code;
  };
  const Case cases[] = {
      {"least", NDValue::integer(0), 0},
      {"greatest", NDValue::integer(100), 0},
      {"below", NDValue::integer(-1), 44},
      {"above", NDValue::integer(101), 44},
      {"rounded in", NDValue::floating(100.4F), 0},
      {"rounded out", NDValue::floating(100.5F), 44},
      {"none", nullptr, 43},
      {"text", NDValue::text("5"), 43},
      {"beyond the format", NDValue::integer(std::int64_t{1} << 40), 43},
  };
  open(sampleHome());
  for (const auto& [label, value, code] : cases) {
    SCOPED_TRACE(label);
    EXPECT_THAT(writeOne(brightnessAddress(), value).codes, ElementsAre(code));
  }
}

TEST_F(SimulatedDriverTest, KeepsItsValueWhereAnInfinityIsWritten) {
  HomeData home = sampleHome();
  brightnessOf(home).metadata = std::nullopt;
  open(home);
  const float infinity = std::numeric_limits<float>::infinity();
  EXPECT_THAT(writeOne(brightnessAddress(), NDValue::integer(5)).codes, ElementsAre(0));
  EXPECT_THAT(writeOne(brightnessAddress(), NDValue::floating(infinity)).codes, ElementsAre(43));
  EXPECT_EQ(storedValues(*platform_, brightnessAddress()), "5/5");
}

TEST_F(SimulatedDriverTest, TextLimitsLimitNothing) {
  HomeData home = sampleHome();
  brightnessOf(home).metadata->minimumValue = NDValue::text("low");
  brightnessOf(home).metadata->maximumValue = NDValue::text("high");
  brightnessOf(home).metadata->format = nullptr;
  open(home);
  EXPECT_THAT(writeOne(brightnessAddress(), NDValue::integer(5000)).codes, ElementsAre(0));
}

TEST_F(SimulatedDriverTest, RefusedWriteChangesNothing) {
  open(sampleHome());
  static_cast<void>(writeOne(brightnessAddress(), NDValue::integer(101)));
  EXPECT_EQ(cached(brightnessAddress()), "40");
  EXPECT_EQ(stored(brightnessAddress()), "40/40");
}

TEST_F(SimulatedDriverTest, WritesConvertedValue) {
  open(sampleHome());
  static_cast<void>(writeOne(brightnessAddress(), NDValue::floating(44.5F)));
  EXPECT_EQ(cached(brightnessAddress()), "45");
  EXPECT_EQ(stored(brightnessAddress()), "45/45");
}

TEST_F(SimulatedDriverTest, ReadTakesDeviceValue) {
  HomeData home = sampleHome();
  brightnessOf(home).deviceValue = NDValue::integer(75);
  open(home);
  EXPECT_EQ(cached(brightnessAddress()), "40");
  EXPECT_THAT(readOne(brightnessAddress()).codes, ElementsAre(0));
  EXPECT_EQ(cached(brightnessAddress()), "75");
  EXPECT_EQ(stored(brightnessAddress()), "75/75");
}

TEST_F(SimulatedDriverTest, ReadTakesMissingDeviceValue) {
  HomeData home = sampleHome();
  brightnessOf(home).deviceValue = nullptr;
  open(home);
  EXPECT_THAT(readOne(brightnessAddress()).codes, ElementsAre(0));
  EXPECT_EQ(stored(brightnessAddress()), "(null)/(null)");
}

TEST_F(SimulatedDriverTest, ReadKeepsKindOfDeviceValue) {
  HomeData home = sampleHome();
  powerOf(home).metadata.reset();
  powerOf(home).value = NDValue::boolean(true);
  powerOf(home).deviceValue = NDValue::integer(1);
  open(home);
  static_cast<void>(readOne(powerAddress()));
  EXPECT_TRUE(characteristicAt(home_, powerAddress())->value()->isInteger());
}

TEST_F(SimulatedDriverTest, FailedReadKeepsCachedValue) {
  HomeData home = sampleHome();
  brightnessOf(home).deviceValue = NDValue::integer(75);
  makeUnreachable(home);
  open(home);
  static_cast<void>(readOne(brightnessAddress()));
  EXPECT_EQ(stored(brightnessAddress()), "40/75");
}

TEST_F(SimulatedDriverTest, AnswersInOrderAsked) {
  HomeData home = sampleHome();
  powerOf(home).faults.read = 71;
  makeUnreachable(home);
  open(home);
  const auto answer =
      read(*platform_, home_, {lockStateAddress(), powerAddress(), brightnessAddress()});
  EXPECT_THAT(answer.codes, ElementsAre(0, 71, 4));
  EXPECT_EQ(answer.calls, 1);
}

TEST_F(SimulatedDriverTest, FindsAccessoriesInAnyOrder) {
  HomeData home = sampleHome();
  std::vector<CharacteristicAddress> targets;
  for (std::uint8_t number = 0; number < 4; ++number) {
    AccessoryData lamp = lampOf(home);
    lamp.uuid = NDUUID({number});
    lamp.faults.read = 60 + number;
    targets.push_back({lamp.uuid, brightnessAddress().service, brightnessAddress().characteristic});
    home.accessories.push_back(std::move(lamp));
  }
  open(home);
  const auto answer =
      read(*platform_, home_,
           {targets[3], targets[0], targets[1], targets[1], targets[3], brightnessAddress()});
  EXPECT_THAT(answer.codes, ElementsAre(63, 60, 61, 61, 63, 0));
}

TEST_F(SimulatedDriverTest, LastWriteOfOneBatchWins) {
  open(sampleHome());
  const auto answer = write(*platform_, home_,
                            {{brightnessAddress(), NDValue::integer(10)},
                             {brightnessAddress(), NDValue::integer(20)},
                             {brightnessAddress(), NDValue::integer(200)}});
  EXPECT_THAT(answer.codes, ElementsAre(0, 0, 44));
  EXPECT_EQ(stored(brightnessAddress()), "20/20");
  EXPECT_EQ(cached(brightnessAddress()), "20");
}

TEST_F(SimulatedDriverTest, LockFollowsItsTarget) {
  open(sampleHome());
  static_cast<void>(writeOne(lockTargetAddress(), NDValue::boolean(true)));
  EXPECT_EQ(stored(lockStateAddress()), "1/1");
  EXPECT_EQ(cached(lockStateAddress()), "1");
}

TEST_F(SimulatedDriverTest, FollowerIgnoresItsLimits) {
  HomeData home = sampleHome();
  lockStateOf(home).metadata->maximumValue = NDValue::integer(0);
  open(home);
  static_cast<void>(writeOne(lockTargetAddress(), NDValue::integer(3)));
  EXPECT_EQ(stored(lockStateAddress()), "3/3");
}

TEST_F(SimulatedDriverTest, FollowerTakesItsOwnFormat) {
  HomeData home = sampleHome();
  lockStateOf(home).metadata->format = "bool";
  open(home);
  static_cast<void>(writeOne(lockTargetAddress(), NDValue::integer(3)));
  EXPECT_TRUE(characteristicAt(home_, lockStateAddress())->value()->isBoolean());
}

TEST_F(SimulatedDriverTest, FollowerKeepsWhatCannotBeConverted) {
  HomeData home = sampleHome();
  lockStateOf(home).metadata->format = "string";
  lockStateOf(home).value = lockStateOf(home).deviceValue = NDValue::text("open");
  open(home);
  EXPECT_THAT(writeOne(lockTargetAddress(), NDValue::integer(1)).codes, ElementsAre(0));
  EXPECT_EQ(stored(lockStateAddress()), "open/open");
}

TEST_F(SimulatedDriverTest, FirstFollowerOfServiceFollows) {
  HomeData home = sampleHome();
  auto& characteristics = doorOf(home).services[0].characteristics;
  characteristics.push_back(characteristics[1]);
  characteristics.back().instanceID = 11;
  open(home);
  static_cast<void>(writeOne(lockTargetAddress(), NDValue::integer(1)));
  EXPECT_EQ(stored(lockStateAddress()), "1/1");
  EXPECT_EQ(stored({uuidOf(kDoorID), 8, 11}), "0/0");
}

TEST_F(SimulatedDriverTest, WrittenStateMovesNoTarget) {
  open(sampleHome());
  static_cast<void>(writeOne(lockStateAddress(), NDValue::integer(1)));
  EXPECT_EQ(stored(lockTargetAddress()), "0/0");
}

TEST_F(SimulatedDriverTest, RefusedTargetMovesNoFollower) {
  HomeData home = sampleHome();
  lockTargetOf(home).faults.write = 71;
  open(home);
  static_cast<void>(writeOne(lockTargetAddress(), NDValue::integer(1)));
  EXPECT_EQ(stored(lockStateAddress()), "0/0");
}

TEST_F(SimulatedDriverTest, GoneCharacteristicIsUnreachable) {
  open(sampleHome());
  HomeData smaller = sampleHome();
  lampOf(smaller).services[0].characteristics.pop_back();
  ASSERT_FALSE(platform_->importHomes({smaller}, false));
  EXPECT_THAT(read(*platform_, home_, {brightnessAddress(), powerAddress()}).codes,
              ElementsAre(4, 0));
  EXPECT_THAT(writeOne(brightnessAddress(), NDValue::integer(1)).codes, ElementsAre(4));
}

TEST_F(SimulatedDriverTest, GoneHomeIsUnreachable) {
  open(sampleHome());
  ASSERT_FALSE(platform_->importHomes({}, false));
  EXPECT_THAT(readOne(brightnessAddress()).codes, ElementsAre(4));
  EXPECT_THAT(writeOne(brightnessAddress(), NDValue::integer(1)).codes, ElementsAre(4));
  EXPECT_EQ(execute(*platform_, home_), 4);
}

TEST_F(SimulatedDriverTest, EmptyBatchIsAnswered) {
  open(sampleHome());
  EXPECT_EQ(read(*platform_, home_, {}).calls, 1);
  EXPECT_EQ(write(*platform_, home_, {}).calls, 1);
}

}  // namespace
}  // namespace nidus
