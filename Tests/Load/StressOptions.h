#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "Load/StressRecord.h"

namespace nidus {

/// How the stress program is run.
struct StressOptions {
  enum class Platform { unruly, embedded };
  Platform platform = Platform::unruly;
  std::size_t commands = 20'000;       ///< How many are given, when no time is.
  std::optional<std::size_t> seconds;  ///< For how long commands are given.
  std::size_t round = 10'000;          ///< After how many commands everything comes to rest.
  std::size_t threads = 8;
  std::optional<std::uint64_t> seed;
  std::size_t growthKiB = 4'096;  ///< By how much the memory may grow after the first round.
  Plant plant = Plant::nothing;
  bool showsHelp = false;

  /// Reads the arguments of the program, or says in `message` what is wrong with them.
  [[nodiscard]] static std::optional<StressOptions> read(const std::vector<std::string>& arguments,
                                                         std::string& message);
  [[nodiscard]] static const char* help();
};

}  // namespace nidus
