#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/PlatformProbe.h"
#include "PlatformModel/System/NDDeliveryHold.h"
#include "PlatformModel/System/NDWaitGroup.h"

namespace nidus {
namespace {

TEST(HomeDeliveryTest, ReportsHomesInOrder) {
  const OpenPlatform platform(onCaller());
  HomeData second = sampleHome();
  second.uuid = uuidOf(kRoomID);
  ASSERT_FALSE(platform->importHomes({sampleHome(), second}, false));
  const auto homes = platform.homes();
  ASSERT_EQ(homes.size(), 2U);
  EXPECT_EQ(homes[0]->uuid(), uuidOf(kHomeID));
  EXPECT_EQ(homes[1]->uuid(), uuidOf(kRoomID));
}

TEST(HomeDeliveryTest, ManagersShareUnchangedHomes) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto first = platform.homes();
  EXPECT_EQ(platform.homes()[0], first[0]);
  static_cast<void>(write(*platform, first[0], {{powerAddress(), NDValue::boolean(true)}}));
  EXPECT_EQ(platform.homes()[0], first[0]);
}

TEST(HomeDeliveryTest, ChangedHomesComeAsNewList) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto before = platform.homes();
  ASSERT_FALSE(platform->importHomes({sampleHome()}, true));
  EXPECT_NE(platform.homes()[0], before[0]);
  EXPECT_EQ(before[0]->accessories().size(), 2U);
}

TEST(HomeDeliveryTest, EmptyManagerHasNoHomesBeforeReport) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto manager = platform->createHomeManager();
  EXPECT_TRUE(manager->homes().empty());
  platform->drain();
  EXPECT_EQ(manager->homes().size(), 1U);
}

TEST(HomeDeliveryTest, HoldKeepsHomesBack) {
  const OpenPlatform platform(onCaller());
  const auto delegate = std::make_shared<DelegateProbe>();
  std::shared_ptr<NDHomeManager> manager;
  {
    const NDDeliveryHold hold;
    manager = platform->createHomeManager();
    manager->setDelegate(delegate);
    EXPECT_EQ(delegate->updates, 0);
  }
  platform->drain();
  EXPECT_EQ(delegate->updates, 1);
}

TEST(HomeDeliveryTest, DrainLetsHeldHomesGo) {
  const OpenPlatform platform({});
  const NDDeliveryHold hold;
  const auto delegate = std::make_shared<DelegateProbe>();
  const auto manager = platform->createHomeManager();
  manager->setDelegate(delegate);
  platform->drain();
  EXPECT_EQ(delegate->updates, 1);
}

TEST(HomeDeliveryTest, WaitRunsDeliveriesOnCaller) {
  const OpenPlatform platform(onCaller());
  NDWaitGroup group(platform->clock());
  group.enter();
  platform->sharedQueue()->async([&group] { group.leave(); });
  EXPECT_TRUE(group.wait(std::chrono::seconds(2)));
}

TEST(HomeDeliveryTest, HopelessWaitEndsAtOnceOnCaller) {
  const OpenPlatform platform(onCaller());
  const auto start = platform->clock()->now();
  NDWaitGroup group(platform->clock());
  group.enter();
  EXPECT_FALSE(group.wait(std::chrono::seconds(2)));
  EXPECT_EQ(platform->clock()->now() - start, std::chrono::seconds(2));
}

TEST(HomeDeliveryTest, WaitLeavesMainQueueAlone) {
  const OpenPlatform platform(onCaller());
  bool hasRun = false;
  platform->mainQueue()->async([&hasRun] { hasRun = true; });
  NDWaitGroup group(platform->clock());
  group.enter();
  EXPECT_FALSE(group.wait(std::chrono::seconds(2)));
  EXPECT_FALSE(hasRun);
}

TEST(HomeDeliveryTest, SilentManagerNeverReports) {
  const OpenPlatform platform(onCaller());
  platform->setSilent(true);
  const auto delegate = std::make_shared<DelegateProbe>();
  const auto manager = platform->createHomeManager();
  manager->setDelegate(delegate);
  platform->setSilent(false);
  platform->drain();
  EXPECT_EQ(delegate->updates, 0);
  EXPECT_EQ(platform.homes().size(), 0U);
  platform->shutDown();
  EXPECT_EQ(delegate->refusals, 1);
}

