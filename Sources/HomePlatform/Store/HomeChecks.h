#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Checks what holds between the parts of one home: UUIDs and instance IDs stand once, what is
/// listed is listed once, and every reference leads somewhere. `place` is the home's JSON pointer.
/// Throws a `JsonError` with the place of the first part that breaks it.
void checkHome(const HomeData& home, const std::string& place);

/// Checks that no two homes have the same UUID. `place` is the document's JSON pointer.
void checkHomesAreUnique(const std::vector<HomeData>& homes, const std::string& place);

/// Checks both for all of `homes`. The failure is bad input, calls the homes `name` and has the
/// place of the first part that breaks it.
[[nodiscard]] Status checkHomes(const std::vector<HomeData>& homes, const std::string& name);

}  // namespace nidus
