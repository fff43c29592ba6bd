#include "HomePlatform/Objects/HomeCalls.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <utility>

#include "HomePlatform/PlatformProbe.h"
#include "HomePlatform/Store/HomeStore.h"

namespace nidus {
namespace {

using testing::ElementsAre;

/// A queue of the worst kind: of all work that waits, what came last runs first.
class NewestFirstQueue final : public NDQueue {
 public:
  void async(NDTask task) override { tasks_.push_back(std::move(task)); }
  void drain() {
    while (!tasks_.empty()) {
      const NDTask task = std::move(tasks_.back());
      tasks_.pop_back();
      task();
    }
  }

 private:
  std::vector<NDTask> tasks_;
};

/// A driver that notes what it is to write and answers nothing.
class NotingDriver final : public AccessoryDriver {
 public:
  void read(const NDUUID& /*home*/, std::vector<CharacteristicAddress> /*targets*/,
            DriverCompletion /*completion*/) override {}
  void write(const NDUUID& /*home*/, std::vector<DriverWrite> writes,
             DriverCompletion /*completion*/) override {
    for (const DriverWrite& write : writes) written.push_back(write.value->integerValue());
  }
  std::vector<std::int64_t> written;
};

TEST(HomeCallsTest, ReachTheDriverInOrder) {
  auto opened = HomeStore::open(std::nullopt);
  ASSERT_TRUE(opened);
  const std::shared_ptr<HomeStore> store = std::move(*opened);
  ASSERT_FALSE(store->replaceHomes({sampleHome()}));
  const auto library = std::make_shared<HomeLibrary>(store);
  const auto queue = std::make_shared<NewestFirstQueue>();
  const auto driver = std::make_shared<NotingDriver>();
  const auto calls = std::make_shared<HomeCalls>(
      HomeCalls::Parts{library, driver, queue, nullptr, [](const Failure&) { FAIL(); }});
  const auto home = (*library->current())->homes[0];
  const auto lamp = characteristicAt(home, brightnessAddress());

  for (int level = 1; level <= 3; ++level) {
    calls->write(home->uuid(), {{lamp, NDValue::integer(level)}}, [](const auto&, const auto&) {});
  }
  queue->drain();

  EXPECT_THAT(driver->written, ElementsAre(1, 2, 3));
}

}  // namespace
}  // namespace nidus
