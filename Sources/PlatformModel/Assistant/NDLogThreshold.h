#pragma once

#include <cstdint>

namespace nidus {

/// Which of its messages the plug-in logs, and what decided that.
struct NDLogThreshold {
  enum class Rule {
    level,           ///< "NidusLogLevel" counts, as it is.
    developerLevel,  ///< "NidusDeveloperLogLevel" counts: it lies between the floor and the
                     ///< greatest.
    floor,           ///< Neither counts.
  };
  std::int32_t level = 0;       ///< Messages of this level and those below it are logged.
  Rule rule = Rule::floor;      ///< Why.
  std::int32_t floor = 0;       ///< What counts when no preference does, by the kind of the build.
  std::int32_t leastLevel = 0;  ///< From here on "NidusLogLevel" counts.
  std::int32_t greatestDeveloperLevel = 0;  ///< Up to here "NidusDeveloperLogLevel" counts.
  bool isInternalBuild = false;             ///< As the process has learned when it asked first.
};

}  // namespace nidus
