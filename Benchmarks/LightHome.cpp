#include "LightHome.h"

#include <unordered_map>
#include <utility>

#include "PlatformModel/NDPlatform.h"

namespace nidus {
namespace {

class LightMetadata final : public NDCharacteristicMetadata {
 public:
  explicit LightMetadata(MetadataData data) : data_(std::move(data)) {}
  [[nodiscard]] const NDString& format() const override { return data_.format; }
  [[nodiscard]] const NDString& units() const override { return data_.units; }
  [[nodiscard]] const NDValueRef& minimumValue() const override { return data_.minimumValue; }
  [[nodiscard]] const NDValueRef& maximumValue() const override { return data_.maximumValue; }
  [[nodiscard]] const NDValueRef& stepValue() const override { return data_.stepValue; }

 private:
  const MetadataData data_;
};

class LightCharacteristic final : public NDCharacteristic {
 public:
  LightCharacteristic(CharacteristicData data, std::weak_ptr<NDService> service)
      : data_(std::move(data)),
        service_(std::move(service)),
        metadata_(data_.metadata ? std::make_shared<LightMetadata>(*data_.metadata) : nullptr) {}
  [[nodiscard]] std::int64_t instanceID() const override { return data_.instanceID; }
  [[nodiscard]] const NDString& characteristicType() const override {
    return data_.characteristicType;
  }
  [[nodiscard]] const std::vector<NDString>& properties() const override {
    return data_.properties;
  }
  [[nodiscard]] const std::shared_ptr<const NDCharacteristicMetadata>& metadata() const override {
    return metadata_;
  }
  [[nodiscard]] NDValueRef value() const override { return data_.value; }
  [[nodiscard]] std::shared_ptr<NDService> service() const override { return service_.lock(); }

 private:
  const CharacteristicData data_;
  const std::weak_ptr<NDService> service_;
  const std::shared_ptr<const NDCharacteristicMetadata> metadata_;
};

class LightService final : public NDService {
 public:
  LightService(const ServiceData& data, std::weak_ptr<NDAccessory> accessory)
      : instanceID_(data.instanceID),
        name_(data.name),
        serviceType_(data.serviceType),
        associatedServiceType_(data.associatedServiceType),
        accessory_(std::move(accessory)) {}
  [[nodiscard]] std::int64_t instanceID() const override { return instanceID_; }
  [[nodiscard]] const NDString& name() const override { return name_; }
  [[nodiscard]] const NDString& serviceType() const override { return serviceType_; }
  [[nodiscard]] const NDString& associatedServiceType() const override {
    return associatedServiceType_;
  }
  [[nodiscard]] const NDArray<NDCharacteristic>& characteristics() const override {
    return characteristics_;
  }
  [[nodiscard]] std::shared_ptr<NDAccessory> accessory() const override {
    return accessory_.lock();
  }
  void setCharacteristics(NDArray<NDCharacteristic> all) { characteristics_ = std::move(all); }

 private:
  const std::int64_t instanceID_;
  const NDString name_;
  const NDString serviceType_;
  const NDString associatedServiceType_;
  const std::weak_ptr<NDAccessory> accessory_;
  NDArray<NDCharacteristic> characteristics_;
};

/// An object that has a UUID, a name and a home.
template <class Interface>
class LightPart : public Interface {
 public:
  template <class Data>
  LightPart(const Data& data, std::weak_ptr<NDHome> home)
      : uuid_(data.uuid), name_(data.name), home_(std::move(home)) {}
  [[nodiscard]] const NDUUID& uuid() const override { return uuid_; }
  [[nodiscard]] const NDString& name() const override { return name_; }
  [[nodiscard]] std::shared_ptr<NDHome> home() const override { return home_.lock(); }

 private:
  const NDUUID uuid_;
  const NDString name_;
  const std::weak_ptr<NDHome> home_;
};

class LightAccessory final : public LightPart<NDAccessory> {
 public:
  using LightPart::LightPart;
  [[nodiscard]] const NDArray<NDService>& services() const override { return services_; }
  [[nodiscard]] std::shared_ptr<NDRoom> room() const override { return room_.lock(); }
  void setRoom(std::weak_ptr<NDRoom> room) { room_ = std::move(room); }
  void setServices(NDArray<NDService> services) { services_ = std::move(services); }

 private:
  std::weak_ptr<NDRoom> room_;
  NDArray<NDService> services_;
};

class LightServiceGroup final : public LightPart<NDServiceGroup> {
 public:
  using LightPart::LightPart;
  [[nodiscard]] const NDArray<NDService>& services() const override { return services_; }
  void setServices(NDArray<NDService> services) { services_ = std::move(services); }

 private:
  NDArray<NDService> services_;
};

class LightZone final : public LightPart<NDZone> {
 public:
  using LightPart::LightPart;
  [[nodiscard]] const NDArray<NDRoom>& rooms() const override { return rooms_; }
  void setRooms(NDArray<NDRoom> rooms) { rooms_ = std::move(rooms); }

