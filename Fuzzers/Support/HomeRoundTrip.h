#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// The document of `homes`, each part on a line of its own.
[[nodiscard]] std::string homeDocumentOf(const std::vector<HomeData>& homes);

/// Checks that homes out of a document survive: written and read again they are the same, in
/// either layout, and so they are when they come out of a database. A finding ends the process.
void checkHomesSurvive(const std::vector<HomeData>& homes);

}  // namespace nidus
