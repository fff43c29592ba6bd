#pragma once

#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

#include "PlatformModel/Home/NDHome.h"
#include "Support/TestCharacteristic.h"

namespace nidus {

/// Adds `element` to a list that is otherwise immutable; copies made before do not change.
template <class T>
void append(NDArray<T>& list, std::shared_ptr<T> element) {
  std::vector<std::shared_ptr<T>> elements(list.begin(), list.end());
  elements.push_back(std::move(element));
  list = NDArray<T>(std::move(elements));
}

/// An object of a test home that has a UUID, a name and nothing else. The objects of a home are put
/// together by one thread and may then be read from any.
template <class Interface>
class TestNamedObject : public Interface {
 public:
  TestNamedObject(const NDUUID& uuid, NDString name, std::weak_ptr<NDHome> home)
      : uuid_(uuid), name_(std::move(name)), home_(std::move(home)) {}

  [[nodiscard]] const NDUUID& uuid() const override { return uuid_; }
  [[nodiscard]] const NDString& name() const override { return name_; }
  [[nodiscard]] std::shared_ptr<NDHome> home() const override { return home_.lock(); }

 private:
  const NDUUID uuid_;
  const NDString name_;
  const std::weak_ptr<NDHome> home_;
};

using TestRoom = TestNamedObject<NDRoom>;
using TestActionSet = TestNamedObject<NDActionSet>;
using TestTrigger = TestNamedObject<NDTrigger>;

class TestZone final : public TestNamedObject<NDZone> {
 public:
  using TestNamedObject<NDZone>::TestNamedObject;
  [[nodiscard]] const NDArray<NDRoom>& rooms() const override { return rooms_; }
  void add(std::shared_ptr<NDRoom> room) { append(rooms_, std::move(room)); }

 private:
  NDArray<NDRoom> rooms_;
};

class TestServiceGroup final : public TestNamedObject<NDServiceGroup> {
 public:
  using TestNamedObject<NDServiceGroup>::TestNamedObject;
  [[nodiscard]] const NDArray<NDService>& services() const override { return services_; }
  void add(std::shared_ptr<NDService> service) { append(services_, std::move(service)); }

 private:
  NDArray<NDService> services_;
};

class TestService final : public NDService {
 public:
  TestService(NDString name, NDString serviceType, std::int64_t instanceID,
              std::weak_ptr<NDAccessory> accessory)
      : name_(std::move(name)),
        serviceType_(std::move(serviceType)),
        instanceID_(instanceID),
        accessory_(std::move(accessory)) {}

  [[nodiscard]] std::int64_t instanceID() const override { return instanceID_; }
  [[nodiscard]] const NDString& name() const override { return name_; }
  [[nodiscard]] const NDString& serviceType() const override { return serviceType_; }
  [[nodiscard]] const NDString& associatedServiceType() const override { return associatedType_; }
  [[nodiscard]] const NDArray<NDCharacteristic>& characteristics() const override {
    return characteristics_;
  }
  [[nodiscard]] std::shared_ptr<NDAccessory> accessory() const override {
    return accessory_.lock();
  }

  void setInstanceID(std::int64_t instanceID) { instanceID_ = instanceID; }
  void setAssociatedServiceType(NDString type) { associatedType_ = std::move(type); }
  void add(std::shared_ptr<NDCharacteristic> characteristic) {
    append(characteristics_, std::move(characteristic));
  }

 private:
  const NDString name_;
  const NDString serviceType_;
  std::int64_t instanceID_;
  const std::weak_ptr<NDAccessory> accessory_;
  NDString associatedType_;
  NDArray<NDCharacteristic> characteristics_;
};

class TestAccessory final : public TestNamedObject<NDAccessory> {
 public:
  TestAccessory(const NDUUID& uuid, NDString name, std::weak_ptr<NDHome> home,
                std::weak_ptr<NDRoom> room)
      : TestNamedObject(uuid, std::move(name), std::move(home)), room_(std::move(room)) {}
  [[nodiscard]] const NDArray<NDService>& services() const override { return services_; }
  [[nodiscard]] std::shared_ptr<NDRoom> room() const override { return room_.lock(); }
  void add(std::shared_ptr<NDService> service) { append(services_, std::move(service)); }

 private:
  const std::weak_ptr<NDRoom> room_;
  NDArray<NDService> services_;
};

}  // namespace nidus
