#include "HomePlatform/Store/HomeStore.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <bit>
#include <cmath>
#include <csignal>
#include <limits>
#include <string>
#include <thread>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Support/RandomHome.h"
#include "Support/TestFolder.h"
#include "Support/TestUUID.h"

namespace nidus {
namespace {

using testing::HasSubstr;

HomeData namedHome(std::uint32_t number, const char* name) {
  HomeData home;
  home.uuid = testUUID(number);
  home.name = name;
  return home;
}

/// A home with the accessory 1, its service 8 and within that the characteristics 9 and 10.
HomeData lampHome() {
  HomeData home = namedHome(0, "Flat");
  ServiceData service;
  service.instanceID = 8;
  service.serviceType = "light";
  for (const std::int64_t instanceID : {9, 10}) {
    CharacteristicData data;
    data.instanceID = instanceID;
    data.characteristicType = "brightness";
    data.value = NDValue::integer(instanceID);
    data.deviceValue = data.value;
    service.characteristics.push_back(data);
  }
  AccessoryData accessory;
  accessory.uuid = testUUID(1);
  accessory.name = "Lamp";
  accessory.services.push_back(service);
  home.accessories.push_back(accessory);
  return home;
}

ValueChange change(std::int64_t characteristic, const NDValueRef& value) {
  return {.home = testUUID(0),
          .address = {testUUID(1), 8, characteristic},
          .value = value,
          .deviceValue = std::nullopt};
}

/// A store in a file of a folder of its own.
class HomeStoreTest : public testing::Test {
 protected:
  [[nodiscard]] std::unique_ptr<HomeStore> open() const {
    auto store = HomeStore::open(file());
    EXPECT_TRUE(store) << store.failure().message;
    return std::move(*store);
  }
  [[nodiscard]] std::filesystem::path file() const { return folder_.path() / "home.db"; }

  static std::string contents(HomeStore& store) {
    const auto homes = store.loadHomes();
    return homes ? documentOf(*homes) : homes.failure().message;
  }

  /// The characteristic 9 or 10 of the lamp.
  static CharacteristicData lamp(HomeStore& store, std::size_t index = 0) {
    return store.loadHomes()->at(0).accessories.at(0).services.at(0).characteristics.at(index);
  }

 private:
  TestFolder folder_;
};

TEST_F(HomeStoreTest, StartsEmpty) {
  auto store = open();
  EXPECT_EQ(*store->countHomes(), 0);
  EXPECT_TRUE(store->loadHomes()->empty());
}

TEST_F(HomeStoreTest, KeepsRandomHomesAsTheyAre) {
  auto store = std::move(*HomeStore::open(std::nullopt));
  for (unsigned seed = 0; seed < 300; ++seed) {
    const std::vector<HomeData> homes = RandomHome(seed).homes();
    const Status failed = store->replaceHomes(homes);
    ASSERT_FALSE(failed) << failed->message;
    ASSERT_EQ(contents(*store), documentOf(homes)) << seed;
    ASSERT_EQ(*store->countHomes(), static_cast<std::int64_t>(homes.size()));
  }
}

TEST_F(HomeStoreTest, KeepsHomesWhenClosed) {
  const std::vector<HomeData> homes = {RandomHome(1).home(), RandomHome(2).home()};
  ASSERT_FALSE(open()->replaceHomes(homes));
  EXPECT_EQ(contents(*open()), documentOf(homes));
}

TEST_F(HomeStoreTest, WorksInMemoryWithoutFile) {
  auto store = HomeStore::open(std::nullopt);
  ASSERT_TRUE(store);
  ASSERT_FALSE((*store)->replaceHomes({lampHome()}));
  EXPECT_EQ(*(*store)->countHomes(), 1);
  EXPECT_EQ(*(*HomeStore::open(std::nullopt))->countHomes(), 0);
}

TEST_F(HomeStoreTest, ReplacesAllHomes) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({namedHome(1, "a"), namedHome(2, "b")}));
  ASSERT_FALSE(store->replaceHomes({namedHome(2, "c")}));
  EXPECT_EQ(contents(*store), documentOf({namedHome(2, "c")}));
}

TEST_F(HomeStoreTest, MergesIntoTheirPlaces) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({namedHome(1, "a"), namedHome(2, "b"), namedHome(3, "c")}));
  ASSERT_FALSE(store->mergeHomes({namedHome(9, "new"), namedHome(2, "B"), namedHome(4, "newer")}));
  EXPECT_EQ(contents(*store), documentOf({namedHome(1, "a"), namedHome(2, "B"), namedHome(3, "c"),
                                          namedHome(9, "new"), namedHome(4, "newer")}));
}

TEST_F(HomeStoreTest, MergeReplacesTheWholeHome) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  ASSERT_FALSE(store->mergeHomes({namedHome(0, "bare")}));
  EXPECT_EQ(contents(*store), documentOf({namedHome(0, "bare")}));
}

