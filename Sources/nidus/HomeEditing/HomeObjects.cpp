#include "nidus/HomeEditing/HomeObjects.h"

#include <algorithm>
#include <iterator>
#include <numeric>
#include <string_view>
#include <utility>

#include "PlatformModel/System/NDTextMatching.h"
#include "nidus/Orders/NearMiss.h"

namespace nidus {
namespace {

struct KindWords {
  ObjectKind kind;
  const char* one;
  const char* many;
};

constexpr std::array kWords = {
    KindWords{ObjectKind::home, "home", "homes"},
    KindWords{ObjectKind::room, "room", "rooms"},
    KindWords{ObjectKind::zone, "zone", "zones"},
    KindWords{ObjectKind::accessory, "accessory", "accessories"},
    KindWords{ObjectKind::service, "service", "services"},
    KindWords{ObjectKind::group, "group", "groups"},
    KindWords{ObjectKind::scene, "scene", "scenes"},
    KindWords{ObjectKind::trigger, "trigger", "triggers"},
};

const KindWords& wordsOf(ObjectKind kind) {
  return *std::find_if(kWords.begin(), kWords.end(),
                       [kind](const KindWords& words) { return words.kind == kind; });
}

/// Calls `visit` with the home or the part of it at `place`.
template <class Homes, class Visit>
decltype(auto) visitAt(Homes& homes, ObjectKind kind, const ObjectPlace& place,
                       const Visit& visit) {
  auto& home = homes[place.home];
  switch (kind) {
    case ObjectKind::room:
      return visit(home.rooms[place.index]);
    case ObjectKind::zone:
      return visit(home.zones[place.index]);
    case ObjectKind::accessory:
      return visit(home.accessories[place.index]);
    case ObjectKind::service:
      return visit(home.accessories[place.index].services[place.service]);
    case ObjectKind::group:
      return visit(home.serviceGroups[place.index]);
    case ObjectKind::scene:
      return visit(home.actionSets[place.index]);
    case ObjectKind::trigger:
      return visit(home.triggers[place.index]);
    case ObjectKind::home:
      break;
  }
  return visit(home);
}

std::size_t countIn(const HomeData& home, ObjectKind kind) {
  switch (kind) {
    case ObjectKind::room:
      return home.rooms.size();
    case ObjectKind::zone:
      return home.zones.size();
    case ObjectKind::accessory:
    case ObjectKind::service:
      return home.accessories.size();
    case ObjectKind::group:
      return home.serviceGroups.size();
    case ObjectKind::scene:
      return home.actionSets.size();
    case ObjectKind::trigger:
      return home.triggers.size();
    case ObjectKind::home:
      break;
  }
  return 1;
}

/// The places of all objects of a kind within one home.
std::vector<ObjectPlace> placesIn(const std::vector<HomeData>& homes, std::size_t home,
                                  ObjectKind kind) {
  std::vector<ObjectPlace> places;
  for (std::size_t i = 0; i < countIn(homes[home], kind); ++i) {
    const bool isService = kind == ObjectKind::service;
    const std::size_t count = isService ? homes[home].accessories[i].services.size() : 1;
    for (std::size_t service = 0; service < count; ++service) places.push_back({home, i, service});
  }
  return places;
}

bool isUUID(std::string_view text, const NDUUID& uuid) { return NDUUID::fromText(text) == uuid; }

template <class Object>
bool isNamed(const Object& object, std::string_view text) {
  return object.name == text || isUUID(text, object.uuid);
}

/// Whether `text` is the accessory, a slash and the service.
bool isPathOf(const AccessoryData& accessory, const ServiceData& service, std::string_view text) {
  for (auto slash = text.find('/'); slash != text.npos; slash = text.find('/', slash + 1)) {
    const std::string_view last = text.substr(slash + 1);
    const bool isService = service.name == last || std::to_string(service.instanceID) == last;
    if (isService && isNamed(accessory, text.substr(0, slash))) return true;
  }
  return false;
}

bool isNamedAt(const std::vector<HomeData>& homes, ObjectKind kind, const ObjectPlace& place,
               std::string_view text) {
  if (kind == ObjectKind::service) {
    const AccessoryData& accessory = homes[place.home].accessories[place.index];
    const ServiceData& service = accessory.services[place.service];
    return service.name == text || isPathOf(accessory, service, text);
  }
  bool isSought = false;
  visitAt(homes, kind, place, [&](const auto& object) {
    if constexpr (requires { object.uuid; }) isSought = isNamed(object, text);
  });
  return isSought;
}

/// The name as it is shown, and as it can be given; a service's with that of its accessory.
std::string spellingAt(const std::vector<HomeData>& homes, ObjectKind kind,
                       const ObjectPlace& place) {
  const NDString& name = nameAt(homes, kind, place);
  if (kind != ObjectKind::service) return name.str();
  const AccessoryData& accessory = homes[place.home].accessories[place.index];
  return accessory.name.str() + '/' +
         (name ? name.str() : std::to_string(accessory.services[place.service].instanceID));
}

std::string withHome(const std::vector<HomeData>& homes, ObjectKind kind,
                     const ObjectPlace& place) {
  const std::string spelling = spellingAt(homes, kind, place);
  return kind == ObjectKind::home ? spelling : spelling + " of " + homes[place.home].name.str();
}

Failure ambiguity(const std::vector<HomeData>& homes, const ObjectWords& words,
                  const std::vector<ObjectPlace>& found) {
  constexpr std::size_t kMost = 8;
  std::string list;
  for (std::size_t i = 0; i < std::min(found.size(), kMost); ++i) {
    list += (list.empty() ? "" : ", ") + withHome(homes, words.kind, found[i]) + " (" +
            identityAt(homes, words.kind, found[i]) + ')';
  }
  if (found.size() > kMost) list += " and " + std::to_string(found.size() - kMost) + " more";
  return badInput("there are " + counted(found.size(), words.kind) + " named " + words.name + ": " +
                  list + "; say which by what stands in brackets" +
                  (words.kind == ObjectKind::home ? "" : ", or its home with --home"));
}

Failure absence(const std::vector<HomeData>& homes, const ObjectWords& words,
                const std::vector<ObjectPlace>& sought) {
  std::vector<std::string> spellings;
  spellings.reserve(2 * sought.size());
  for (const ObjectPlace& place : sought) {
    spellings.push_back(nameAt(homes, words.kind, place).str());
    spellings.push_back(spellingAt(homes, words.kind, place));
  }
  return absenceOf(words.kind, words.name, spellings);
}

Result<ObjectPlace> findAmong(const std::vector<HomeData>& homes,
                              const std::vector<std::size_t>& range, const ObjectWords& words) {
  std::vector<ObjectPlace> sought;
  for (const std::size_t home : range) {
    const auto places = placesIn(homes, home, words.kind);
    sought.insert(sought.end(), places.begin(), places.end());
  }
  std::vector<ObjectPlace> found;
  std::copy_if(
      sought.begin(), sought.end(), std::back_inserter(found),
      [&](const ObjectPlace& place) { return isNamedAt(homes, words.kind, place, words.name); });
  if (found.size() == 1) return found.front();
  return found.empty() ? absence(homes, words, sought) : ambiguity(homes, words, found);
}

}  // namespace

std::string wordOf(ObjectKind kind) { return wordsOf(kind).one; }

std::string pluralOf(ObjectKind kind) { return wordsOf(kind).many; }

std::string counted(std::size_t count, ObjectKind kind) {
  return std::to_string(count) + ' ' + (count == 1 ? wordOf(kind) : pluralOf(kind));
}

Result<ObjectPlace> findObject(const std::vector<HomeData>& homes, const ObjectWords& words) {
  if (!words.home.empty() && words.kind != ObjectKind::home) {
    const auto home = findHome(homes, words.home);
    return home ? findObjectIn(homes, *home, words) : Result<ObjectPlace>(home.failure());
  }
  std::vector<std::size_t> all(homes.size());
  std::iota(all.begin(), all.end(), std::size_t{0});
  return findAmong(homes, all, words);
}

Result<ObjectPlace> findObjectIn(const std::vector<HomeData>& homes, std::size_t home,
                                 const ObjectWords& words) {
  return findAmong(homes, {home}, words);
}

Result<std::size_t> findHome(const std::vector<HomeData>& homes, const std::string& name) {
  if (!name.empty()) {
    const auto place = findObject(homes, {ObjectKind::home, name, ""});
    return place ? Result<std::size_t>(place->home) : Result<std::size_t>(place.failure());
  }
  if (homes.size() == 1) return std::size_t{0};
  if (homes.empty()) return badInput("there is no home yet; nidus home add home NAME adds one");
  return badInput("there are " + counted(homes.size(), ObjectKind::home) +
                  "; say which with --home NAME");
}

const NDString& nameAt(const std::vector<HomeData>& homes, ObjectKind kind,
                       const ObjectPlace& place) {
  return visitAt(homes, kind, place,
                 [](const auto& object) -> const NDString& { return object.name; });
}

NDString& nameAt(std::vector<HomeData>& homes, ObjectKind kind, const ObjectPlace& place) {
  return visitAt(homes, kind, place, [](auto& object) -> NDString& { return object.name; });
}

std::string identityAt(const std::vector<HomeData>& homes, ObjectKind kind,
                       const ObjectPlace& place) {
  if (kind == ObjectKind::service) {
    const AccessoryData& accessory = homes[place.home].accessories[place.index];
    return accessory.uuid.UUIDString().str() + '/' +
           std::to_string(accessory.services[place.service].instanceID);
  }
  std::string text;
  visitAt(homes, kind, place, [&](const auto& object) {
    if constexpr (requires { object.uuid; }) text = object.uuid.UUIDString().str();
  });
  return text;
}

std::string describe(const std::vector<HomeData>& homes, ObjectKind kind,
                     const ObjectPlace& place) {
  return "the " + wordOf(kind) + ' ' + withHome(homes, kind, place);
}

Failure absenceOf(ObjectKind kind, const std::string& name, const std::vector<std::string>& known) {
  const std::vector<std::string_view> words(known.begin(), known.end());
  const std::string_view meant = nearMiss(name, words);
  return badInput("there is no " + wordOf(kind) + ' ' + name +
                  (meant.empty() ? "; nidus home show lists what there is"
                                 : "; did you mean " + std::string(meant) + '?'));
}

Failure badInput(std::string message) { return {Failure::Kind::badInput, std::move(message)}; }

namespace {

bool isControl(char32_t c) {
  constexpr char32_t kFirstPrintable = 0x20;
  constexpr char32_t kDelete = 0x7f;
  constexpr char32_t kLastControl = 0x9f;
  return c < kFirstPrintable || (c >= kDelete && c <= kLastControl);
}

}  // namespace

Status checkName(const std::string& name) {
  if (name.find_first_not_of(' ') == std::string::npos)
    return badInput("a name must not be empty or blank; give one");
  if (!isUTF8(name)) return badInput("the name " + name + " is not UTF-8; give it in UTF-8");
  const std::u32string codePoints = withoutDiacritics(name);
  if (std::any_of(codePoints.begin(), codePoints.end(), isControl)) {
    return badInput("the name " + name + " has control characters; leave them out");
  }
  return std::nullopt;
}

}  // namespace nidus
