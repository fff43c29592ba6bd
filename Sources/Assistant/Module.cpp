#include <exception>

#include "Assistant/NDAssistantCommand.h"
#include "Assistant/NDAssistantSyncHome.h"
#include "Logging/WLOThreshold.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"
#include "PlatformModel/NDPlatform.h"
#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

bool hasPlatform(std::string& message) {
  if (NDPlatform::registered()) return true;
  message = "no home platform is registered; register one before the plug-in is used";
  return false;
}

std::shared_ptr<AFServiceCommand> makeCommand(const VAHACommand& request,
                                              std::shared_ptr<NDAssistantCommandObserver> observer,
                                              std::string& message) try {
  if (!hasPlatform(message)) return nullptr;
  return std::make_shared<NDAssistantCommand>(request, std::move(observer));
} catch (const std::exception& error) {
  message = error.what();
  return nullptr;
}

std::shared_ptr<AFSyncHandler> makeSyncHandler(std::string& message) try {
  if (!hasPlatform(message)) return nullptr;
  return NDAssistantSyncHome::init();
} catch (const std::exception& error) {
  message = error.what();
  return nullptr;
}

NDDictionaryList dictionariesOf(const HomeObjectRecords& records) {
  NDDictionaryList list;
  for (const HomeObjectRecord& record : records) list.emplace_back(record.dictionary());
  return list;
}

bool gatherRecords(std::function<void(const NDDictionaryList&)> receive, std::string& message) try {
  if (!hasPlatform(message)) return false;
  const NDDeliveryHold hold;
  const auto gather = NDAssistantGather::init();
  if (!gather) {
    receive({});
    return true;
  }
  gather->startWithCompletionHandler([gather, receive = std::move(receive)](long count) {
    receive(count == 0 ? NDDictionaryList() : dictionariesOf(gather->gatherNidusObjects()));
  });
  return true;
} catch (const std::exception& error) {
  message = error.what();
  return false;
}

bool readLogThreshold(NDLogThreshold& threshold, std::string& message) try {
  if (!hasPlatform(message)) return false;
  threshold = readThreshold(*NDPlatform::registered());
  return true;
} catch (const std::exception& error) {
  message = error.what();
  return false;
}

constinit const NDAssistantModule kModule = {kNDAssistantModuleInterfaceVersion,
                                             kNDAssistantModuleABI,
                                             &makeCommand,
                                             &makeSyncHandler,
                                             &gatherRecords,
                                             &readLogThreshold};

}  // namespace
}  // namespace nidus

extern "C" ND_EXPORT const nidus::NDAssistantModule* NDAssistantModuleEntry() {
  return &nidus::kModule;
}
