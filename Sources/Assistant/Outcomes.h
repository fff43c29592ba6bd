#pragma once

#include <optional>
#include <string_view>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDError.h"

namespace nidus {

// What an error of the platform means for the object concerned. Errors are told apart by their
// code.

/// Says whether the device must be unlocked first; that is the command's outcome, not the object's.
[[nodiscard]] inline bool requiresUnlock(const std::optional<NDError>& error) {
  return error && error->code == kNDErrorMustUnlock;
}

/// The outcome of a value that was read; none is a success.
[[nodiscard]] inline std::string_view outcomeOfRead(const std::optional<NDError>& error) {
  if (!error) return VAHAActionOutcomeSUCCESSValue;
  return error->code == kNDErrorUnreachable ? VAHAActionOutcomeUNREACHABLEValue
                                            : VAHAActionOutcomeFAILUREValue;
}

/// The outcome of a value that was written; none is a success.
[[nodiscard]] inline std::string_view outcomeOfWrite(const std::optional<NDError>& error) {
  if (error && error->code == kNDErrorNotWritable) return VAHAActionOutcomeREAD_ONLYValue;
  return outcomeOfRead(error);
}

}  // namespace nidus