TEST_F(HomeStoreTest, MergesRandomHomesAgain) {
  auto store = open();
  std::vector<HomeData> homes;
  for (unsigned seed = 0; seed < 20; ++seed) homes.push_back(RandomHome(seed).home());
  ASSERT_FALSE(store->replaceHomes(homes));
  ASSERT_FALSE(store->mergeHomes(homes));
  EXPECT_EQ(contents(*store), documentOf(homes));
}

TEST_F(HomeStoreTest, KeepsOldHomesWhenAnImportFails) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  const std::vector<HomeData> twice = {namedHome(5, "a"), namedHome(5, "b")};
  EXPECT_TRUE(store->replaceHomes(twice));
  EXPECT_EQ(contents(*store), documentOf({lampHome()}));
}

TEST_F(HomeStoreTest, KeepsOldHomesWhenAMergeFails) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  HomeData wrong = namedHome(0, "wrong");
  wrong.rooms = {{testUUID(7), "a"}, {testUUID(7), "b"}};
  EXPECT_TRUE(store->mergeHomes({namedHome(6, "fine"), wrong}));
  EXPECT_EQ(contents(*store), documentOf({lampHome()}));
}

/// Renames the first of the homes.
HomeEdit renaming(const char* name) {
  return [name](std::vector<HomeData>& homes) {
    homes.at(0).name = name;
    return Status();
  };
}

TEST_F(HomeStoreTest, EditsHomesAsTheyAre) {
  auto store = open();
  auto other = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  ASSERT_FALSE(other->writeValues({change(9, NDValue::integer(77))}));
  ASSERT_FALSE(store->editHomes(renaming("Loft")));
  EXPECT_EQ(store->loadHomes()->at(0).name, "Loft");
  EXPECT_EQ(lamp(*store).value->integerValue(), 77);
}

TEST_F(HomeStoreTest, EditingKeepsRandomHomes) {
  auto store = open();
  for (unsigned seed = 0; seed < 30; ++seed) {
    const std::vector<HomeData> homes = RandomHome(seed).homes();
    ASSERT_FALSE(store->replaceHomes(homes));
    ASSERT_FALSE(store->editHomes([](std::vector<HomeData>&) { return Status(); }));
    ASSERT_EQ(contents(*store), documentOf(homes)) << seed;
  }
}

TEST_F(HomeStoreTest, NobodyWritesDuringAnEdit) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  auto other = std::move(*HomeStore::open(file(), std::chrono::milliseconds(0)));
  Status refusal;
  ASSERT_FALSE(store->editHomes([&](std::vector<HomeData>&) {
    refusal = other->writeValues({change(9, NDValue::integer(77))});
    return Status();
  }));
  ASSERT_TRUE(refusal);
  EXPECT_THAT(refusal->message, HasSubstr("locked"));
}

TEST_F(HomeStoreTest, KeepsOldHomesWhenAnEditFails) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  const Status failure = store->editHomes([](std::vector<HomeData>& homes) {
    homes.clear();
    return Status({Failure::Kind::badInput, "no"});
  });
  ASSERT_TRUE(failure);
  EXPECT_EQ(failure->message, "no");
  EXPECT_EQ(contents(*store), documentOf({lampHome()}));
}

struct WrongEdit {
  const char* label;
  HomeEdit edit;
  const char* message;
};

TEST_F(HomeStoreTest, RefusesEditsThatNoDocumentMayHold) {
  const WrongEdit table[] = {
      {"two homes of one UUID",
       [](std::vector<HomeData>& homes) {
         homes.push_back(homes.front());
         return Status();
       },
       "the changed homes: /homes/1/uuid: "},
      {"a room that is not there",
       [](std::vector<HomeData>& homes) {
         homes.at(0).accessories.at(0).room = testUUID(7);
         return Status();
       },
       "the changed homes: /homes/0/accessories/0/room: "},
  };
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  for (const WrongEdit& wrong : table) {
    SCOPED_TRACE(wrong.label);
    const Status failure = store->editHomes(wrong.edit);
    ASSERT_TRUE(failure);
    EXPECT_EQ(failure->kind, Failure::Kind::badInput);
    EXPECT_THAT(failure->message, HasSubstr(wrong.message));
    EXPECT_EQ(contents(*store), documentOf({lampHome()}));
  }
}

TEST_F(HomeStoreTest, WritesOneValueAtATime) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  ASSERT_FALSE(store->writeValues({change(9, NDValue::floating(0.1F))}));
  EXPECT_EQ(lamp(*store).value->floatValue(), 0.1F);
  EXPECT_EQ(lamp(*store).deviceValue->integerValue(), 9);
  EXPECT_EQ(lamp(*store, 1).value->integerValue(), 10);
}

