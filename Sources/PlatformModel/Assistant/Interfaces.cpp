#include "PlatformModel/Assistant/AFServiceCommand.h"
#include "PlatformModel/Assistant/AFSyncHandler.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"

// The classes that cross the border between the module and the process that opens it have their
// type information here, in the library that both share, and nowhere else.

namespace nidus {

AFServiceCommand::~AFServiceCommand() = default;
AFSyncBeginInfo::~AFSyncBeginInfo() = default;
AFSyncChangeInfo::~AFSyncChangeInfo() = default;
AFSyncHandler::~AFSyncHandler() = default;
NDAssistantCommandObserver::~NDAssistantCommandObserver() = default;

}  // namespace nidus
