#include "Load/EmbeddedStage.h"

#include <algorithm>
#include <chrono>
#include <future>
#include <stdexcept>
#include <utility>

#include "HomePlatform/System/DataFolder.h"
#include "Load/LoadHome.h"
#include "Load/Performance.h"
#include "Support/StandingClock.h"

namespace nidus {
namespace {

constexpr std::size_t kPending = 20;
/// Longer than any command takes on the slowest machine, so that a lost one is told of.
constexpr std::chrono::minutes kLongestCommand(5);

}  // namespace

EmbeddedStage::EmbeddedStage(StressRecord& record, std::size_t callers)
    : record_(record), callers_(callers), platform_(open()), other_(open()) {
  auto store = HomeStore::open(folder_.path() / kDatabaseFile);
  if (!store) throw std::runtime_error(store.failure().message);
  store_ = std::move(*store);
  std::vector<HomeData> homes = {loadHome(0, callers)};
  for (std::size_t home = 1; home < kLoadHomes; ++home) homes.push_back(loadHome(home, kLoadRooms));
  expectDone(platform_->importHomes(homes, false), "the first import");
  record_.expect(NDPlatform::registerPlatform(platform_).empty(), "a platform is registered",
                 "the begin");
  for (std::size_t room = 0; room < callers; ++room) {
    ownRooms_.emplace_back(
        room, record_, [this](const LoadCommand& command) { return performToEnd(command); },
        [this]() -> std::optional<std::size_t> {
          const std::size_t ended = importsEnded_;  // first, so that equal numbers mean rest
          return ended == importsBegun_ ? std::optional(ended) : std::nullopt;
        });
  }
}

EmbeddedStage::~EmbeddedStage() {
  leavePending();
  platform_->shutDown();
  NDPlatform::unregisterPlatform(platform_);
  platform_.reset();
  record_.expectNoSurvivors("after the end of the platform");
  record_.expect(record_.ended == record_.commands, "commands never end", "the end");
}

std::shared_ptr<HomePlatform> EmbeddedStage::open() {
  auto opened =
      HomePlatform::open({.dataFolder = folder_.path(),
                          .locked = true,
                          .clock = std::make_shared<StandingClock>(),
                          .logSink = [](const NDSystemLogMessage&) {},
                          .failureHandler =
                              [this](const Failure& failure) {
                                record_.complain("a failure of the platform", failure.message);
                              }});
  if (!opened) throw std::runtime_error(opened.failure().message);
  return *opened;
}

void EmbeddedStage::beginRound(std::size_t /*commands*/, Random& /*random*/) {}

void EmbeddedStage::command(std::size_t caller, Random& random) {
  if (random.oneIn(2)) {
    ownRooms_.at(caller).step();
  } else {
    static_cast<void>(performToEnd(CommandMix{.homes = {1, 2}, .rooms = kLoadRooms}.draw(random)));
  }
}

/// Performs a command, waits for its end, and judges what can be judged of any.
Replies EmbeddedStage::performToEnd(const LoadCommand& command) {
  auto end = std::make_shared<std::promise<Replies>>();
  auto over = end->get_future();
  perform(command, record_, [end](const Replies& replies) { end->set_value(replies); });
  if (over.wait_for(kLongestCommand) != std::future_status::ready) {
    record_.complain("a command does not end", command.description());
    return {};
  }
  Replies replies = over.get();
  for (const auto& fault : judge(command, std::nullopt, replies)) {
    record_.complain(fault, command.description());
  }
  return replies;
}

void EmbeddedStage::sync(std::size_t /*caller*/, Random& /*random*/) {
  const auto entities = performSync(record_, nullptr);
  const NDString home = homeName(0);
  const auto isOfHome = [&home](const auto& entity) {
    return entity->home() == home || entity->name() == home;
  };
  const auto count = std::count_if(entities.begin(), entities.end(), isOfHome);
  record_.expect(static_cast<std::size_t>(count) == entityCount(callers_),
                 "entities of an unchanged home are lost or invented", "a sync");
}

void EmbeddedStage::change(std::size_t /*caller*/, Random& random) {
  HomePlatform& platform = random.oneIn(2) ? *platform_ : *other_;
  const std::size_t number = 1 + random.below(kLoadHomes - 1);
  HomeData changed = changedHome(number, kLoadRooms, random);
  changed.primary = false;
  const auto isSame = [&changed](const HomeData& home) { return home.uuid == changed.uuid; };
  switch (random.below(8)) {
    case 0:
      importAll(platform, random);
      break;
    case 1:
    case 2:
      expectDone(platform.importHomes({changed}, true), "a merge");
      break;
    case 3:
      expectDone(platform.editHomes([&isSame](std::vector<HomeData>& homes) {
        std::erase_if(homes, isSame);
        return Status();
      }),
                 "a removal");
      break;
    case 4:
    case 5:
      expectDone(platform.editHomes([&](std::vector<HomeData>& homes) {
        const auto found = std::find_if(homes.begin(), homes.end(), isSame);
        if (found == homes.end())
          homes.push_back(changed);
        else
          *found = changed;
        return Status();
      }),
                 "an edit");
      break;
    default:
      writeValues(random);
  }
  ++record_.changes;
}

/// Puts other homes in the place of all; what callers have written is taken back.
void EmbeddedStage::importAll(HomePlatform& platform, Random& random) {
  std::vector<HomeData> homes = {loadHome(0, callers_)};
  for (std::size_t home = 1; home < kLoadHomes; ++home) {
    homes.push_back(changedHome(home, kLoadRooms, random));
  }
  ++importsBegun_;
  expectDone(platform.importHomes(homes, false), "an import");
  ++importsEnded_;
}

/// What another process does that writes values.
void EmbeddedStage::writeValues(Random& random) {
  const std::size_t home = 1 + random.below(kLoadHomes - 1);
  const std::size_t room = random.below(kLoadRooms);
  const std::size_t lamp = random.below(kLampsPerRoom);
  const NDValueRef level = NDValue::integer(static_cast<std::int64_t>(random.below(100)));
  expectDone(
      store_->writeValues({{loadHome(home, 0).uuid, brightnessOf(home, room, lamp), level, level}}),
      "a write of values");
}

void EmbeddedStage::expectDone(const Status& status, const std::string& what) {
  if (status) record_.complain(what + " fails", status->message);
}

void EmbeddedStage::runMainQueue(const std::function<bool()>& haveCallersGone) {
  platform_->mainQueue()->runUntil(haveCallersGone);
}

void EmbeddedStage::wakeMainQueue() { platform_->mainQueue()->wake(); }

void EmbeddedStage::endRound() {
  platform_->drain();
  const auto survivors = record_.lives.survivors();
  for (const auto& [kind, count] : survivors) {
    record_.complain(kind + " are left over", std::to_string(count) + " after a round");
  }
  record_.expect(record_.ended == record_.commands, "commands never end", "the end of a round");
  compareLevels();
}

/// What was answered as written is in the database.
void EmbeddedStage::compareLevels() {
  const auto homes = other_->exportHomes();
  if (!homes) return expectDone(homes.failure(), "an export");
  const auto isFirst = [](const HomeData& home) { return home.name == homeName(0); };
  const auto home = std::find_if(homes->begin(), homes->end(), isFirst);
  record_.expect(home != homes->end(), "a home is lost", "the end of a round");
  if (home == homes->end()) return;
  for (std::size_t room = 0; room < callers_; ++room) {
    const auto level = ownRooms_[room].level();
    const CharacteristicAddress address = brightnessOf(0, room, 1);
    for (const auto& lamp : home->accessories) {
      if (lamp.uuid != address.accessory || !level) continue;
      const auto& value = lamp.services.front().characteristics.back().value;
      record_.expect(value && value->integerValue() == *level, "a written value is lost",
                     roomName(0, room).str());
    }
  }
}

/// Commands whose homes never come; they are over when the platform is shut down.
void EmbeddedStage::leavePending() {
  platform_->setSilent(true);
  for (std::size_t i = 0; i < kPending; ++i) {
    const LoadCommand command{.actionType = "GET"};
    perform(command, record_, [this](const Replies& replies) {
      record_.expect(replies.empty(), "a reply without homes", "a silent platform");
    });
  }
  platform_->drain();
  record_.expect(record_.commands == record_.ended + kPending, "pending commands have ended early",
                 "a silent platform");
}

}  // namespace nidus
