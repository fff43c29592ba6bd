#include <memory>

#include "PlatformModel/Assistant/NDAssistantModule.h"

namespace nidus {
namespace {

/// Lets go of its handler without a reply.
class SilentCommand final : public AFServiceCommand {
 public:
  void performWithCompletion(VAHAReplyHandler /*handler*/) override {}
};

/// Never resets and has no entities.
class SilentSync final : public AFSyncHandler {
 public:
  void beginSyncWithAnchor_validity_forKey_beginInfo(
      const NDString& /*anchor*/, const NDString& /*validity*/, const NDString& /*key*/,
      std::shared_ptr<AFSyncBeginInfo> /*beginInfo*/) override {}
  void getChangeAfterAnchor_changeInfo(const NDString& anchor,
                                       AFSyncChangeInfo& changeInfo) override {
    changeInfo.setPostAnchor(anchor);
  }
  void syncDidEnd() override {}
};

// The module's interface gives the types of the arguments.
// NOLINTBEGIN(performance-unnecessary-value-param)

std::shared_ptr<AFServiceCommand> makeCommand(
    const VAHACommand& /*request*/, std::shared_ptr<NDAssistantCommandObserver> /*observer*/,
    std::string& /*message*/) {
  return std::make_shared<SilentCommand>();
}

std::shared_ptr<AFSyncHandler> makeSyncHandler(std::string& /*message*/) {
  return std::make_shared<SilentSync>();
}

bool gatherRecords(std::function<void(const NDDictionaryList& records)> /*receive*/,
                   std::string& /*message*/) {
  return true;
}

bool readLogThreshold(nidus::NDLogThreshold& /*threshold*/, std::string& message) {
  message = "this module has no log";
  return false;
}

// NOLINTEND(performance-unnecessary-value-param)

}  // namespace
}  // namespace nidus

extern "C" ND_EXPORT const nidus::NDAssistantModule* NDAssistantModuleEntry() {
  static constexpr nidus::NDAssistantModule kModule = {
      nidus::kNDAssistantModuleInterfaceVersion + NIDUS_INTERFACE_OFFSET,
      nidus::kNDAssistantModuleABI,
      nidus::makeCommand,
      nidus::makeSyncHandler,
      nidus::gatherRecords,
      nidus::readLogThreshold};
  return &kModule;
}
