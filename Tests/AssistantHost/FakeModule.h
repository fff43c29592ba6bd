#pragma once

#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "PlatformModel/Assistant/NDAssistantModule.h"

namespace nidus {

/// A module within the test program whose answers the test chooses. One at a time, as the
/// operations of a module carry no state.
class FakeModule {
 public:
  FakeModule() { current = this; }
  ~FakeModule() { current = nullptr; }
  FakeModule(const FakeModule&) = delete;
  FakeModule& operator=(const FakeModule&) = delete;

  /// What a command does; empty refuses to make one.
  std::function<void(VAHAReplyHandler)> perform;
  /// What a snapshot does; empty refuses it.
  std::function<void(std::function<void(const NDDictionaryList&)>)> gather;
  /// The handler of syncs; null refuses them.
  std::shared_ptr<AFSyncHandler> syncHandler;

  [[nodiscard]] const NDAssistantModule& module() const { return kModule; }

 private:
  class Command final : public AFServiceCommand {
   public:
    void performWithCompletion(VAHAReplyHandler handler) override {
      current->perform(std::move(handler));
    }
  };

  static std::shared_ptr<AFServiceCommand> makeCommand(
      const VAHACommand& /*request*/,
      // NOLINTNEXTLINE(performance-unnecessary-value-param): the module's interface has it so
      std::shared_ptr<NDAssistantCommandObserver> /*observer*/, std::string& message) {
    if (current->perform) return std::make_shared<Command>();
    message = "no platform is registered";
    return nullptr;
  }
  static std::shared_ptr<AFSyncHandler> makeSyncHandler(std::string& message) {
    if (!current->syncHandler) message = "no platform is registered";
    return current->syncHandler;
  }
  static bool gatherRecords(std::function<void(const NDDictionaryList&)> receive,
                            std::string& message) {
    if (current->gather) {
      current->gather(std::move(receive));
      return true;
    }
    message = "no platform is registered";
    return false;
  }

  static bool readLogThreshold(NDLogThreshold& /*threshold*/, std::string& message) {
    message = "no platform is registered";
    return false;
  }

  static inline FakeModule* current = nullptr;
  static constexpr NDAssistantModule kModule = {kNDAssistantModuleInterfaceVersion,
                                                kNDAssistantModuleABI,
                                                makeCommand,
                                                makeSyncHandler,
                                                gatherRecords,
                                                readLogThreshold};
};

}  // namespace nidus
