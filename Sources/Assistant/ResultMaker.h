#pragma once

#include <memory>
#include <optional>
#include <string_view>

#include "PlatformModel/Assistant/VAHAAction.h"
#include "PlatformModel/Assistant/VAHAActionResult.h"
#include "PlatformModel/Home/NDService.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// Makes the results of one action, one after the other. What the mapper says of the action is
/// asked when the first result needs it, and holds for all. Results with the same value may share
/// the object that holds it. Not synchronised: each batch has its own.
///
///     ResultMaker maker(action, serviceType);
///     for (const auto& response : responses) {
///       results.push_back(maker.make(VAHAActionOutcomeSUCCESSValue, service));
///     }
class ResultMaker {
 public:
  /// Both may be null; `serviceType` is the assistant service type of the command's filter.
  ResultMaker(VAHAActionRef action, NDString serviceType);
  ~ResultMaker();
  ResultMaker(const ResultMaker&) = delete;
  ResultMaker& operator=(const ResultMaker&) = delete;

  /// A result about `service`, which may be null, filled in as by `fill`.
  [[nodiscard]] std::shared_ptr<VAHAActionResult> make(std::string_view outcome,
                                                       const std::shared_ptr<NDService>& service);
  /// The same; null when the result turns out to be no answer to the action.
  [[nodiscard]] std::shared_ptr<VAHAActionResult> makeIfAnswer(
      std::string_view outcome, const std::shared_ptr<NDService>& service);

  /// Fills in a result as `populateResultWithService` does.
  bool fill(VAHAActionResult& result, const std::shared_ptr<NDService>& service);

 private:
  struct Mapping;

  [[nodiscard]] const NDString& sharedOutcome(std::string_view outcome);
  bool fillValue(VAHAActionResult& result, const std::shared_ptr<NDService>& service);

  const VAHAActionRef action_;
  const NDString serviceType_;
  NDString outcome_;  // of the last result: most have the same
  std::unique_ptr<Mapping> mapping_;
};

}  // namespace nidus
