#pragma once

#include <cstdint>

#include "PlatformModel/Home/NDError.h"

namespace nidus {

/// The database could not be read, or did not take a value: the platform's own failure, which is
/// reported beside the answer.
inline constexpr std::int64_t kErrorNotKept = 90;

/// Makes the error of that code, with its message for people.
[[nodiscard]] NDError errorOfCode(std::int64_t code);

}  // namespace nidus
