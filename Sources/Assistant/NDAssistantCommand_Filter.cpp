#include <algorithm>
#include <string>
#include <string_view>
#include <unordered_map>

#include "Assistant/NDAssistantCommand.h"
#include "Assistant/ServiceLookUp.h"
#include "Logging/WLOLog.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDLookUp.h"
#include "PlatformModel/System/NDNull.h"
#include "PlatformModel/System/NDTextMatching.h"

namespace nidus {
namespace {

using ObjectList = NDAssistantCommand::ObjectList;

// The matching rules. A record that lacks the field never matches.

bool isEqual(const NDString& field, const NDString& text) { return field && field == text; }

bool isEqualButDiacritics(const NDString& field, const NDString& text) {
  return field && text && isEqualIgnoringDiacritics(field.view(), text.view());
}

bool contains(const NDURL& field, const NDString& part) {
  return field && part && containsIgnoringCase(field.text().view(), part.view());
}

/// Says which lists contain a text. Objects that follow each other often share their list, and its
/// answer is remembered.
class ListsWith {
 public:
  explicit ListsWith(const NDString& text) : text_(text) {}

  [[nodiscard]] bool contain(const TextList& list) {
    if (list.begin() != last_) {
      last_ = list.begin();
      contains_ = text_ && std::find(list.begin(), list.end(), text_) != list.end();
    }
    return contains_;
  }

