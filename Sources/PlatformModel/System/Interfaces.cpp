#include "PlatformModel/System/NDDeviceInformation.h"
#include "PlatformModel/System/NDLocale.h"
#include "PlatformModel/System/NDNotificationCenter.h"
#include "PlatformModel/System/NDPreferences.h"
#include "PlatformModel/System/NDQueue.h"
#include "PlatformModel/System/NDSystemLog.h"

// The classes that platforms derive from have their type information here, in the library that the
// module and the process that opens it share, and nowhere else.

namespace nidus {

NDDeviceInformation::~NDDeviceInformation() = default;
NDLocale::~NDLocale() = default;
NDNotificationCenter::Token::~Token() = default;
NDNotificationCenter::~NDNotificationCenter() = default;
NDPreferences::~NDPreferences() = default;
NDQueue::~NDQueue() = default;
NDSystemLogClient::~NDSystemLogClient() = default;
NDSystemLog::~NDSystemLog() = default;

}  // namespace nidus
