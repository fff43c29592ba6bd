#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDCharacteristicBatch.h"
#include "PlatformModel/Home/NDError.h"

namespace nidus {

// What an error of the platform means for the object concerned. Errors are told apart by their
// code.

/// Says whether the device must be unlocked first; that is the command's outcome, not the object's.
[[nodiscard]] inline bool requiresUnlock(const std::optional<NDError>& error) {
  return error && error->code == kNDErrorMustUnlock;
}

/// Hands each response of a batch to `visit`, up to the first one that requires the device to be
/// unlocked; none when the batch as a whole, whose error is `error`, requires it. Says whether all
/// were visited.
template <class Visit>
[[nodiscard]] bool visitUntilLocked(const std::optional<NDError>& error,
                                    const std::vector<NDCharacteristicResponse>& responses,
                                    const Visit& visit) {
  if (requiresUnlock(error)) return false;
  for (const NDCharacteristicResponse& response : responses) {
    if (requiresUnlock(response.error)) return false;
    visit(response);
  }
  return true;
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
