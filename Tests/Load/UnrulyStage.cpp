#include "Load/UnrulyStage.h"

#include <algorithm>
#include <utility>

#include "Load/LoadHome.h"
#include "Load/Performance.h"
#include "Load/UnrulyHome.h"
#include "Logging/WLOLog.h"

namespace nidus {
namespace {

constexpr std::size_t kGreatestWaiting = 128;

}  // namespace

UnrulyStage::UnrulyStage(StressRecord& record, std::size_t callers)
    : record_(record), kept_(callers) {}

UnrulyStage::~UnrulyStage() = default;

void UnrulyStage::beginRound(std::size_t commands, Random& random) {
  isAbrupt_ = random.oneIn(3);
  abruptEnd_ = record_.commands + commands * 9 / 10;
  platform_ = std::make_shared<UnrulyPlatform>(
      services_, UnrulyPlatform::Habits{.seed = random.seed(), .isPatient = !isAbrupt_},
      record_.lives);
  services_.preferences->configureHomes(true);
  record_.expect(NDPlatform::registerPlatform(platform_).empty(), "a platform stays registered",
                 "the begin of a round");
  // The log is connected by the first who asks, here, before others post to those who listen.
  static_cast<void>(WLOShouldLogAtLevel(0));
  changeHomes(random);
}

void UnrulyStage::command(std::size_t caller, Random& random) {
  platform_->answers()->waitUntilFewer(kGreatestWaiting);
  const CommandMix mix{.homes = {0, 1, 2}, .rooms = kLoadRooms, .isHomeNamed = false};
  const LoadCommand command = mix.draw(random);
  const auto ledger = std::make_shared<Ledger>();
  const Ledger::Scope scope(ledger);
  auto performed = perform(command, record_, [this, command, ledger](const Replies& replies) {
    for (const auto& fault : judge(command, ledger->facts(), replies)) {
      record_.complain(fault, command.description());
    }
  });
  if (random.oneIn(4)) kept_[caller] = std::move(performed);
}

void UnrulyStage::sync(std::size_t /*caller*/, Random& /*random*/) {
  performSync(record_, std::make_shared<Ledger>());
}

void UnrulyStage::change(std::size_t /*caller*/, Random& random) {
  switch (random.below(8)) {
    case 0:
      services_.preferences->configureHomes(!random.oneIn(8));
      break;
    case 1:
      services_.preferences->setInteger("NidusLogLevel", random.oneIn(4) ? 6 : 3);
      services_.notifications->post();
      services_.log->clearMessages();
      break;
    default:
      changeHomes(random);
  }
}

/// New homes, so that those of before end as soon as nobody looks at them.
void UnrulyStage::changeHomes(Random& random) {
  std::vector<std::shared_ptr<NDHome>> homes;
  for (std::size_t number = 0; number < kLoadHomes; ++number) {
    if (random.oneIn(5)) continue;
    HomeData data = changedHome(number, kLoadRooms, random);
    if (random.oneIn(16)) data.primary = !data.primary;
    homes.push_back(UnrulyHome::make(data, random, platform_->answers()));
    record_.lives.add("homes", homes.back());
  }
  if (!homes.empty()) std::swap(homes.front(), homes[random.below(homes.size())]);
  platform_->setHomes(NDArray<NDHome>(std::move(homes)));
  ++record_.changes;
}

void UnrulyStage::runMainQueue(const std::function<bool()>& haveCallersGone) {
  // An abrupt round ends while callers still give commands.
  const auto isTime = [&] {
    return haveCallersGone() || (isAbrupt_ && record_.commands >= abruptEnd_);
  };
  platform_->mainQueue()->runUntil(isTime);
  if (isAbrupt_) platform_->shutDown();
  platform_->mainQueue()->runUntil(haveCallersGone);
}

void UnrulyStage::wakeMainQueue() { platform_->mainQueue()->wake(); }

void UnrulyStage::endRound() {
  if (!isAbrupt_) platform_->settle();
  platform_->shutDown();
  platform_->mainQueue()->drain();
  NDPlatform::unregisterPlatform(platform_);
  platform_.reset();
  std::fill(kept_.begin(), kept_.end(), nullptr);
  services_.log->clearMessages();
  record_.expectNoSurvivors("after the end of the platform");
  record_.expect(record_.ended == record_.commands, "commands never end", "the end of a round");
}

}  // namespace nidus