TEST_F(HomeStoreTest, WritesDeviceValueAlone) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  ValueChange device = change(10, nullptr);
  device.value = std::nullopt;
  device.deviceValue = NDValue::text("on");
  ASSERT_FALSE(store->writeValues({device}));
  EXPECT_EQ(lamp(*store, 1).value->integerValue(), 10);
  EXPECT_EQ(lamp(*store, 1).deviceValue->stringValue(), "on");
}

TEST_F(HomeStoreTest, WritesNullAsNone) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  ASSERT_FALSE(store->writeValues({change(9, nullptr)}));
  EXPECT_FALSE(lamp(*store).value);
  EXPECT_TRUE(lamp(*store).deviceValue);
}

TEST_F(HomeStoreTest, KeepsKindAndBitsOfValues) {
  const NDValueRef values[] = {
      NDValue::boolean(true),
      NDValue::boolean(false),
      NDValue::integer(0),
      NDValue::integer(std::numeric_limits<std::int64_t>::max()),
      NDValue::integer(std::numeric_limits<std::int64_t>::min()),
      NDValue::floating(0.0F),
      NDValue::floating(-0.0F),
      NDValue::floating(1.0F),
      NDValue::floating(1e-45F),
      NDValue::floating(std::numeric_limits<float>::infinity()),
      NDValue::floating(std::numeric_limits<float>::quiet_NaN()),
      NDValue::text(""),
      NDValue::text("1"),
      NDValue::text(std::string_view("a\0b", 3)),
  };
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  for (const NDValueRef& value : values) {
    SCOPED_TRACE(value->description());
    ASSERT_FALSE(store->writeValues({change(9, value)}));
    const NDValueRef kept = lamp(*store).value;
    ASSERT_TRUE(kept);
    EXPECT_EQ(kept->isBoolean(), value->isBoolean());
    EXPECT_EQ(kept->isFloating(), value->isFloating());
    EXPECT_EQ(kept->stringValue(), value->stringValue());
    EXPECT_EQ(kept->integerValue(), value->integerValue());
    EXPECT_EQ(std::bit_cast<std::uint32_t>(kept->floatValue()),
              std::bit_cast<std::uint32_t>(value->floatValue()));
  }
}

TEST_F(HomeStoreTest, PassesOverAddressesThatAreGone) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  ValueChange elsewhere = change(9, NDValue::integer(1));
  elsewhere.home = testUUID(99);
  const Status failed = store->writeValues(
      {change(11, NDValue::integer(1)), elsewhere, change(10, NDValue::integer(2))});
  EXPECT_FALSE(failed);
  EXPECT_EQ(lamp(*store).value->integerValue(), 9);
  EXPECT_EQ(lamp(*store, 1).value->integerValue(), 2);
}

TEST_F(HomeStoreTest, VersionTellsOwnStructuralChanges) {
  auto store = open();
  const std::uint64_t atFirst = *store->version();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  const std::uint64_t replaced = *store->version();
  ASSERT_FALSE(store->mergeHomes({lampHome()}));
  const std::uint64_t merged = *store->version();
  ASSERT_FALSE(store->writeValues({change(9, NDValue::integer(1))}));
  EXPECT_NE(atFirst, replaced);
  EXPECT_NE(replaced, merged);
  EXPECT_EQ(*store->version(), merged);
}

TEST_F(HomeStoreTest, VersionTellsChangesOfOthers) {
  auto store = open();
  auto other = open();
  ASSERT_FALSE(other->replaceHomes({lampHome()}));
  const std::uint64_t before = *store->version();
  EXPECT_EQ(*store->version(), before);
  ASSERT_FALSE(other->writeValues({change(9, NDValue::integer(1))}));
  EXPECT_NE(*store->version(), before);
  EXPECT_EQ(lamp(*store).value->integerValue(), 1);
}

TEST_F(HomeStoreTest, FailedChangeKeepsVersion) {
  auto store = open();
  const std::uint64_t before = *store->version();
  EXPECT_TRUE(store->replaceHomes({namedHome(1, "a"), namedHome(1, "b")}));
  EXPECT_EQ(*store->version(), before);
}

TEST_F(HomeStoreTest, ReadsWhileAnotherWrites) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  Database other(file().string(), std::chrono::milliseconds(0));
  const Transaction transaction(other, Transaction::Kind::writing);
  other.run("DELETE FROM home");
  EXPECT_EQ(contents(*store), documentOf({lampHome()}));
}

TEST_F(HomeStoreTest, ReadsWhileItsOwnChangeIsMade) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  std::string seen;
  ASSERT_FALSE(store->editHomes([&](std::vector<HomeData>& homes) {
    homes.clear();
    std::thread([&] { seen = store->version() ? contents(*store) : "no version"; }).join();
    return Status();
  }));
  EXPECT_EQ(seen, documentOf({lampHome()}));
}

