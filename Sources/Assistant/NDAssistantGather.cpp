#include "Assistant/NDAssistantGather.h"

#include <utility>

#include "Assistant/AddressableTypes.h"
#include "Assistant/EntityTypes.h"
#include "Assistant/HomeMemberships.h"
#include "Assistant/ObjectURL.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/NDPlatform.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {
namespace {

bool areHomesConfigured() {
  const auto platform = NDPlatform::registered();
  if (!platform) return false;
  const auto reading = platform->preferences()->booleanForKey_domain_container(
      "kHomesConfigured", "com.corvane.nidusd", getHomeConfigurationPath());
  return reading.keyExistsAndIsValid && reading.value;
}

std::shared_ptr<NDHome> primaryHome(const std::shared_ptr<NDHomeManager>& manager) {
  for (const auto& home : property(manager, &NDHomeManager::homes)) {
    if (home->isPrimary()) return home;
  }
  return nullptr;
}

std::size_t greatestRecordCount(const NDHome& home) {
  std::size_t count = 1 + home.serviceGroups().size() + home.rooms().size() + home.zones().size() +
                      home.actionSets().size() + home.triggers().size();
  for (const auto& accessory : home.accessories()) count += accessory->services().size();
  return count;
}

/// Where the services of one accessory are.
struct Place {
  std::shared_ptr<NDAccessory> accessory;
  std::shared_ptr<NDHome> home;
  NDString homeName;
  NDString roomName;
};

/// Appends the records of one home's objects. What is the same for all of them is read once.
class HomeFlattener {
 public:
  HomeFlattener(HomeObjectRecords& list, const NDHome* home, const NDNAPMetadata* metadata)
      : list_(list), memberships_(home), types_(metadata) {}

  void append(NDString name, NDString type, NDString home, NDURL identifier) {
    HomeObjectRecord& record = list_.emplace_back();
    record.objectType = std::move(type);
    record.objectName = std::move(name);
    record.objectIdentifier = std::move(identifier);
    record.objectHome = std::move(home);
  }

  template <class Object>
  void appendAll(const NDArray<Object>& objects, const NDString& type, const NDString& home) {
    for (const auto& object : objects) append(object->name(), type, home, url(*object));
  }

  void appendRoom(const NDRoom& room) {
    const auto home = room.home();
    append(room.name(), entityTypes().room, property(home, &NDHome::name), url(room));
    list_.back().objectZone = memberships_.zoneName(room);
  }

  void appendService(const NDService& service) {
    TextList types = types_.of(service);
    if (types.empty()) return;
    const Place& place = placeOf(service);
    append(service.name(), entityTypes().service, place.homeName,
           url(service, place.accessory.get(), place.home.get()));
    HomeObjectRecord& record = list_.back();
    record.objectServiceType = service.serviceType();
    record.objectCharacteristics = std::move(types);
    record.objectAssociatedServiceType = service.associatedServiceType();
    record.objectGroups = memberships_.groupNames(service);
    if (place.roomName != place.homeName) record.objectRoom = place.roomName;
  }

  void appendHome(const NDHome& home) {
    const EntityTypes& types = entityTypes();
    append(home.name(), types.home, nullptr, url(home));
    for (const auto& accessory : home.accessories()) {
      for (const auto& service : accessory->services()) appendService(*service);
    }
    const NDString& name = home.name();
    appendAll(home.serviceGroups(), types.group, name);
    for (const auto& room : home.rooms()) appendRoom(*room);
    appendAll(home.zones(), types.zone, name);
    appendAll(home.actionSets(), types.scene, name);
    appendAll(home.triggers(), types.trigger, name);
  }

 private:
  /// Services of one accessory mostly follow each other.
  const Place& placeOf(const NDService& service) {
    auto accessory = service.accessory();
    if (accessory == place_.accessory) return place_;
    const auto room = property(accessory, &NDAccessory::room);
    place_.home = property(accessory, &NDAccessory::home);
    place_.homeName = property(place_.home, &NDHome::name);
    place_.roomName = property(room, &NDRoom::name);
    place_.accessory = std::move(accessory);
    return place_;
  }

