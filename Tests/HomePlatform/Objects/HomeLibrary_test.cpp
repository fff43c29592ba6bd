#include "HomePlatform/Objects/HomeLibrary.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "HomePlatform/Drivers/PlatformErrors.h"
#include "HomePlatform/Drivers/SimulatedDriver.h"
#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/Objects/CharacteristicObject.h"
#include "HomePlatform/Objects/HomeCalls.h"
#include "HomePlatform/PlatformProbe.h"
#include "HomePlatform/System/CallerQueue.h"

namespace nidus {
namespace {

using testing::ElementsAre;

const Failure kBroken{Failure::Kind::platform, "the disk is gone"};

/// A store whose answers the test gives.
class ScriptedStore final : public HomeStore {
 public:
  Status replaceHomes(const std::vector<HomeData>&, const StoreProgress&) override {
    return std::nullopt;
  }
  Status mergeHomes(const std::vector<HomeData>&, const StoreProgress&) override {
    return std::nullopt;
  }
  Status editHomes(const HomeEdit&) override { return std::nullopt; }
  Result<std::vector<HomeData>> loadHomes() override {
    ++loads;
    if (isBroken) return kBroken;
    return homes;
  }
  Result<std::int64_t> countHomes() override { return static_cast<std::int64_t>(homes.size()); }
  Status writeValues(const std::vector<ValueChange>& changes, const AroundWrite& around) override {
    ++writes;
    if (isReadOnly) return kBroken;
    if (onWait) onWait();
    return around([&] {
      written = changes;
      if (onWrite) onWrite();
      return Status();
    });
  }
  Result<bool> waitForWriter() override { return true; }
  Result<std::uint64_t> version() override {
    if (isBroken) return kBroken;
    return number;
  }

  std::vector<HomeData> homes{sampleHome()};
  std::uint64_t number = 1;
  int loads = 0;
  int writes = 0;
  bool isBroken = false;
  bool isReadOnly = false;
  std::vector<ValueChange> written;
  std::function<void()> onWait;
  std::function<void()> onWrite;
};

class HomeLibraryTest : public testing::Test {
 protected:
  [[nodiscard]] std::shared_ptr<NDHome> home() { return (*library_->current())->homes[0]; }
  [[nodiscard]] std::string power(const std::shared_ptr<NDHome>& home) {
    return description(characteristicAt(home, powerAddress())->value());
  }

  const std::shared_ptr<ScriptedStore> store_ = std::make_shared<ScriptedStore>();
  const std::shared_ptr<HomeLibrary> library_ = std::make_shared<HomeLibrary>(store_);
};

TEST_F(HomeLibraryTest, ReadsUnchangedDatabaseOnce) {
  const auto first = home();
  EXPECT_EQ(home(), first);
  EXPECT_EQ(store_->loads, 1);
}

TEST_F(HomeLibraryTest, ReadsChangedDatabaseAgain) {
  const auto first = home();
  store_->number = 2;
  EXPECT_NE(home(), first);
  EXPECT_EQ(first->name(), "Cabin");
}

TEST_F(HomeLibraryTest, KeptValuesShowInAllEditions) {
  const auto earlier = home();
  store_->number = 2;
  const auto later = home();
  const NDValueRef on = NDValue::boolean(true);
  EXPECT_FALSE(library_->keep({{uuidOf(kHomeID), powerAddress(), on, on}}));
  EXPECT_EQ(power(earlier), "1");
  EXPECT_EQ(power(later), "1");
}

TEST_F(HomeLibraryTest, PushedValueShowsInLoadedHome) {
  const auto loaded = home();
  ValueKeeper& keeper = *library_;
  EXPECT_FALSE(
      keeper.keep({{uuidOf(kHomeID), brightnessAddress(), NDValue::integer(7), std::nullopt}}));
  const auto& object =
      static_cast<const CharacteristicObject&>(*characteristicAt(loaded, brightnessAddress()));
  EXPECT_EQ(description(object.values().value), "7");
  EXPECT_EQ(description(object.values().deviceValue), "40");
}

TEST_F(HomeLibraryTest, EarlierEditionTakesLoadedValues) {
  const auto earlier = home();
  powerOf(store_->homes[0]).value = NDValue::boolean(true);
  store_->number = 2;
  static_cast<void>(home());
  EXPECT_EQ(power(earlier), "1");
}

TEST_F(HomeLibraryTest, FailedWriteChangesNoValue) {
  const auto loaded = home();
  store_->isReadOnly = true;
  const NDValueRef on = NDValue::boolean(true);
  EXPECT_TRUE(library_->keep({{uuidOf(kHomeID), powerAddress(), on, on}}));
  EXPECT_EQ(power(loaded), "0");
}

TEST_F(HomeLibraryTest, DeliversWhileAWriteWaits) {
  bool isDelivered = false;
  store_->onWait = [&] { isDelivered = static_cast<bool>(library_->current()); };
  const NDValueRef on = NDValue::boolean(true);
  EXPECT_FALSE(library_->keep({{uuidOf(kHomeID), powerAddress(), on, on}}));
  EXPECT_TRUE(isDelivered);
}

TEST_F(HomeLibraryTest, PassesOnFailureOfDatabase) {
  store_->isBroken = true;
  const auto edition = library_->current();
  ASSERT_FALSE(edition);
  EXPECT_EQ(edition.failure().message, kBroken.message);
}

/// Batches of homes over the scripted store.
class FailingDatabaseTest : public HomeLibraryTest {
 protected:
  FailingDatabaseTest() { library_->setCalls(calls_); }

