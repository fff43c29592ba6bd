#include "LightPlatform.h"

#include <array>
#include <string_view>

#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

/// The words of the benchmarks' homes, looked up in a table of a few rows.
class LightMapper final : public NDNAPMetadata {
 public:
  [[nodiscard]] NDString mapFromAssistantServiceName(const NDString& name) const override {
    return name == serviceName_ ? serviceType_ : nullptr;
  }
  [[nodiscard]] NDString mapToAssistantServiceName(const NDString& type) const override {
    return type == serviceType_ ? serviceName_ : nullptr;
  }
  [[nodiscard]] NDString mapToAssistantCharacteristicName(const NDString& type) const override {
    return property(type, &Attribute::name);
  }
  [[nodiscard]] NDString mapReadCharcteristicFromAssistantName(
      const NDString& name) const override {
    return property(name, &Attribute::type);
  }
  [[nodiscard]] NDString mapWriteCharcteristicFromAssistantName(
      const NDString& name) const override {
    return property(name, &Attribute::type);
  }
  [[nodiscard]] NDString mapCharacteristicValueType(const NDString& name) const override {
    return property(name, &Attribute::valueType);
  }
  [[nodiscard]] NDString mapFromAssistantUnitName(const NDString& /*name*/) const override {
    return nullptr;
  }
  [[nodiscard]] NDString mapToAssistantUnitName(const NDString& /*unit*/) const override {
    return nullptr;
  }
  [[nodiscard]] NDString characteristicValueUnit(const NDString& /*type*/) const override {
    return nullptr;
  }
  [[nodiscard]] bool supportsLocalization(const NDString& /*type*/) const override { return false; }
  [[nodiscard]] NDValueRef mapFromAssistantCharacteristicValue_name(
      const NDValueRef& value, const NDString& /*name*/) const override {
    return value;
  }
  [[nodiscard]] NDValueRef mapToAssistantCharacteristicValue_name(
      const NDValueRef& value, const NDString& /*name*/) const override {
    return value;
  }

 private:
  struct Attribute {
    NDString name;
    NDString type;
    NDString valueType;
  };

  [[nodiscard]] NDString property(const NDString& nameOrType, NDString Attribute::*field) const {
    for (const Attribute& attribute : attributes_) {
      if (nameOrType == attribute.name || nameOrType == attribute.type) return attribute.*field;
    }
    return nullptr;
  }

  const NDString serviceName_ = "LIGHT";
  const NDString serviceType_ = "com.corvane.nidus.service.light";
  const std::array<Attribute, 3> attributes_ = {
      Attribute{"POWER", "com.corvane.nidus.characteristic.power", "bool"},
      Attribute{"BRIGHTNESS", "com.corvane.nidus.characteristic.brightness", "int"},
      Attribute{"HUE", "com.corvane.nidus.characteristic.hue", "float"}};
};

class LightHomeManager final : public NDHomeManager,
                               public std::enable_shared_from_this<LightHomeManager> {
 public:
  explicit LightHomeManager(NDArray<NDHome> homes) : homes_(std::move(homes)) {}
  [[nodiscard]] NDArray<NDHome> homes() const override { return homes_; }
  void setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) override {
    delegate_ = std::move(delegate);
  }
  void report() {
    if (const auto delegate = delegate_.lock()) {
      delegate->homeManagerDidUpdateHomes(shared_from_this());
    }
  }

 private:
  const NDArray<NDHome> homes_;
  std::weak_ptr<NDHomeManagerDelegate> delegate_;
};

}  // namespace

LightPlatform::LightPlatform(std::shared_ptr<HomePlatform> system, NDArray<NDHome> homes)
    : system_(std::move(system)),
      homes_(std::move(homes)),
      metadata_(std::make_shared<LightMapper>()) {}

std::shared_ptr<NDHomeManager> LightPlatform::createHomeManager() {
  auto manager = std::make_shared<LightHomeManager>(homes_);
  NDDeliveryHold::whenReleased([weakManager = std::weak_ptr(manager)] {
    if (const auto released = weakManager.lock()) released->report();
  });
  return manager;
}

std::shared_ptr<NDMainQueue> LightPlatform::mainQueue() {
  thread_local const auto queue = std::make_shared<NDMainQueue>();
  return queue;
}

}  // namespace nidus
