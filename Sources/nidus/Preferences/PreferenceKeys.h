#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Json/JsonValue.h"
#include "HomePlatform/Result.h"

namespace nidus {

/// A preference that the program or its plug-in reads.
struct PreferenceKey {
  enum class Kind {
    flag,   ///< true or false.
    level,  ///< A log level, an integer.
  };
  std::string_view name;
  Kind kind = Kind::flag;
  std::string_view purpose;  ///< What it does, in one sentence.
};

/// All preferences, in the order in which they are listed.
[[nodiscard]] const std::vector<PreferenceKey>& preferenceKeys();

/// The key of that name; null when there is none.
[[nodiscard]] const PreferenceKey* findPreferenceKey(std::string_view name);

/// The failure for a name that is no key: with a near miss, and with all keys.
[[nodiscard]] Failure unknownPreference(const std::string& name);

/// Whether those who read `key` take `value`; else it counts as missing for them.
[[nodiscard]] bool isValidPreference(const PreferenceKey& key, const JsonValue& value);

/// Reads a value for `key`: JSON, or a word such as "yes" or "debug". A failure is bad input and
/// says what the key takes.
[[nodiscard]] Result<JsonValue> readPreference(const PreferenceKey& key, const std::string& text);

/// What `key` takes: "true or false".
[[nodiscard]] std::string expectationOf(const PreferenceKey& key);

/// A log level with its name, "4 (warning)"; one beyond the last says what it counts as, "99 (as 7,
/// debug)".
[[nodiscard]] std::string levelText(std::int64_t level);

}  // namespace nidus
