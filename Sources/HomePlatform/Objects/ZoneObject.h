#pragma once

#include <utility>

#include "HomePlatform/Objects/HomePart.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// A zone of a home, with the rooms of the home's own list.
class ZoneObject final : public HomePart<NDZone, ZoneData> {
 public:
  ZoneObject(std::shared_ptr<const ZoneData> data, std::weak_ptr<NDHome> home,
             NDArray<NDRoom> rooms)
      : HomePart(std::move(data), std::move(home)), rooms_(std::move(rooms)) {}

  [[nodiscard]] const NDArray<NDRoom>& rooms() const override { return rooms_; }

 private:
  const NDArray<NDRoom> rooms_;
};

}  // namespace nidus