TEST(HomeDeliveryTest, ShutDownTellsThoseStillWaiting) {
  const OpenPlatform platform(onCaller());
  const auto waiting = std::make_shared<DelegateProbe>();
  const auto served = std::make_shared<DelegateProbe>();
  const auto servedManager = platform->createHomeManager();
  servedManager->setDelegate(served);
  platform->drain();
  const auto waitingManager = platform->createHomeManager();
  waitingManager->setDelegate(waiting);
  platform->shutDown();
  platform->shutDown();
  EXPECT_EQ(waiting->refusals, 1);
  EXPECT_EQ(served->refusals, 0);
  EXPECT_EQ(served->updates, 1);
}

TEST(HomeDeliveryTest, ManagerAfterShutDownIsTold) {
  const OpenPlatform platform(onCaller());
  platform->shutDown();
  const auto delegate = std::make_shared<DelegateProbe>();
  std::shared_ptr<NDHomeManager> manager;
  {
    const NDDeliveryHold hold;
    manager = platform->createHomeManager();
    manager->setDelegate(delegate);
    EXPECT_EQ(delegate->refusals, 0);
  }
  EXPECT_EQ(delegate->refusals, 1);
}

TEST(HomeDeliveryTest, ShutDownFreesPendingBatches) {
  const OpenPlatform platform({});
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto home = platform.homes()[0];
  const auto kept = std::make_shared<int>(0);
  for (int batch = 0; batch < 100; ++batch) {
    home->readCharacteristicValues_withCompletionHandler({characteristicAt(home, powerAddress())},
                                                         [kept](const auto&, const auto&) {});
  }
  platform->shutDown();
  EXPECT_EQ(kept.use_count(), 1);
}

TEST(HomeDeliveryTest, NothingOutlivesThePlatform) {
  std::weak_ptr<NDHome> home;
  std::weak_ptr<NDHomeManager> manager;
  {
    const OpenPlatform platform({});
    ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
    home = platform.homes()[0];
    manager = platform->createHomeManager();
  }
  EXPECT_TRUE(home.expired());
  EXPECT_TRUE(manager.expired());
}

/// Commands of many threads, each of which asks for its homes under nested holds.
TEST(HomeDeliveryTest, EveryHeldManagerReportsAfterItsHold) {
  constexpr int kThreads = 4;
  constexpr int kRounds = 200;
  const OpenPlatform platform({});
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  std::atomic<int> early{0};
  std::atomic<int> reported{0};
  class Delegate final : public NDHomeManagerDelegate {
   public:
    Delegate(std::atomic<int>& earlyCount, std::atomic<int>& reportCount)
        : early_(earlyCount), reported_(reportCount) {}
    void homeManagerDidUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) override {
      if (!isAsked.load()) ++early_;
      if (manager->homes().size() == 1) ++reported_;
    }
    void homeManagerWillNotUpdateHomes(const std::shared_ptr<NDHomeManager>& /*manager*/) override {
      ADD_FAILURE() << "the platform was not shut down";
    }
    std::atomic<bool> isAsked{false};

   private:
    std::atomic<int>& early_;
    std::atomic<int>& reported_;
  };
  const auto work = [&] {
    std::vector<std::shared_ptr<Delegate>> delegates;
    std::vector<std::shared_ptr<NDHomeManager>> managers;
    for (int round = 0; round < kRounds; ++round) {
      const NDDeliveryHold outer;
      for (int nested = 0; nested < 2; ++nested) {
        const NDDeliveryHold inner;
        managers.push_back(platform->createHomeManager());
        delegates.push_back(std::make_shared<Delegate>(early, reported));
        managers.back()->setDelegate(delegates.back());
        std::this_thread::yield();
        delegates.back()->isAsked = true;
      }
    }
    platform->drain();
  };
  std::vector<std::thread> threads;
  for (int thread = 0; thread < kThreads; ++thread) threads.emplace_back(work);
  for (auto& thread : threads) thread.join();
  platform->drain();
  EXPECT_EQ(early.load(), 0);
  EXPECT_EQ(reported.load(), kThreads * kRounds * 2);
}

TEST(HomeDeliveryTest, DrainSeesTheLastOfAChain) {
  const OpenPlatform platform({});
  for (int round = 0; round < 200; ++round) {
    std::atomic<int> steps{0};
    platform->sharedQueue()->async([&] {
      ++steps;
      platform->mainQueue()->async([&] {
        ++steps;
        platform->sharedQueue()->async([&] { ++steps; });
      });
    });
    platform->drain();
    ASSERT_EQ(steps.load(), 3);
  }
}

}  // namespace
}  // namespace nidus
