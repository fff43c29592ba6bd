#include "Logging/WLOThreshold.h"

#include <algorithm>
#include <atomic>
#include <limits>

#include "Logging/WLOLog.h"
#include "PlatformModel/System/NDRunOnce.h"

namespace nidus {
namespace {

constexpr const char* kDeveloperLevelKey = "NidusDeveloperLogLevel";
constexpr std::int32_t kLeastLevelTakenAsItIs = 3;
constexpr std::int32_t kGreatestDeveloperLevel = 7;
constexpr std::int32_t kGreatestLevel = std::numeric_limits<std::int32_t>::max();
constexpr std::int32_t kInternalFloor = 6;
constexpr std::int32_t kCustomerFloor = 4;

constinit std::atomic<bool> isInternalBuild{false};
constinit NDRunOnce internalBuildOnce;

void askForInternalBuild(NDPlatform& platform) {
  const NDValueRef answer = platform.deviceInformation()->answerForQuery("InternalBuild");
  if (answer && answer->isBoolean()) isInternalBuild = answer->boolValue();
}

/// Puts in the level of the first rule that applies.
void decide(NDLogThreshold& threshold, NDPreferences& preferences) {
  using Rule = NDLogThreshold::Rule;
  const auto take = [&threshold](Rule rule, std::int64_t level) {
    threshold.rule = rule;
    threshold.level = static_cast<std::int32_t>(level);
  };
  const std::int64_t level = preferences.integerForKey(kWLOLogLevelKey);
  if (level >= threshold.leastLevel) {
    return take(Rule::level, std::min<std::int64_t>(level, kGreatestLevel));
  }
  const std::int64_t developerLevel = preferences.integerForKey(kDeveloperLevelKey);
  if (developerLevel >= threshold.floor && developerLevel <= threshold.greatestDeveloperLevel) {
    return take(Rule::developerLevel, developerLevel);
  }
  take(Rule::floor, threshold.floor);
}

}  // namespace

NDLogThreshold readThreshold(NDPlatform& platform) {
  const auto preferences = platform.preferences();
  preferences->synchronize();
  internalBuildOnce.run([&platform] { askForInternalBuild(platform); });
  NDLogThreshold threshold;
  threshold.isInternalBuild = isInternalBuild;
  threshold.floor = threshold.isInternalBuild ? kInternalFloor : kCustomerFloor;
  threshold.leastLevel = kLeastLevelTakenAsItIs;
  threshold.greatestDeveloperLevel = kGreatestDeveloperLevel;
  decide(threshold, *preferences);
  return threshold;
}

}  // namespace nidus
