#pragma once

#include <optional>
#include <string>

#include "HomePlatform/HomePlatform.h"
#include "PlatformModel/Assistant/NDLogThreshold.h"
#include "nidus/Preferences/PreferenceKeys.h"

namespace nidus {

/// Whether the plug-in looks for the homes of `platform`.
[[nodiscard]] bool areHomesConfigured(HomePlatform& platform);

/// What is told about one preference.
struct PreferenceReport {
  std::string name;
  std::optional<JsonValue> value;  ///< As it stands in the file; none when it is not set.
  std::string purpose;             ///< What it does.
  std::string effect;              ///< What it does now.
};

/// Tells what `key` is set to in `platform` and what comes of that; `threshold` is what the plug-in
/// has read from the same preferences.
[[nodiscard]] PreferenceReport reportOn(const PreferenceKey& key, HomePlatform& platform,
                                        const NDLogThreshold& threshold);

/// Tells of a preference that stands in the file although nothing reads it.
[[nodiscard]] PreferenceReport reportOnUnread(const std::string& name, const JsonValue& value);

/// A report in three lines for people.
[[nodiscard]] std::string textOf(const PreferenceReport& report);

/// A report as JSON: "key", "value" (null when it is not set), "purpose" and "effect".
[[nodiscard]] JsonValue jsonOf(const PreferenceReport& report);

/// The threshold of the log as JSON: "level", "rule", "floor" and "internalBuild".
[[nodiscard]] JsonValue jsonOf(const NDLogThreshold& threshold);

}  // namespace nidus
