#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string_view>
#include <vector>

#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDQueue.h"
#include "Support/TestObjects.h"

namespace nidus {

/// A home in memory that records what it is asked to do and answers as the test says. Made by
/// `HomeBuilder`. May be used from any thread.
///
/// An answer comes through the registered platform's shared queue unless the test chooses another
/// queue or holds answers back.
class TestHome : public NDHome {
 public:
  using Reads = NDArray<NDCharacteristic>;
  using Writes = std::vector<NDCharacteristicWriteRequestTuple>;

  TestHome(const NDUUID& uuid, NDString name, bool isPrimary);

  [[nodiscard]] const NDUUID& uuid() const override { return uuid_; }
  [[nodiscard]] const NDString& name() const override { return name_; }
  [[nodiscard]] bool isPrimary() const override { return isPrimary_; }
  [[nodiscard]] const NDArray<NDAccessory>& accessories() const override { return accessories_; }
  [[nodiscard]] const NDArray<NDServiceGroup>& serviceGroups() const override { return groups_; }
  [[nodiscard]] const NDArray<NDRoom>& rooms() const override { return rooms_; }
  [[nodiscard]] const NDArray<NDZone>& zones() const override { return zones_; }
  [[nodiscard]] const NDArray<NDActionSet>& actionSets() const override { return actionSets_; }
  [[nodiscard]] const NDArray<NDTrigger>& triggers() const override { return triggers_; }

  void readCharacteristicValues_withCompletionHandler(NDArray<NDCharacteristic> characteristics,
                                                      NDBatchCompletion completion) override;
  void writeCharacteristicValues_withCompletionHandler(Writes writes,
                                                       NDBatchCompletion completion) override;
  void executeActionSet_completionHandler(std::shared_ptr<NDActionSet> actionSet,
                                          NDExecuteCompletion completion) override;

  /// The first object of that name; null when there is none.
  [[nodiscard]] std::shared_ptr<TestService> service(std::string_view name) const;
  [[nodiscard]] std::shared_ptr<NDAccessory> accessory(std::string_view name) const;
  [[nodiscard]] std::shared_ptr<NDRoom> room(std::string_view name) const;
  [[nodiscard]] std::shared_ptr<NDZone> zone(std::string_view name) const;
  [[nodiscard]] std::shared_ptr<NDServiceGroup> group(std::string_view name) const;
  [[nodiscard]] std::shared_ptr<NDActionSet> scene(std::string_view name) const;
  [[nodiscard]] std::shared_ptr<NDTrigger> trigger(std::string_view name) const;
  /// The first characteristic of `type` of the service of that name; null when there is none.
  [[nodiscard]] std::shared_ptr<TestCharacteristic> characteristic(std::string_view serviceName,
                                                                   std::string_view type) const;

  /// What the home was asked to do, in order.
  [[nodiscard]] std::vector<Reads> reads() const;
  [[nodiscard]] std::vector<Writes> writes() const;
  [[nodiscard]] std::vector<std::shared_ptr<NDActionSet>> executions() const;

  /// Removes all accessories from the home; nothing else may be looking at them.
  void removeAccessories() { accessories_ = {}; }

  /// Answers every batch of that kind, or every run, with the error `code` as a whole.
  void failReads(std::int64_t code);
  void failWrites(std::int64_t code);
  void failExecutions(std::int64_t code);

  /// Sends the answers through `queue`.
  void answerOn(std::shared_ptr<NDQueue> queue);
  /// Keeps answers back until they are released, if ever.
  void holdAnswers();
  [[nodiscard]] std::size_t heldAnswers() const;
  /// Gives all answers that are held back, in order, on the calling thread; new ones are held
  /// still.
  void releaseAnswers();
  /// Forgets what is held back: those answers never come.
  void dropAnswers();

 private:
  friend class HomeBuilder;
  void answer(NDTask task);

  const NDUUID uuid_;
  const NDString name_;
  bool isPrimary_;
  std::shared_ptr<NDRoom> defaultRoom_;
  NDArray<NDAccessory> accessories_;
  NDArray<NDServiceGroup> groups_;
  NDArray<NDRoom> rooms_;
  NDArray<NDZone> zones_;
  NDArray<NDActionSet> actionSets_;
  NDArray<NDTrigger> triggers_;

  mutable NDMutex mutex_;
  std::vector<Reads> reads_ ND_GUARDED_BY(mutex_);
  std::vector<Writes> writes_ ND_GUARDED_BY(mutex_);
  std::vector<std::shared_ptr<NDActionSet>> executions_ ND_GUARDED_BY(mutex_);
  std::optional<NDError> readError_ ND_GUARDED_BY(mutex_);
  std::optional<NDError> writeError_ ND_GUARDED_BY(mutex_);
  std::optional<NDError> executeError_ ND_GUARDED_BY(mutex_);
  std::shared_ptr<NDQueue> queue_ ND_GUARDED_BY(mutex_);
  bool isHolding_ ND_GUARDED_BY(mutex_) = false;
  std::vector<NDTask> held_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
