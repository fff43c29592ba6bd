#pragma once

#include <cstdint>
#include <string>

#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// Gives the decimal text of `number`. May be called from any thread.
[[nodiscard]] ND_EXPORT std::string numberText(std::int64_t number);

/// Gives the shortest text that reads back as the same 32-bit float, such as "72.5" or "72".
/// May be called from any thread, whatever its locale.
[[nodiscard]] ND_EXPORT std::string numberText(float number);

}  // namespace nidus