TEST_F(HomeStoreTest, OwnWriteHidesNoOtherChange) {
  auto store = open();
  auto other = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  const std::uint64_t before = *store->version();
  ASSERT_FALSE(other->writeValues({change(9, NDValue::integer(1))}));
  ASSERT_FALSE(store->writeValues({change(10, NDValue::integer(2))}));
  const std::uint64_t between = *store->version();
  EXPECT_NE(between, before);
  const auto andAnother = [&](const std::function<Status()>& write) {
    const Status failure = write();
    return failure ? failure : other->writeValues({change(9, NDValue::integer(3))});
  };
  ASSERT_FALSE(store->writeValues({change(10, NDValue::integer(4))}, andAnother));
  EXPECT_NE(*store->version(), between);
}

TEST_F(HomeStoreTest, SaysWhenAnotherHoldsTheLock) {
  auto store = HomeStore::open(file(), std::chrono::milliseconds(1));
  ASSERT_TRUE(store);
  ASSERT_FALSE((*store)->replaceHomes({lampHome()}));
  Database other(file().string(), std::chrono::milliseconds(0));
  const Transaction transaction(other, Transaction::Kind::writing);
  const Status failed = (*store)->writeValues({change(9, NDValue::integer(1))});
  ASSERT_TRUE(failed);
  EXPECT_EQ(failed->kind, Failure::Kind::platform);
  EXPECT_THAT(failed->message,
              HasSubstr(file().string() + ": the database is locked: another process is using it"));
  EXPECT_THAT(failed->message, HasSubstr("try again"));
}

TEST_F(HomeStoreTest, WaitsForALockThatIsReleased) {
  auto store = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  Database other(file().string(), std::chrono::milliseconds(0));
  auto transaction = std::make_unique<Transaction>(other, Transaction::Kind::writing);
  Status failed;
  std::thread writer([&] { failed = store->writeValues({change(9, NDValue::integer(1))}); });
  transaction.reset();
  writer.join();
  EXPECT_FALSE(failed);
  EXPECT_EQ(lamp(*store).value->integerValue(), 1);
}

TEST_F(HomeStoreTest, MayBeUsedFromManyThreads) {
  auto store = open();
  auto other = open();
  ASSERT_FALSE(store->replaceHomes({lampHome()}));
  std::vector<std::thread> threads;
  std::atomic<int> failures = 0;
  for (int i = 0; i < 4; ++i) {
    HomeStore& own = i % 2 == 0 ? *store : *other;
    threads.emplace_back([&own, &failures, i] {
      for (int round = 0; round < 10; ++round) {
        if (own.writeValues({change(9 + i % 2, NDValue::integer(round))})) ++failures;
        if (!own.loadHomes() || !own.version()) ++failures;
      }
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(failures, 0);
  EXPECT_EQ(lamp(*store).value->integerValue(), 9);
}

/// Notes what a progress is told.
StoreProgress notedIn(std::vector<std::size_t>& numbers) {
  return [&numbers](std::size_t accessories) { numbers.push_back(accessories); };
}

TEST_F(HomeStoreTest, TellsHowManyAccessoriesAreStored) {
  auto store = open();
  HomeData second = lampHome();
  second.uuid = testUUID(5);
  std::vector<std::size_t> numbers;
  ASSERT_FALSE(store->replaceHomes({lampHome(), second}, notedIn(numbers)));
  EXPECT_EQ(numbers, (std::vector<std::size_t>{0, 1, 2}));
  numbers.clear();
  ASSERT_FALSE(store->mergeHomes({second}, notedIn(numbers)));
  EXPECT_EQ(numbers, (std::vector<std::size_t>{0, 1}));
  numbers.clear();
  ASSERT_FALSE(store->replaceHomes({}, notedIn(numbers)));
  EXPECT_EQ(numbers, (std::vector<std::size_t>{0}));
}

TEST_F(HomeStoreTest, KeepsTheHomesWhenKilledWhileStoring) {
  const std::vector<HomeData> homes = {lampHome(), namedHome(5, "Hut")};
  ASSERT_FALSE(open()->replaceHomes({namedHome(7, "Tent")}));
  const std::string before = contents(*open());
  for (const std::size_t last : {std::size_t{0}, std::size_t{1}}) {
    const auto dieAt = [last](std::size_t accessories) {
      if (accessories == last) std::raise(SIGKILL);
    };
    EXPECT_EXIT(static_cast<void>(open()->replaceHomes(homes, dieAt)),
                testing::KilledBySignal(SIGKILL), "");
    EXPECT_EXIT(static_cast<void>(open()->mergeHomes(homes, dieAt)),
                testing::KilledBySignal(SIGKILL), "");
    EXPECT_EQ(contents(*open()), before);
  }
}

}  // namespace
}  // namespace nidus
