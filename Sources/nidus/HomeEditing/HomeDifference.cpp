#include "nidus/HomeEditing/HomeDifference.h"

#include <algorithm>
#include <map>
#include <optional>
#include <utility>

#include "HomePlatform/Store/ValueConversion.h"
#include "nidus/HomeEditing/HomeObjects.h"
#include "nidus/ObjectPairs.h"

namespace nidus {
namespace {

bool isSame(const std::optional<MetadataData>& a, const std::optional<MetadataData>& b) {
  if (!a || !b) return !a && !b;
  return a->format == b->format && a->units == b->units &&
         isSameValue(a->minimumValue, b->minimumValue) &&
         isSameValue(a->maximumValue, b->maximumValue) && isSameValue(a->stepValue, b->stepValue);
}

bool isSame(const CharacteristicData& a, const CharacteristicData& b) {
  return a.instanceID == b.instanceID && a.characteristicType == b.characteristicType &&
         a.properties == b.properties && isSameValue(a.value, b.value) &&
         isSameValue(a.deviceValue, b.deviceValue) && isSame(a.metadata, b.metadata) &&
         a.faults == b.faults;
}

bool isSame(const SceneActionData& a, const SceneActionData& b) {
  return a.target == b.target && isSameValue(a.value, b.value);
}

template <class Part>
bool areSame(const std::vector<Part>& a, const std::vector<Part>& b) {
  return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                    [](const Part& one, const Part& other) { return isSame(one, other); });
}

/// Whether two states of an object say the same beside its name and the objects in it.
bool isSameBeside(const HomeData& a, const HomeData& b) {
  return a.primary == b.primary && a.faults == b.faults;
}
bool isSameBeside(const RoomData& /*a*/, const RoomData& /*b*/) { return true; }
bool isSameBeside(const ZoneData& a, const ZoneData& b) { return a.rooms == b.rooms; }
bool isSameBeside(const AccessoryData& a, const AccessoryData& b) {
  return a.room == b.room && a.reachable == b.reachable && a.requiresUnlock == b.requiresUnlock &&
         a.faults == b.faults;
}
bool isSameBeside(const ServiceData& a, const ServiceData& b) {
  return a.serviceType == b.serviceType && a.associatedServiceType == b.associatedServiceType &&
         areSame(a.characteristics, b.characteristics);
}
bool isSameBeside(const ServiceGroupData& a, const ServiceGroupData& b) {
  return a.services == b.services;
}
bool isSameBeside(const ActionSetData& a, const ActionSetData& b) {
  return areSame(a.actions, b.actions) && a.executeFault == b.executeFault;
}
bool isSameBeside(const TriggerData& /*a*/, const TriggerData& /*b*/) { return true; }

/// How many objects of one kind differ, and in what.
struct Count {
  std::size_t added = 0;
  std::size_t removed = 0;
  std::size_t renamed = 0;
  std::size_t changed = 0;
};

/// Compares two editions of the homes.
class EditionComparison {
 public:
  EditionComparison(const std::vector<HomeData>& before, const std::vector<HomeData>& after) {
    compareLists(ObjectKind::home, before, after);
  }

  /// The counts of all that differs.
  [[nodiscard]] std::string text() const {
    std::string text;
    for (const auto& [kind, count] : counts_) {
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
  [[nodiscard]] bool isOrderSame() const { return isOrderSame_; }

 private:
  template <class Object>
  void compareLists(ObjectKind kind, const std::vector<Object>& before,
                    const std::vector<Object>& after) {
    forEachPair(before, after, [this, kind](const Object* old, const Object* now) {
      compare(kind, old, now);
      compareParts(old, now);
    });
    isOrderSame_ = isOrderSame_ && std::equal(before.begin(), before.end(), after.begin(),
                                              after.end(), [](const Object& a, const Object& b) {
                                                return keyOf(a) == keyOf(b);
                                              });
  }

  template <class Object>
  void compare(ObjectKind kind, const Object* old, const Object* now) {
    Count& count = counts_[kind];
    if (!old) ++count.added;
    if (!now) ++count.removed;
    if (!old || !now) return;
    if (!(old->name == now->name)) ++count.renamed;
    if (!isSameBeside(*old, *now)) ++count.changed;
  }

  void compareParts(const HomeData* old, const HomeData* now) {
    compareParts(ObjectKind::room, old, now, &HomeData::rooms);
    compareParts(ObjectKind::zone, old, now, &HomeData::zones);
    compareParts(ObjectKind::accessory, old, now, &HomeData::accessories);
    compareParts(ObjectKind::group, old, now, &HomeData::serviceGroups);
    compareParts(ObjectKind::scene, old, now, &HomeData::actionSets);
    compareParts(ObjectKind::trigger, old, now, &HomeData::triggers);
  }
  void compareParts(const AccessoryData* old, const AccessoryData* now) {
    compareParts(ObjectKind::service, old, now, &AccessoryData::services);
  }
  /// All others have none.
  void compareParts(const void* /*old*/, const void* /*now*/) {}

  /// The parts of one kind; an object that is not there has none.
  template <class Owner, class Object>
  void compareParts(ObjectKind kind, const Owner* old, const Owner* now,
                    std::vector<Object> Owner::*list) {
    const std::vector<Object> none;
    compareLists(kind, old ? old->*list : none, now ? now->*list : none);
  }

  std::map<ObjectKind, Count> counts_;  ///< In the order in which they are told.
  bool isOrderSame_ = true;
};

}  // namespace

std::string differenceText(const std::vector<HomeData>& before,
                           const std::vector<HomeData>& after) {
  return EditionComparison(before, after).text();
}

bool isSame(const std::vector<HomeData>& before, const std::vector<HomeData>& after) {
  const EditionComparison comparison(before, after);
  return comparison.isOrderSame() && comparison.text().empty();
}

}  // namespace nidus
