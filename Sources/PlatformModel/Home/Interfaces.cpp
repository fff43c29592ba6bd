#include "PlatformModel/Home/NDAccessory.h"
#include "PlatformModel/Home/NDActionSet.h"
#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/Home/NDCharacteristicMetadata.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/Home/NDRoom.h"
#include "PlatformModel/Home/NDService.h"
#include "PlatformModel/Home/NDServiceGroup.h"
#include "PlatformModel/Home/NDTrigger.h"
#include "PlatformModel/Home/NDZone.h"

// The classes that platforms derive from have their type information here, in the library that the
// module and the process that opens it share, and nowhere else.

namespace nidus {

NDAccessory::~NDAccessory() = default;
NDActionSet::~NDActionSet() = default;
NDCharacteristic::~NDCharacteristic() = default;
NDCharacteristicMetadata::~NDCharacteristicMetadata() = default;
NDHome::~NDHome() = default;
NDRoom::~NDRoom() = default;
NDService::~NDService() = default;
NDServiceGroup::~NDServiceGroup() = default;
NDTrigger::~NDTrigger() = default;
NDZone::~NDZone() = default;

}  // namespace nidus
