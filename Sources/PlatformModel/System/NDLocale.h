#pragma once

#include <optional>

#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// The current locale of the device. Supplied by the platform; may be called from any thread.
class ND_EXPORT NDLocale {
 public:
  virtual ~NDLocale();
  /// Whether the locale uses the metric system; none when the locale does not say.
  [[nodiscard]] virtual std::optional<bool> usesMetricSystem() = 0;
};

}  // namespace nidus
