#pragma once

#include <memory>
#include <utility>

#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {

/// A thing of the home as the assistant knows it. A field that is not set is null.
/// Not synchronised.
class ND_EXPORT VAHAEntity {
 public:
  /// Makes an empty entity, never null.
  [[nodiscard]] static std::shared_ptr<VAHAEntity> entity();

  [[nodiscard]] const NDString& name() const noexcept { return name_; }
  void setName(NDString name) { name_ = std::move(name); }
  [[nodiscard]] const NDURL& identifier() const noexcept { return identifier_; }
  void setIdentifier(NDURL identifier) { identifier_ = std::move(identifier); }
  [[nodiscard]] const NDString& entityType() const noexcept { return entityType_; }
  void setEntityType(NDString type) { entityType_ = std::move(type); }
  [[nodiscard]] const NDString& serviceType() const noexcept { return serviceType_; }
  void setServiceType(NDString type) { serviceType_ = std::move(type); }
  [[nodiscard]] const NDString& room() const noexcept { return room_; }
  void setRoom(NDString room) { room_ = std::move(room); }
  [[nodiscard]] const NDString& home() const noexcept { return home_; }
  void setHome(NDString home) { home_ = std::move(home); }
  [[nodiscard]] const NDString& zone() const noexcept { return zone_; }
  void setZone(NDString zone) { zone_ = std::move(zone); }

  /// The plain form; fields that are null are left out.
  [[nodiscard]] NDDictionary dictionary() const;

 private:
  NDString name_;
  NDURL identifier_;
  NDString entityType_;
  NDString serviceType_;
  NDString room_;
  NDString home_;
  NDString zone_;
};

}  // namespace nidus