  void run() {
    while (queue_->runOne()) {
    }
  }
  [[nodiscard]] BatchAnswer readPower(const std::shared_ptr<NDHome>& home) {
    BatchAnswer answer;
    home->readCharacteristicValues_withCompletionHandler(
        {characteristicAt(home, powerAddress()), characteristicAt(home, brightnessAddress())},
        [&answer](const auto&, const auto& responses) { note(answer, responses); });
    run();
    return answer;
  }
  [[nodiscard]] BatchAnswer writePower(const std::shared_ptr<NDHome>& home) {
    BatchAnswer answer;
    home->writeCharacteristicValues_withCompletionHandler(
        {{characteristicAt(home, powerAddress()), NDValue::boolean(true)},
         {characteristicAt(home, brightnessAddress()), NDValue::integer(500)}},
        [&answer](const auto&, const auto& responses) { note(answer, responses); });
    run();
    return answer;
  }
  static void note(BatchAnswer& answer, const std::vector<NDCharacteristicResponse>& responses) {
    ++answer.calls;
    for (const auto& response : responses) {
      answer.codes.push_back(response.error ? response.error->code : 0);
    }
  }

  int failures_ = 0;
  const std::function<void(const Failure&)> reportFailure_ = [this](const auto&) { ++failures_; };
  const std::shared_ptr<CallerQueue> queue_ = std::make_shared<CallerQueue>();
  const std::shared_ptr<HomeCalls> calls_ = std::make_shared<HomeCalls>(
      HomeCalls::Parts{library_,
                       std::make_shared<SimulatedDriver>(
                           library_, std::make_shared<MetadataMapper>(builtInVocabulary()),
                           std::make_shared<DeviceLock>(false), queue_, reportFailure_),
                       queue_, nullptr, reportFailure_});
};

TEST_F(FailingDatabaseTest, FailedCommitIsNoSuccess) {
  const auto loaded = home();
  store_->isReadOnly = true;
  EXPECT_THAT(writePower(loaded).codes, ElementsAre(kErrorNotKept, kNDErrorOutOfRange));
  EXPECT_EQ(failures_, 1);
  EXPECT_EQ(power(loaded), "0");
}

TEST_F(FailingDatabaseTest, UnreadableDatabaseAnswersBatches) {
  const auto loaded = home();
  store_->isBroken = true;
  EXPECT_THAT(readPower(loaded).codes, ElementsAre(kErrorNotKept, kErrorNotKept));
  EXPECT_EQ(failures_, 1);
}

TEST_F(FailingDatabaseTest, UnchangedReadWritesNothing) {
  const auto loaded = home();
  EXPECT_THAT(readPower(loaded).codes, ElementsAre(0, 0));
  EXPECT_EQ(store_->writes, 0);
}

TEST_F(FailingDatabaseTest, ReadSurvivesReadOnlyDatabase) {
  powerOf(store_->homes[0]).deviceValue = NDValue::boolean(true);
  const auto loaded = home();
  store_->isReadOnly = true;
  EXPECT_THAT(readPower(loaded).codes, ElementsAre(kErrorNotKept, 0));
}

TEST_F(FailingDatabaseTest, BatchIsOneTransaction) {
  const auto loaded = home();
  static_cast<void>(writePower(loaded));
  EXPECT_EQ(store_->writes, 1);
}

TEST_F(FailingDatabaseTest, ReadTakesValueWrittenMeanwhile) {
  powerOf(store_->homes[0]).deviceValue = NDValue::boolean(true);
  const auto loaded = home();
  store_->onWrite = [this] {  // another process writes first, this one covers its cached value
    store_->onWrite = nullptr;
    powerOf(store_->homes[0]).value = NDValue::boolean(true);
    powerOf(store_->homes[0]).deviceValue = NDValue::boolean(false);
    store_->number = 2;
  };
  EXPECT_THAT(readPower(loaded).codes, ElementsAre(0, 0));
  EXPECT_EQ(description(*store_->written.at(0).value), "0");
  EXPECT_EQ(power(loaded), "0");
}

TEST_F(FailingDatabaseTest, WriteToReplacedHomeIsUnreachable) {
  const auto loaded = home();
  store_->onWrite = [this] {
    store_->homes.clear();
    store_->number = 2;
  };
  EXPECT_THAT(writePower(loaded).codes, ElementsAre(kNDErrorUnreachable, kNDErrorOutOfRange));
}

TEST_F(FailingDatabaseTest, DroppedBatchIsNeverAnswered) {
  const auto loaded = home();
  queue_->shutDown();
  EXPECT_EQ(readPower(loaded).calls, 0);
}

}  // namespace
}  // namespace nidus
