#pragma once

#include <string_view>

namespace nidus {

/// Goes one of the roads whose instructions are counted (Tools/ratchet): once to warm up, then once
/// more within the function `nidusCountedRoad`, on one thread and with the same identifiers each
/// time. False when there is no road of that name, or when it leads somewhere else than it should.
[[nodiscard]] bool goRoad(std::string_view name);

}  // namespace nidus
