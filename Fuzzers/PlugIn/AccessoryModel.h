#pragma once

#include <cstdint>
#include <vector>

#include "HomePlatform/PlatformCall.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// What a home must answer to a call.
struct ModelAnswer {
  std::int32_t batch = 0;           ///< The error of the call as a whole; 0 is none.
  std::vector<std::int32_t> codes;  ///< Of each characteristic in order; empty with `batch`.
};

/// The simulated accessories as their rules are written down, and nothing more: answers each call
/// and makes the change that it makes.
class AccessoryModel {
 public:
  /// `homes` must outlive it.
  AccessoryModel(std::vector<HomeData>& homes, bool isLocked)
      : homes_(homes), isLocked_(isLocked) {}

  ModelAnswer answer(const PlatformCall& call);

  /// The characteristic at `address`; null when there is none.
  [[nodiscard]] const CharacteristicData* find(const NDUUID& home,
                                               const CharacteristicAddress& address) const;

 private:
  struct Place {
    HomeData* home = nullptr;
    AccessoryData* accessory = nullptr;
    ServiceData* service = nullptr;
    CharacteristicData* characteristic = nullptr;
  };

  [[nodiscard]] HomeData* findHome(const NDUUID& home) const;
  [[nodiscard]] Place place(const NDUUID& home, const CharacteristicAddress& address) const;
  [[nodiscard]] std::int32_t refusal(const Place& place, std::int32_t FaultData::*fault) const;
  std::int32_t read(const Place& place) const;
  std::int32_t write(const Place& place, const NDValueRef& value) const;
  std::int32_t run(const NDUUID& home, const NDUUID& actionSet) const;

  std::vector<HomeData>& homes_;
  const bool isLocked_;
};

}  // namespace nidus
