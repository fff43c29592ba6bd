#pragma once

#include <cstddef>
#include <string_view>

namespace nidus {

/// The size of the home unless another one is asked for.
inline constexpr std::size_t kServicesOfRoad = 1'000;

/// Goes one of the roads whose instructions are counted (Tools/count-instructions) in a home of so
/// many services, a multiple of 100: once to warm up, then once more within the function
/// `nidusCountedRoad`, on one thread and with the same identifiers each time. False when there is
/// no road of that name, or when it leads somewhere else than it should.
[[nodiscard]] bool goRoad(std::string_view name, std::size_t services);

}  // namespace nidus
