#include "Support/HomeBuilder.h"

#include <stdexcept>
#include <string>
#include <utility>

#include "Support/TestTypes.h"
#include "Support/TestUUID.h"

namespace nidus {
namespace {

/// A number that is the same in every run, so that a home's UUID follows from its name.
std::uint32_t numberOf(const NDString& name) {
  std::uint32_t number = 2166136261U;
  for (const char c : name.view()) number = (number ^ static_cast<std::uint8_t>(c)) * 16777619U;
  return number;
}

template <class Pointer>
Pointer required(Pointer object, const NDString& name) {
  if (!object) throw std::invalid_argument("the home has no " + name.str());
  return object;
}

}  // namespace

HomeBuilder::HomeBuilder(const NDString& name)
    : HomeBuilder(std::make_shared<TestHome>(testUUID(0, numberOf(name)), name, false)) {}

HomeBuilder::HomeBuilder(std::shared_ptr<TestHome> home)
    : home_(std::move(home)), room_(std::make_shared<TestRoom>(nextUUID(), home_->name(), home_)) {
  home_->defaultRoom_ = room_;
}

NDUUID HomeBuilder::nextUUID() {
  const NDUUID counted = testUUID(++objectCount_, numberOf(home_->name()));
  return std::exchange(givenUUID_, std::nullopt).value_or(counted);
}

HomeBuilder& HomeBuilder::uuid(const NDUUID& uuid) {
  givenUUID_ = uuid;
  return *this;
}

HomeBuilder& HomeBuilder::primary() {
  home_->isPrimary_ = true;
  return *this;
}

HomeBuilder& HomeBuilder::room(const NDString& name) {
  room_ = std::make_shared<TestRoom>(nextUUID(), name, home_);
  append(home_->rooms_, room_);
  return *this;
}

HomeBuilder& HomeBuilder::inRoom(const NDString& name) {
  room_ = required(home_->room(name.view()), name);
  return *this;
}

HomeBuilder& HomeBuilder::inNoRoom() {
  room_ = home_->defaultRoom_;
  return *this;
}

HomeBuilder& HomeBuilder::accessory(const NDString& name) {
  accessory_ = std::make_shared<TestAccessory>(nextUUID(), name, home_, room_);
  append<NDAccessory>(home_->accessories_, accessory_);
  characteristicCount_ = 0;
  return *this;
}

HomeBuilder& HomeBuilder::service(const NDString& name, const NDString& type,
                                  const Characteristics& list) {
  const auto number = static_cast<std::int64_t>(accessory_->services().size()) + 1;
  service_ = std::make_shared<TestService>(name, type, number, accessory_);
  for (const CharacteristicSpec& spec : list) {
    service_->add(std::make_shared<TestCharacteristic>(spec, ++characteristicCount_, service_));
  }
  accessory_->add(service_);
  return *this;
}

HomeBuilder& HomeBuilder::associated(const NDString& serviceType) {
  service_->setAssociatedServiceType(serviceType);
  return *this;
}

HomeBuilder& HomeBuilder::serviceID(std::int64_t instanceID) {
  service_->setInstanceID(instanceID);
  return *this;
}

HomeBuilder& HomeBuilder::light(const NDString& name, const Characteristics& list) {
  return accessory(name).service(name, kLightService, list);
}

HomeBuilder& HomeBuilder::thermostat(const NDString& name, const Characteristics& list) {
  return accessory(name).service(name, kThermostatService, list);
}

HomeBuilder& HomeBuilder::zone(const NDString& name, const Names& rooms) {
  auto zone = std::make_shared<TestZone>(nextUUID(), name, home_);
  for (const NDString& room : rooms) zone->add(required(home_->room(room.view()), room));
  append<NDZone>(home_->zones_, zone);
  return *this;
}

HomeBuilder& HomeBuilder::group(const NDString& name, const Names& services) {
  auto group = std::make_shared<TestServiceGroup>(nextUUID(), name, home_);
  for (const NDString& service : services) {
    group->add(required(home_->service(service.view()), service));
  }
  append<NDServiceGroup>(home_->groups_, group);
  return *this;
}

HomeBuilder& HomeBuilder::scene(const NDString& name) {
  append<NDActionSet>(home_->actionSets_, std::make_shared<TestActionSet>(nextUUID(), name, home_));
  return *this;
}

HomeBuilder& HomeBuilder::trigger(const NDString& name) {
  append<NDTrigger>(home_->triggers_, std::make_shared<TestTrigger>(nextUUID(), name, home_));
  return *this;
}

}  // namespace nidus