  HomeObjectRecords& list_;
  const HomeMemberships memberships_;
  AddressableTypes types_;
  Place place_;
};

}  // namespace

std::shared_ptr<NDAssistantGather> NDAssistantGather::init() {
  if (!areHomesConfigured()) return nullptr;
  auto manager = NDHomeManager::create();
  if (!manager) return nullptr;
  auto gather = std::make_shared<NDAssistantGather>(Passkey(), std::move(manager));
  gather->manager()->setDelegate(gather);
  return gather;
}

NDAssistantGather::NDAssistantGather(Passkey /*passkey*/, std::shared_ptr<NDHomeManager> manager)
    : manager_(std::move(manager)) {}

bool NDAssistantGather::fetchComplete() const {
  const NDLock lock(mutex_);
  return fetchComplete_;
}

NDAssistantGather::CompletionHandler NDAssistantGather::completionHandler() const {
  const NDLock lock(mutex_);
  return completionHandler_;
}

void NDAssistantGather::startWithCompletionHandler(CompletionHandler handler) {
  {
    const NDLock lock(mutex_);
    if (!fetchComplete_) {
      // What leaves the field, or finds it closed, is destroyed after the lock is released.
      if (!isAbandoned_) completionHandler_.swap(handler);
      return;
    }
  }
  handler(0);
}

void NDAssistantGather::homeManagerDidUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) {
  CompletionHandler handler;
  {
    const NDLock lock(mutex_);
    if (fetchComplete_) return;
    // Together, so that a start at the same time is either called with this count or with 0.
    fetchComplete_ = true;
    handler.swap(completionHandler_);
  }
  if (handler) handler(static_cast<long>(manager->homes().size()));
}

void NDAssistantGather::homeManagerWillNotUpdateHomes(
    const std::shared_ptr<NDHomeManager>& /*manager*/) {
  CompletionHandler dropped;
  const NDLock lock(mutex_);
  isAbandoned_ = true;
  dropped.swap(completionHandler_);
}

NDString NDAssistantGather::getPrimaryHomeName() const {
  const auto home = primaryHome(manager_);
  return property(home, &NDHome::name);
}

NDString NDAssistantGather::getPrimaryHomeID() const {
  const auto home = primaryHome(manager_);
  return home ? home->uuid().UUIDString() : nullptr;
}

HomeObjectRecords NDAssistantGather::gatherNidusObjects() const {
  const NDArray<NDHome> homes = manager_->homes();
  const auto metadata = NDNAPMetadata::getSharedInstance();
  std::size_t count = 0;
  for (const auto& home : homes) count += greatestRecordCount(*home);
  HomeObjectRecords list;
  list.reserve(count);
  for (const auto& home : homes) {
    HomeFlattener(list, home.get(), metadata.get()).appendHome(*home);
  }
  return list;
}

void NDAssistantGather::addToList_objectWithName_type_home_andIdentifer(HomeObjectRecords& list,
                                                                        const NDString& name,
                                                                        const NDString& type,
                                                                        const NDString& home,
                                                                        NDURL identifier) const {
  HomeFlattener(list, nullptr, nullptr).append(name, type, home, std::move(identifier));
}

void NDAssistantGather::addToList_room(HomeObjectRecords& list, const NDRoom& room) const {
  const auto home = room.home();
  HomeFlattener(list, home.get(), nullptr).appendRoom(room);
}

void NDAssistantGather::addToList_service(HomeObjectRecords& list,
                                          const std::shared_ptr<NDService>& service) const {
  const auto metadata = NDNAPMetadata::getSharedInstance();
  const auto accessory = service->accessory();
  const auto home = property(accessory, &NDAccessory::home);
  HomeFlattener(list, home.get(), metadata.get()).appendService(*service);
}

}  // namespace nidus