 private:
  NDArray<NDRoom> rooms_;
};

using Rooms = std::unordered_map<NDUUID, std::shared_ptr<NDRoom>>;
using Accessories = std::unordered_map<NDUUID, std::shared_ptr<NDAccessory>>;

class LightHome final : public NDHome {
 public:
  explicit LightHome(const HomeData& data)
      : uuid_(data.uuid), name_(data.name), isPrimary_(data.primary) {}
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
                                                      NDBatchCompletion completion) override {
    answer([characteristics = std::move(characteristics), completion = std::move(completion)] {
      std::vector<NDCharacteristicResponse> responses;
      responses.reserve(characteristics.size());
      for (const auto& each : characteristics) responses.push_back({each, std::nullopt});
      completion(std::nullopt, responses);
    });
  }
  void writeCharacteristicValues_withCompletionHandler(
      std::vector<NDCharacteristicWriteRequestTuple> writes,
      NDBatchCompletion completion) override {
    answer([writes = std::move(writes), completion = std::move(completion)] {
      std::vector<NDCharacteristicResponse> responses;
      responses.reserve(writes.size());
      for (const auto& each : writes) responses.push_back({each.characteristic, std::nullopt});
      completion(std::nullopt, responses);
    });
  }
  void executeActionSet_completionHandler(std::shared_ptr<NDActionSet> /*actionSet*/,
                                          NDExecuteCompletion completion) override {
    answer([completion = std::move(completion)] { completion(std::nullopt); });
  }

  NDArray<NDAccessory> accessories_;
  NDArray<NDServiceGroup> groups_;
  NDArray<NDRoom> rooms_;
  NDArray<NDZone> zones_;

 private:
  /// Never inside the call that asks.
  static void answer(NDTask task) { NDPlatform::registered()->mainQueue()->async(std::move(task)); }

  const NDUUID uuid_;
  const NDString name_;
  const bool isPrimary_;
  const NDArray<NDActionSet> actionSets_;
  const NDArray<NDTrigger> triggers_;
};

std::shared_ptr<NDService> makeService(const ServiceData& data,
                                       const std::weak_ptr<NDAccessory>& accessory) {
  const auto service = std::make_shared<LightService>(data, accessory);
  std::vector<std::shared_ptr<NDCharacteristic>> characteristics;
  characteristics.reserve(data.characteristics.size());
  for (const CharacteristicData& each : data.characteristics) {
    characteristics.push_back(std::make_shared<LightCharacteristic>(each, service));
  }
  service->setCharacteristics(NDArray<NDCharacteristic>(std::move(characteristics)));
  return service;
}

NDArray<NDRoom> makeRooms(const std::shared_ptr<LightHome>& home, const HomeData& data,
                          Rooms& rooms) {
  std::vector<std::shared_ptr<NDRoom>> made;
  for (const RoomData& each : data.rooms) {
    made.push_back(std::make_shared<LightPart<NDRoom>>(each, home));
    rooms[each.uuid] = made.back();
  }
  return NDArray<NDRoom>(std::move(made));
}

NDArray<NDZone> makeZones(const std::shared_ptr<LightHome>& home, const HomeData& data,
                          const Rooms& rooms) {
  std::vector<std::shared_ptr<NDZone>> made;
  for (const ZoneData& each : data.zones) {
    std::vector<std::shared_ptr<NDRoom>> contained;
    for (const NDUUID& room : each.rooms) contained.push_back(rooms.at(room));
    auto zone = std::make_shared<LightZone>(each, home);
    zone->setRooms(NDArray<NDRoom>(std::move(contained)));
    made.push_back(std::move(zone));
  }
  return NDArray<NDZone>(std::move(made));
}

NDArray<NDAccessory> makeAccessories(const std::shared_ptr<LightHome>& home, const HomeData& data,
                                     const Rooms& rooms, Accessories& accessories) {
  std::vector<std::shared_ptr<NDAccessory>> made;
  for (const AccessoryData& each : data.accessories) {
    auto accessory = std::make_shared<LightAccessory>(each, home);
    if (each.room) accessory->setRoom(rooms.at(*each.room));
    std::vector<std::shared_ptr<NDService>> services;
    for (const ServiceData& service : each.services) {
      services.push_back(makeService(service, accessory));
    }
    accessory->setServices(NDArray<NDService>(std::move(services)));
    accessories[each.uuid] = accessory;
    made.push_back(std::move(accessory));
  }
  return NDArray<NDAccessory>(std::move(made));
}

NDArray<NDServiceGroup> makeGroups(const std::shared_ptr<LightHome>& home, const HomeData& data,
                                   const Accessories& accessories) {
  std::vector<std::shared_ptr<NDServiceGroup>> made;
  for (const ServiceGroupData& each : data.serviceGroups) {
    std::vector<std::shared_ptr<NDService>> members;
    for (const ServiceAddress& address : each.services) {
      for (const auto& service : accessories.at(address.accessory)->services()) {
        if (service->instanceID() == address.service) members.push_back(service);
      }
    }
    auto group = std::make_shared<LightServiceGroup>(each, home);
    group->setServices(NDArray<NDService>(std::move(members)));
    made.push_back(std::move(group));
  }
  return NDArray<NDServiceGroup>(std::move(made));
}

}  // namespace

std::shared_ptr<NDHome> makeLightHome(const HomeData& data) {
  const auto home = std::make_shared<LightHome>(data);
  Rooms rooms;
  Accessories accessories;
  home->rooms_ = makeRooms(home, data, rooms);
  home->zones_ = makeZones(home, data, rooms);
  home->accessories_ = makeAccessories(home, data, rooms, accessories);
  home->groups_ = makeGroups(home, data, accessories);
  return home;
}

}  // namespace nidus