 private:
  const NDString& text_;
  TextList::const_iterator last_ = nullptr;  // that of the empty list, which contains nothing
  bool contains_ = false;
};

template <class Predicate>
ObjectList matching(const ObjectList& objects, const Predicate& matches) {
  ObjectList kept;
  kept.reserve(objects.size());
  for (const HomeObjectRecord* object : objects) {
    if (matches(*object)) kept.push_back(object);
  }
  return kept;
}

void append(ObjectList& list, const ObjectList& more) {
  list.insert(list.end(), more.begin(), more.end());
}

/// Says whether `object` is a room that is meant; a room without a name is nobody's.
bool isRoom(const HomeObjectRecord& object, const NDString& roomName, const NDString& zoneName) {
  return object.objectType == VAHAEntityTypeROOMValue && object.objectName &&
         (!zoneName || isEqualButDiacritics(object.objectZone, zoneName)) &&
         (!roomName || isEqualButDiacritics(object.objectName, roomName));
}

/// Lets names without diacritics be looked for by code points, or by a text of ASCII as it stands.
struct PlainNameHash {
  using is_transparent = void;
  template <class Text>
  std::size_t operator()(const Text& name) const noexcept {
    std::size_t mixed = 0;
    for (const auto character : name) mixed = mixed * 131 + static_cast<char32_t>(character);
    return mixed;
  }
};
struct PlainNameEqual {
  using is_transparent = void;
  template <class A, class B>
  bool operator()(const A& a, const B& b) const noexcept {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [](auto x, auto y) {
      return static_cast<char32_t>(x) == static_cast<char32_t>(y);
    });
  }
};

bool isASCII(std::string_view text) {
  return std::all_of(text.begin(), text.end(),
                     [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}

/// The records of a list that are in certain rooms, by the names of these, diacritics ignored.
class ObjectsByRoom {
 public:
  /// Gives the place of the records in rooms of that name, which are kept from now on. It stays
  /// where it is.
  [[nodiscard]] const ObjectList& inRoom(const NDString& roomName) {
    return byName_[withoutDiacritics(roomName.view())];
  }

  /// Puts each record of `objects` into its place, if it has one.
  void add(const ObjectList& objects) {
    // The objects of a room share the text of its name, and mostly follow each other.
    const char* name = nullptr;
    ObjectList* place = nullptr;
    for (const HomeObjectRecord* object : objects) {
      if (!object->objectRoom) continue;
      const std::string_view roomName = object->objectRoom.view();
      if (roomName.data() != name) place = placeOf(roomName);
      name = roomName.data();
      if (place) place->push_back(object);
    }
  }

 private:
  ObjectList* placeOf(std::string_view roomName) {
    const auto found =
        isASCII(roomName) ? byName_.find(roomName) : byName_.find(withoutDiacritics(roomName));
    return found == byName_.end() ? nullptr : &found->second;
  }

  std::unordered_map<std::u32string, ObjectList, PlainNameHash, PlainNameEqual> byName_;
};

/// One search: narrows the snapshot field by field of the filter. A step runs only while there is
/// something left and its field is there; what is not reached is neither applied nor logged.
class SearchNarrowing {
 public:
  SearchNarrowing(const NDAssistantCommand& command, const VAHASearchCriteriaFilter& filter,
                  NDAssistantCommandObserver* observer)
      : command_(command),
        filter_(filter),
        observer_(observer),
        isLogged_(WLOShouldLogAtLevel(6)),
        entityType_(filter.entityType()) {
    keep("snapshot", command.allObjects());
  }

  std::optional<ObjectList> run(const NDString& homeName) {
    if (!narrowToHome(homeName)) return std::nullopt;
    settleEntityType();
    narrowToEntityType();
    if (!narrowToServiceType()) return std::nullopt;
    narrowToRoomAndZone();
    narrowToGroup();
    narrowToServiceName();
    narrowToSceneName();
    narrowToAttribute();
    if (isLogged_) WLOLog(6, "Incoming Filter: %@", {pieces_});
    return std::move(list_);
  }

 private:
  [[nodiscard]] bool isReached(const NDString& field) const { return !list_.empty() && field; }

  void addPiece(std::string_view key, const NDString& text) {
    if (isLogged_) pieces_.append(key).append("=").append(text.view()).append("/");
  }

  void keep(std::string_view step, ObjectList list) {
    list_ = std::move(list);
    if (!observer_) return;
    NDDictionaryList kept;
    for (const HomeObjectRecord* object : list_) kept.emplace_back(object->dictionary());
    observer_->filterDidRunStep(step, kept);
  }

  [[nodiscard]] long homesWithName(const NDString& name) const {
    return std::count_if(list_.begin(), list_.end(), [&name](const HomeObjectRecord* object) {
      return object->objectType == VAHAEntityTypeHOMEValue && isEqual(object->objectName, name);
    });
  }

  bool narrowToHome(const NDString& name) {
    if (!isReached(name)) return true;
    addPiece("home", name);
    if (homesWithName(name) < 2) {
      keep("home", matching(list_, [&name](const HomeObjectRecord& object) {
             return isEqual(object.objectHome, name);
           }));
      return true;
    }
    if (name == command_.primaryHomeName()) {
      // Homes share the name, so only the home's UUID, which stands in the identifier of all that
      // it holds, tells its objects from the others'.
      keep("home", matching(list_, [this](const HomeObjectRecord& object) {
             return contains(object.objectIdentifier, command_.primaryHomeID());
           }));
      return true;
    }
    if (WLOShouldLogAtLevel(4)) WLOLog(4, "Multiple homes with same name but no primary home", {});
    command_.reportOutcome_results_handler(VAHACommandOutcomeCOMMAND_FAILUREValue, std::nullopt,
                                           nullptr);
    return false;
  }

  /// An attribute speaks of services, and is the only reason why an entity type is logged.
  void settleEntityType() {
    if (!isReached(filter_.attribute())) return;
    addPiece("attribute", filter_.attribute());
    if (!entityType_) {
      entityType_ = VAHAEntityTypeSERVICEValue;
      return;
    }
    addPiece("entity", entityType_);
    if (!(entityType_ == VAHAEntityTypeSERVICEValue) && WLOShouldLogAtLevel(4)) {
      WLOLog(4, "Attribute specified in search filter with entityType not SERVICE(%@)", {filter_});
    }
  }

  void narrowToEntityType() {
    if (!isReached(entityType_)) return;
    keep("entityType", matching(list_, [this](const HomeObjectRecord& object) {
           return isEqual(object.objectType, entityType_);
         }));
  }

  /// Services come before the others by what is plugged into them, and twice when both types match.
  bool narrowToServiceType() {
    if (!isReached(filter_.serviceType())) return true;
    addPiece("serviceType", filter_.serviceType());
    const NDString type = property(command_.metadata(), &NDNAPMetadata::mapFromAssistantServiceName,
                                   filter_.serviceType());
    if (!type) return false;
    const auto isAssociated = [&type](const HomeObjectRecord& object) {
      return isEqual(object.objectAssociatedServiceType, type);
    };
    const auto isOfType = [&type](const HomeObjectRecord& object) {
      return isEqual(object.objectServiceType, type);
    };
    ObjectList services = matching(list_, isAssociated);
    append(services, matching(list_, isOfType));
    keep("serviceType", std::move(services));
    return true;
  }

  void narrowToRoomAndZone() {
    const NDString& room = filter_.roomName();
    const NDString& zone = filter_.zoneName();
    if (!isReached(room) && !isReached(zone)) return;
    if (zone) addPiece("zone", zone);
    if (room) addPiece("room", room);
    keep("room and zone", command_.filterObjects_forRoom_andZone(list_, room, zone));
  }

  void narrowToGroup() {
    if (!isReached(filter_.groupName())) return;
    addPiece("group", filter_.groupName());
    keep("group", command_.filterObjects_forGroup(list_, filter_.groupName()));
  }

  void narrowToServiceName() {
    if (!isReached(filter_.serviceName())) return;
    addPiece("service", filter_.serviceName());
    keepNamed("serviceName", filter_.serviceName());
  }

  void narrowToSceneName() {
    if (!isReached(filter_.sceneName())) return;
    addPiece("scene", filter_.sceneName());
    keepNamed("sceneName", filter_.sceneName());
  }

  void keepNamed(std::string_view step, const NDString& name) {
    keep(step, matching(list_, [&name](const HomeObjectRecord& object) {
           return isEqualButDiacritics(object.objectName, name);
         }));
  }

  void narrowToAttribute() {
    if (!isReached(filter_.attribute())) return;
    keep("attribute", command_.filterObjects_byAttribute(list_, filter_.attribute()));
  }

  const NDAssistantCommand& command_;
  const VAHASearchCriteriaFilter& filter_;
  NDAssistantCommandObserver* const observer_;
  const bool isLogged_;
  NDString entityType_;
  ObjectList list_;
  std::string pieces_;
};

}  // namespace

std::optional<ObjectList> NDAssistantCommand::objectsWithSearchFilter_inHome(
    const VAHASearchCriteriaFilter& filter, const NDString& homeName) const {
  return SearchNarrowing(*this, filter, observer_.get()).run(homeName);
}

ObjectList NDAssistantCommand::filterObjects_forRoom_andZone(const ObjectList& objects,
                                                             const NDString& roomName,
                                                             const NDString& zoneName) const {
  ObjectsByRoom objectsByRoom;
  std::vector<const ObjectList*> rooms;
  for (const HomeObjectRecord& object : nidusObjects_) {
    if (!isRoom(object, roomName, zoneName)) continue;
    rooms.push_back(&objectsByRoom.inRoom(object.objectName));
  }
  objectsByRoom.add(objects);
  ObjectList kept;
  for (const ObjectList* room : rooms) append(kept, *room);
  return kept;
}

ObjectList NDAssistantCommand::filterObjects_forGroup(const ObjectList& objects,
                                                      const NDString& groupName) const {
  ListsWith listsWithName(groupName);
  return matching(objects, [&listsWithName](const HomeObjectRecord& object) {
    return listsWithName.contain(object.objectGroups);
  });
}

ObjectList NDAssistantCommand::filterObjects_byAttribute(const ObjectList& objects,
                                                         const NDString& attribute) const {
  const NDString type =
      property(metadata_, &NDNAPMetadata::mapReadCharcteristicFromAssistantName, attribute);
  ListsWith listsWithType(type);
  const auto hasType = [&listsWithType](const HomeObjectRecord& object) {
    return object.objectType == VAHAEntityTypeSERVICEValue &&
           listsWithType.contain(object.objectCharacteristics);
  };
  return matching(objects, hasType);
}

NDAssistantCommand::CharacteristicList NDAssistantCommand::filterObjects_forcharacteristicType(
    const ObjectList& objects, const NDString& type) const {
  CharacteristicList found;
  found.reserve(objects.size());
  ServiceLookUp lookUp(gather_);
  for (const HomeObjectRecord* object : objects) {
    const auto service = lookUp.service(*object);
    if (!service) {
      if (WLOShouldLogAtLevel(4)) WLOLog(4, "Filtered object %@ not a service", {*object});
      continue;
    }
    auto characteristic = findInArrayByCharacteristicType(service->characteristics(), type);
    if (characteristic) found.push_back(std::move(characteristic));
  }
  if (observer_) observer_->actionDidReach(found);
  return found;
}

ObjectList NDAssistantCommand::objectsWithIdentifierList(
    const std::vector<NDURL>& /*identifiers*/) const {
  // The search starts from no list instead of the snapshot, so nothing is ever found. Hosts have
  // come to rely on that reply; it is not to be repaired here.
  return {};
}

}  // namespace nidus
