#include "nidus/HomeEditing/HomeDifference.h"

#include <map>
#include <sstream>
#include <utility>

#include "HomePlatform/Store/HomeDocument.h"
#include "nidus/HomeEditing/HomeObjects.h"

namespace nidus {
namespace {

/// What is compared of one object.
struct Object {
  NDString name;
  std::string content;  ///< What it says beside its name and the objects in it.
};

/// Objects by what tells them apart from all others of their kind.
using Objects = std::map<std::string, Object>;
using ObjectsByKind = std::map<ObjectKind, Objects>;

/// The document of a home that has nothing but the object to be compared.
std::string contentOf(HomeData home) {
  home.uuid = NDUUID();
  home.name = "";
  std::ostringstream out;
  writeHomeDocument(out, {home}, false);
  return out.str();
}

std::string text(const NDUUID& uuid) { return uuid.UUIDString().str() + '/'; }

/// Lists all objects of an edition.
class Listing {
 public:
  explicit Listing(const std::vector<HomeData>& homes) {
    for (const HomeData& home : homes) addHome(home);
  }
  [[nodiscard]] ObjectsByKind take() { return std::move(objects_); }

 private:
  void addHome(const HomeData& home) {
    HomeData own;
    own.primary = home.primary;
    own.faults = home.faults;
    add(ObjectKind::home, text(home.uuid), home.name, std::move(own));
    addAll(ObjectKind::room, home, &HomeData::rooms);
    addAll(ObjectKind::zone, home, &HomeData::zones);
    for (const AccessoryData& accessory : home.accessories) {
      addServices(accessory, text(home.uuid) + text(accessory.uuid));
      AccessoryData bare = accessory;
      bare.services.clear();
      addOne(ObjectKind::accessory, home, &HomeData::accessories, std::move(bare));
    }
    addAll(ObjectKind::group, home, &HomeData::serviceGroups);
    addAll(ObjectKind::scene, home, &HomeData::actionSets);
    addAll(ObjectKind::trigger, home, &HomeData::triggers);
  }

  template <class Data>
  void addAll(ObjectKind kind, const HomeData& home, std::vector<Data> HomeData::*list) {
    for (const Data& data : home.*list) addOne(kind, home, list, data);
  }

  template <class Data>
  void addOne(ObjectKind kind, const HomeData& home, std::vector<Data> HomeData::*list, Data data) {
    const std::string identity = text(home.uuid) + text(data.uuid);
    const NDString name = std::exchange(data.name, "");
    HomeData own;
    (own.*list).push_back(std::move(data));
    add(kind, identity, name, std::move(own));
  }

  void addServices(const AccessoryData& accessory, const std::string& identity) {
    for (const ServiceData& service : accessory.services) {
      HomeData own;
      own.accessories.resize(1);
      own.accessories[0].name = "";
      own.accessories[0].services = {service};
      own.accessories[0].services[0].name = "";
      add(ObjectKind::service, identity + std::to_string(service.instanceID), service.name,
          std::move(own));
    }
  }

  void add(ObjectKind kind, const std::string& identity, const NDString& name, HomeData own) {
    objects_[kind][identity] = {name, contentOf(std::move(own))};
  }

  ObjectsByKind objects_;
};

/// How many objects of one kind differ, and in what.
struct Count {
  std::size_t added = 0;
  std::size_t removed = 0;
  std::size_t renamed = 0;
  std::size_t changed = 0;
};

Count compare(const Objects& before, const Objects& after) {
  Count count;
  for (const auto& [identity, object] : after) {
    const auto old = before.find(identity);
    if (old == before.end()) {
      ++count.added;
      continue;
    }
    if (!(old->second.name == object.name)) ++count.renamed;
    if (old->second.content != object.content) ++count.changed;
  }
  for (const auto& entry : before) {
    if (after.count(entry.first) == 0) ++count.removed;
  }
  return count;
}

}  // namespace

std::string differenceText(const std::vector<HomeData>& before,
                           const std::vector<HomeData>& after) {
  ObjectsByKind old = Listing(before).take();
  ObjectsByKind now = Listing(after).take();
  std::string text;
  for (const ObjectKind kind : kObjectKinds) {
    const Count count = compare(old[kind], now[kind]);
    const std::pair<std::size_t, const char*> parts[] = {{count.added, " added"},
                                                         {count.removed, " removed"},
                                                         {count.renamed, " renamed"},
                                                         {count.changed, " changed"}};
    for (const auto& [number, verb] : parts) {
      if (number > 0) text += (text.empty() ? "" : ", ") + counted(number, kind) + verb;
    }
  }
  return text;
}

}  // namespace nidus
