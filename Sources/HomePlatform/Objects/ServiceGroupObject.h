#pragma once

#include <utility>

#include "HomePlatform/Objects/HomePart.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// A group of a home, with the services of the accessories' own lists.
class ServiceGroupObject final : public HomePart<NDServiceGroup, ServiceGroupData> {
 public:
  ServiceGroupObject(std::shared_ptr<const ServiceGroupData> data, std::weak_ptr<NDHome> home,
                     NDArray<NDService> services)
      : HomePart(std::move(data), std::move(home)), services_(std::move(services)) {}

  [[nodiscard]] const NDArray<NDService>& services() const override { return services_; }

 private:
  const NDArray<NDService> services_;
};

}  // namespace nidus
