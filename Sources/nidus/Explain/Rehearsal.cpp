#include "nidus/Explain/Rehearsal.h"

#include <utility>

#include "PlatformModel/Home/NDAccessory.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/Home/NDService.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {

struct RehearsalStage::Notes {
  Rehearsal rehearsal;
};

namespace {

constexpr const char kLogLevel[] = "NidusLogLevel";
constexpr std::int64_t kEveryLevel = 7;

/// The place of a characteristic; one whose home is gone has none.
std::optional<HomeCharacteristic> placeOf(const NDCharacteristic& characteristic) {
  const auto service = characteristic.service();
  const auto accessory = property(service, &NDService::accessory);
  const auto home = property(accessory, &NDAccessory::home);
  if (!home) return std::nullopt;
  return HomeCharacteristic{
      home->uuid(), {accessory->uuid(), service->instanceID(), characteristic.instanceID()}};
}

/// Notes what the plug-in tells of a command.
class NotingObserver final : public NDAssistantCommandObserver {
 public:
  explicit NotingObserver(Rehearsal& rehearsal) : rehearsal_(rehearsal) {}

  void filterDidRunStep(std::string_view step, const NDDictionaryList& kept) override {
    rehearsal_.steps.push_back({std::string(step), kept});
  }

  void actionDidReach(const std::vector<std::shared_ptr<NDCharacteristic>>& reached) override {
    for (const auto& characteristic : reached) {
      if (const auto place = placeOf(*characteristic)) rehearsal_.reached.push_back(*place);
    }
  }

 private:
  Rehearsal& rehearsal_;
};

/// Has each device answer what was known of it last, so that nothing seems to be asked of it.
std::vector<HomeData> answeringFromMemory(std::vector<HomeData> homes) {
  for (HomeData& home : homes) {
    for (AccessoryData& accessory : home.accessories) {
      for (ServiceData& service : accessory.services) {
        for (CharacteristicData& characteristic : service.characteristics) {
          characteristic.deviceValue = characteristic.value;
        }
      }
    }
  }
  return homes;
}

/// How to open a copy of `platform`; its homes are still missing.
HomePlatformOptions copyOptions(HomePlatform& platform, bool isLocked) {
  HomePlatformOptions options;
  options.locked = isLocked;
  // Everything has been seen when the drain returns.
  options.drainsOnCaller = true;
  options.metric = platform.locale()->usesMetricSystem();
  options.vocabulary = platform.vocabulary();
  options.preferences = platform.preferenceValues();
  options.preferences[kLogLevel] = JsonValue{kEveryLevel};
  return options;
}

}  // namespace

Result<std::unique_ptr<RehearsalStage>> RehearsalStage::open(Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return session.failure();
  HomePlatform& platform = (*session)->platform();
  auto exported = platform.exportHomes();
  if (!exported) return exported.failure();
  std::vector<HomeData> homes = answeringFromMemory(std::move(*exported));
  HomePlatformOptions options = copyOptions(platform, workspace.settings().isLocked);
  workspace.close();

  const auto notes = std::make_shared<Notes>();
  options.homes = homes;
  options.callObserver = [notes](const PlatformCall& call) {
    notes->rehearsal.calls.push_back(call);
  };
  options.logSink = [notes](const NDSystemLogMessage& message) {
    notes->rehearsal.log.push_back(message);
  };
  auto copy = Session::open(std::move(options));
  if (!copy) return copy.failure();
  if (auto failure = (*copy)->openModule()) return *failure;
  return std::unique_ptr<RehearsalStage>(
      new RehearsalStage(std::move(homes), notes, std::move(*copy)));
}

RehearsalStage::RehearsalStage(std::vector<HomeData> homes, std::shared_ptr<Notes> notes,
                               std::unique_ptr<Session> session)
    : homes_(std::move(homes)), notes_(std::move(notes)), session_(std::move(session)) {}

Result<Rehearsal> RehearsalStage::perform(const VAHACommand& command) {
  notes_->rehearsal = {};
  const auto observer = std::make_shared<NotingObserver>(notes_->rehearsal);
  auto replies = session_->runner().perform(command, observer);
  if (!replies) return replies.failure();
  auto after = platform().exportHomes();
  if (!after) return after.failure();
  notes_->rehearsal.replies = std::move(*replies);
  notes_->rehearsal.after = std::move(*after);
  return std::move(notes_->rehearsal);
}

}  // namespace nidus
