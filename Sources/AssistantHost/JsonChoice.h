#pragma once

#include <string_view>
#include <vector>

#include "HomePlatform/Json/JsonObject.h"

namespace nidus {

/// Gives the one of `keys` that `object` has, be its value null: it stands for what kind of thing
/// the object is. Throws `JsonError` when the object has none of them or more than one.
[[nodiscard]] std::string_view chosenKey(const JsonPlaced& object,
                                         const std::vector<std::string_view>& keys);

}  // namespace nidus
