#pragma once

#include <string>
#include <vector>

#include "nidus/HomeEditing/HomeObjects.h"

namespace nidus {

/// Renames an object. Gives what was done: "renamed the room Kitchen of Beach House to Galley". A
/// failure is bad input, and nothing has been changed.
[[nodiscard]] Result<std::string> renameObject(std::vector<HomeData>& homes,
                                               const ObjectWords& words,
                                               const std::string& newName);

}  // namespace nidus
