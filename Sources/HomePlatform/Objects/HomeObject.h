#pragma once

#include <cstddef>
#include <memory>
#include <unordered_map>
#include <vector>

#include "HomePlatform/Store/HomeStore.h"
#include "PlatformModel/Home/NDHome.h"

namespace nidus {

class AccessoryObject;
class HomeCalls;
struct FoundCharacteristic;

/// One loaded home. Its calls go to `HomeCalls`; once those are gone they are never answered.
class HomeObject final : public NDHome {
 public:
  /// Makes the home and all that is in it.
  [[nodiscard]] static std::shared_ptr<HomeObject> make(const std::shared_ptr<const HomeData>& data,
                                                        std::weak_ptr<HomeCalls> calls);
  /// For `make` alone.
  HomeObject(std::shared_ptr<const HomeData> data, std::weak_ptr<HomeCalls> calls);
  ~HomeObject() override;

  [[nodiscard]] const NDUUID& uuid() const override { return data_->uuid; }
  [[nodiscard]] const NDString& name() const override { return data_->name; }
  [[nodiscard]] bool isPrimary() const override { return data_->primary; }
  [[nodiscard]] const NDArray<NDAccessory>& accessories() const override { return accessories_; }
  [[nodiscard]] const NDArray<NDServiceGroup>& serviceGroups() const override { return groups_; }
  [[nodiscard]] const NDArray<NDRoom>& rooms() const override { return rooms_; }
  [[nodiscard]] const NDArray<NDZone>& zones() const override { return zones_; }
  [[nodiscard]] const NDArray<NDActionSet>& actionSets() const override { return actionSets_; }
  [[nodiscard]] const NDArray<NDTrigger>& triggers() const override { return triggers_; }

  void readCharacteristicValues_withCompletionHandler(NDArray<NDCharacteristic> characteristics,
                                                      NDBatchCompletion completion) override;
  void writeCharacteristicValues_withCompletionHandler(
      std::vector<NDCharacteristicWriteRequestTuple> writes, NDBatchCompletion completion) override;
  void executeActionSet_completionHandler(std::shared_ptr<NDActionSet> actionSet,
                                          NDExecuteCompletion completion) override;

  /// As it was loaded: its values are out of date.
  [[nodiscard]] const HomeData& data() const { return *data_; }
  /// Batches mostly go through a home in its order: `near` is where the accessory of the last one
  /// was found, and is looked at first, with the place behind it.
  /// What is found lives as long as the home.
  [[nodiscard]] FoundCharacteristic find(const CharacteristicAddress& address,
                                         std::size_t& near) const;
  [[nodiscard]] FoundCharacteristic find(const CharacteristicAddress& address) const;
  /// Takes a value that has been kept, if it is of this home.
  void apply(const ValueChange& change) const;
  /// Takes over all values of `newer`, which is the same home loaded later.
  void takeValues(const HomeObject& newer) const;

 private:
  friend class HomeBuilding;
  [[nodiscard]] const AccessoryObject& accessory(std::size_t index) const;
  [[nodiscard]] const AccessoryObject* findAccessory(const NDUUID& id, std::size_t& near) const;

  const std::shared_ptr<const HomeData> data_;
  const std::weak_ptr<HomeCalls> calls_;
  // Complete when `make` returns.
  std::shared_ptr<NDRoom> defaultRoom_;
  NDArray<NDRoom> rooms_;
  NDArray<NDZone> zones_;
  NDArray<NDAccessory> accessories_;
  NDArray<NDServiceGroup> groups_;
  NDArray<NDActionSet> actionSets_;
  NDArray<NDTrigger> triggers_;
  std::unordered_map<NDUUID, std::size_t> accessoryIndexes_;
};

}  // namespace nidus
