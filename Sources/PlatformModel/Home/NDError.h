#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace nidus {

/// An error of the home-automation platform. Callers tell errors apart by `code` alone.
struct NDError {
  std::int64_t code = 0;  ///< See the constants below; any other code is a failure too.
  std::string message;    ///< For people; may be empty.
};

/// The codes that the platform's own accessories use.
inline constexpr std::int64_t kNDErrorUnreachable = 4;
inline constexpr std::int64_t kNDErrorNotWritable = 5;
inline constexpr std::int64_t kNDErrorNotReadable = 6;
inline constexpr std::int64_t kNDErrorWrongType = 43;
inline constexpr std::int64_t kNDErrorOutOfRange = 44;
inline constexpr std::int64_t kNDErrorMustUnlock = 82;

}  // namespace nidus
