#pragma once

#include <string>
#include <vector>

#include "nidus/HomeEditing/HomeObjects.h"

namespace nidus {

/// Removes an object with all that is in it, and what refers to it: accessories of a room then
/// stand in no room, services leave their groups, actions leave their scenes. Gives the object and
/// what else is touched, to be put behind "remove": "the room Kitchen of Beach House, putting its 4
/// accessories into no room and taking it out of 1 zone". A failure is bad input, and nothing has
/// been changed.
[[nodiscard]] Result<std::string> removeObject(std::vector<HomeData>& homes,
                                               const ObjectWords& words);

}  // namespace nidus
