#include "nidus/Watch/HomeChange.h"

#include <utility>

#include "nidus/AttributeText.h"
#include "nidus/ObjectPairs.h"
#include "nidus/ObjectPath.h"

namespace nidus {
namespace {

NDDictionaryValue contentOf(const NDValue& value) {
  if (value.isBoolean()) return NDDictionaryValue(value.boolValue());
  if (value.isInteger()) return NDDictionaryValue(value.integerValue());
  if (value.isFloating()) return NDDictionaryValue(value.floatValue());
  return NDDictionaryValue(value.stringValue());
}

const char* keyOf(const NDValue& value) {
  if (value.isBoolean()) return "boolean";
  if (value.isInteger()) return "integer";
  return value.isFloating() ? "float" : "string";
}

/// Null gives the empty dictionary.
NDDictionary dictionaryOf(const NDValueRef& value) {
  NDDictionary dictionary;
  if (value) dictionary.set(keyOf(*value), contentOf(*value));
  return dictionary;
}

NDDictionary dictionaryOf(const NDString& text) {
  return text ? dictionaryOf(NDValue::text(text)) : NDDictionary();
}

bool isSame(const NDValueRef& a, const NDValueRef& b) { return a && b ? a->isEqual(*b) : !a && !b; }

NDString shownName(const ServiceData& service) {
  return service.name ? service.name : NDString("(no name)");
}

/// Compares two states of the homes.
class Comparison {
 public:
  explicit Comparison(const MetadataMapper& metadata) : metadata_(metadata) {}

  std::vector<HomeChange> run(const std::vector<HomeData>& before,
                              const std::vector<HomeData>& after) {
    forEachPair(before, after,
                [this](const HomeData* old, const HomeData* now) { compareHomes(old, now); });
    return std::move(changes_);
  }

 private:
  /// Appends a change of the object that `place_` says.
  HomeChange& add(HomeChange::Kind kind) {
    HomeChange& change = changes_.emplace_back();
    change.kind = kind;
    change.place = place_;
    change.earlier = earlier_;
    return change;
  }

  void addValues(std::string attribute, NDDictionary before, NDDictionary after) {
    HomeChange& change = add(HomeChange::Kind::changed);
    change.attribute = std::move(attribute);
    change.before = std::move(before);
    change.after = std::move(after);
  }

  void compareTexts(const char* attribute, const NDString& before, const NDString& after) {
    if (before == after) return;
    addValues(attribute, dictionaryOf(before), dictionaryOf(after));
  }

  /// Whether the object was and is there; tells when it was or is not.
  bool isThere(const void* old, const void* now) {
    if (!old) add(HomeChange::Kind::added);
    if (!now) add(HomeChange::Kind::removed);
    return old && now;
  }

  /// Says one part of the place.
  void enter(NDString ChangePlace::*part, NDString old, NDString now) {
    earlier_.*part = std::move(old);
    place_.*part = std::move(now);
  }
  void leave(NDString ChangePlace::*part) { enter(part, nullptr, nullptr); }

  void compareHomes(const HomeData* old, const HomeData* now) {
    enter(&ChangePlace::home, (old ? old : now)->name, (now ? now : old)->name);
    if (!isThere(old, now)) return;
    compareTexts("name", old->name, now->name);
    forEachPair(old->rooms, now->rooms, [this](const RoomData* oldOne, const RoomData* nowOne) {
      compareRooms(oldOne, nowOne);
      leave(&ChangePlace::room);
    });
    forEachPair(old->accessories, now->accessories,
                [&](const AccessoryData* oldOne, const AccessoryData* nowOne) {
                  compareAccessories({*old, oldOne}, {*now, nowOne});
                  leave(&ChangePlace::accessory);
                  leave(&ChangePlace::room);
                });
  }

  void compareRooms(const RoomData* old, const RoomData* now) {
    enter(&ChangePlace::room, (old ? old : now)->name, (now ? now : old)->name);
    if (isThere(old, now)) compareTexts("name", old->name, now->name);
  }

  /// An accessory, null where there is none, and its home.
  struct PlacedAccessory {
    const HomeData& home;
    const AccessoryData* data;
    [[nodiscard]] NDString room() const { return roomNameOf(home, *data); }
  };

  void compareAccessories(const PlacedAccessory& old, const PlacedAccessory& now) {
    const PlacedAccessory& first = old.data ? old : now;
    const PlacedAccessory& last = now.data ? now : old;
    enter(&ChangePlace::room, first.room(), last.room());
    enter(&ChangePlace::accessory, first.data->name, last.data->name);
    if (!isThere(old.data, now.data)) return;
    compareTexts("name", old.data->name, now.data->name);
    if (old.data->room != now.data->room) compareTexts("room", old.room(), now.room());
    if (old.data->reachable != now.data->reachable) {
      addValues("reachable", dictionaryOf(NDValue::boolean(old.data->reachable)),
                dictionaryOf(NDValue::boolean(now.data->reachable)));
    }
    forEachPair(old.data->services, now.data->services,
                [this](const ServiceData* oldOne, const ServiceData* nowOne) {
                  compareServices(oldOne, nowOne);
                  leave(&ChangePlace::service);
                });
  }

  void compareServices(const ServiceData* old, const ServiceData* now) {
    enter(&ChangePlace::service, shownName(*(old ? old : now)), shownName(*(now ? now : old)));
    if (!isThere(old, now)) return;
    compareTexts("name", old->name, now->name);
    forEachPair(old->characteristics, now->characteristics,
                [this](const CharacteristicData* oldOne, const CharacteristicData* nowOne) {
                  compareValues(oldOne, nowOne);
                });
  }

  void compareValues(const CharacteristicData* old, const CharacteristicData* now) {
    if (isSame(old ? old->value : nullptr, now ? now->value : nullptr)) return;
    const NDString& type = (now ? now : old)->characteristicType;
    addValues(attributeText(type, metadata_), valueOf(old), valueOf(now));
  }

  /// The value as the assistant has it, and the unit of the device.
  [[nodiscard]] NDDictionary valueOf(const CharacteristicData* data) const {
    if (!data || !data->value) return {};
    const NDString& type = data->characteristicType;
    const NDValueRef value = metadata_.mapToAssistantCharacteristicValue_name(data->value, type);
    NDDictionary dictionary = dictionaryOf(value);
    const bool hasOwnUnit = data->metadata && data->metadata->units;
    const NDString unit =
        hasOwnUnit ? data->metadata->units : metadata_.characteristicValueUnit(type);
    const NDString unitName = metadata_.mapToAssistantUnitName(unit);
    if (value->isNumber()) dictionary.setIfPresent("units", unitName ? unitName : unit);
    return dictionary;
  }

  const MetadataMapper& metadata_;
  ChangePlace place_;    ///< Where the comparison is, in the later state.
  ChangePlace earlier_;  ///< The same in the earlier one.
  std::vector<HomeChange> changes_;
};

}  // namespace

std::vector<HomeChange> changesBetween(const std::vector<HomeData>& before,
                                       const std::vector<HomeData>& after,
                                       const MetadataMapper& metadata) {
  return Comparison(metadata).run(before, after);
}

}  // namespace nidus
