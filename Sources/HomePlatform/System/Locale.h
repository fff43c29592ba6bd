#pragma once

#include <optional>
#include <string_view>

#include "PlatformModel/System/NDLocale.h"

namespace nidus {

/// Says whether the name of a locale, such as `en_US.UTF-8`, belongs to a territory that uses the
/// metric system; a name without a territory does.
[[nodiscard]] bool isMetricLocaleName(std::string_view name);

/// Says the same of the environment's locale: the first of LC_ALL, LC_MEASUREMENT and LANG that is
/// set and not empty.
[[nodiscard]] bool isMetricEnvironment();

/// A locale whose answer never changes.
class Locale final : public NDLocale {
 public:
  explicit Locale(bool isMetric) : isMetric_(isMetric) {}
  [[nodiscard]] std::optional<bool> usesMetricSystem() override { return isMetric_; }

 private:
  const bool isMetric_;
};

}  // namespace nidus
