#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {

/// What a command acts on: the base of the two filter classes. Not synchronised.
class ND_EXPORT VAHAFilter {
 public:
  virtual ~VAHAFilter();
  /// The class identifier, such as `VAHASearchCriteriaFilterClassIdentifier`.
  [[nodiscard]] virtual std::string_view encodedClassName() const = 0;
  /// The filter on one line, for log messages.
  [[nodiscard]] virtual std::string description() const = 0;

 protected:
  VAHAFilter() = default;
  VAHAFilter(const VAHAFilter&) = default;
  VAHAFilter& operator=(const VAHAFilter&) = default;
};

/// Gives the description of `filter`.
[[nodiscard]] inline std::string description(const VAHAFilter& filter) {
  return filter.description();
}

/// Names objects by what they are, what they are called and where they are. Every field may be
/// null.
class ND_EXPORT VAHASearchCriteriaFilter : public VAHAFilter {
 public:
  [[nodiscard]] std::string_view encodedClassName() const override;
  [[nodiscard]] std::string description() const override;

  [[nodiscard]] const NDString& homeName() const noexcept { return homeName_; }
  void setHomeName(NDString name) { homeName_ = std::move(name); }
  [[nodiscard]] const NDString& entityType() const noexcept { return entityType_; }
  void setEntityType(NDString type) { entityType_ = std::move(type); }
  [[nodiscard]] const NDString& attribute() const noexcept { return attribute_; }
  void setAttribute(NDString attribute) { attribute_ = std::move(attribute); }
  [[nodiscard]] const NDString& serviceType() const noexcept { return serviceType_; }
  void setServiceType(NDString type) { serviceType_ = std::move(type); }
  [[nodiscard]] const NDString& roomName() const noexcept { return roomName_; }
  void setRoomName(NDString name) { roomName_ = std::move(name); }
  [[nodiscard]] const NDString& zoneName() const noexcept { return zoneName_; }
  void setZoneName(NDString name) { zoneName_ = std::move(name); }
  [[nodiscard]] const NDString& groupName() const noexcept { return groupName_; }
  void setGroupName(NDString name) { groupName_ = std::move(name); }
  [[nodiscard]] const NDString& serviceName() const noexcept { return serviceName_; }
  void setServiceName(NDString name) { serviceName_ = std::move(name); }
  [[nodiscard]] const NDString& sceneName() const noexcept { return sceneName_; }
  void setSceneName(NDString name) { sceneName_ = std::move(name); }

 private:
  NDString homeName_;
  NDString entityType_;
  NDString attribute_;
  NDString serviceType_;
  NDString roomName_;
  NDString zoneName_;
  NDString groupName_;
  NDString serviceName_;
  NDString sceneName_;
};

/// Names objects by their identifiers.
class ND_EXPORT VAHAIdentifierFilter : public VAHAFilter {
 public:
  [[nodiscard]] std::string_view encodedClassName() const override;
  [[nodiscard]] std::string description() const override;

  /// None of the identifiers is null.
  [[nodiscard]] const std::vector<NDURL>& identifiers() const noexcept { return identifiers_; }
  void setIdentifiers(std::vector<NDURL> identifiers) { identifiers_ = std::move(identifiers); }

 private:
  std::vector<NDURL> identifiers_;
};

}  // namespace nidus
