#pragma once

#include "HomePlatform/Objects/HomePart.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// The parts of a home that have nothing but a name.
using RoomObject = HomePart<NDRoom, RoomData>;
using ActionSetObject = HomePart<NDActionSet, ActionSetData>;
using TriggerObject = HomePart<NDTrigger, TriggerData>;

}  // namespace nidus
