#pragma once

#include <memory>

#include "HomePlatform/Store/HomeData.h"
#include "Load/Ledger.h"
#include "Load/Random.h"
#include "Support/TestHome.h"

namespace nidus {

/// A test home that enters into the ledger of a command what it is asked and what it answers.
class UnrulyHome final : public TestHome {
 public:
  using TestHome::TestHome;

  /// Makes the home of `data`, whose answers go through `queue`. A lamp that is locked or cannot be
  /// reached answers so, and now and then a whole home does.
  [[nodiscard]] static std::shared_ptr<UnrulyHome> make(const HomeData& data, Random& random,
                                                        std::shared_ptr<NDQueue> queue);

  void readCharacteristicValues_withCompletionHandler(NDArray<NDCharacteristic> characteristics,
                                                      NDBatchCompletion completion) override;
  void writeCharacteristicValues_withCompletionHandler(Writes writes,
                                                       NDBatchCompletion completion) override;
  void executeActionSet_completionHandler(std::shared_ptr<NDActionSet> actionSet,
                                          NDExecuteCompletion completion) override;
};

}  // namespace nidus
