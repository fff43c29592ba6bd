#pragma once

#include <array>
#include <cstddef>
#include <string>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// The kinds of objects that a person can name.
enum class ObjectKind { home, room, zone, accessory, service, group, scene, trigger };

inline constexpr std::array kObjectKinds = {
    ObjectKind::home,    ObjectKind::room,  ObjectKind::zone,  ObjectKind::accessory,
    ObjectKind::service, ObjectKind::group, ObjectKind::scene, ObjectKind::trigger};

/// The word for one object of a kind ("accessory"), and for any other number of them.
[[nodiscard]] std::string wordOf(ObjectKind kind);
[[nodiscard]] std::string pluralOf(ObjectKind kind);
/// Such as "1 room" or "3 accessories".
[[nodiscard]] std::string counted(std::size_t count, ObjectKind kind);

/// How a person names an object.
struct ObjectWords {
  ObjectKind kind = ObjectKind::home;
  /// Its name or its UUID. A service goes by its name, by its accessory's name or UUID, a slash and
  /// its name, or by the same with its instance ID: "Lamp", "Floor lamp/Lamp", "Floor lamp/8".
  std::string name;
  std::string home;  ///< The name or UUID of the home it is in; empty for any home.
};

/// Where an object stands in a list of homes.
struct ObjectPlace {
  std::size_t home = 0;
  std::size_t index = 0;    ///< In the home's list of its kind; that of a service's accessory.
  std::size_t service = 0;  ///< Of a service: in the list of its accessory.
};

/// Finds the one object that `words` name. A failure is bad input: it names a near miss, or all
/// objects of that name, with what tells them apart.
[[nodiscard]] Result<ObjectPlace> findObject(const std::vector<HomeData>& homes,
                                             const ObjectWords& words);
/// The same within the home at `home`; `words.home` is not looked at.
[[nodiscard]] Result<ObjectPlace> findObjectIn(const std::vector<HomeData>& homes, std::size_t home,
                                               const ObjectWords& words);
/// The place of the home of that name or UUID; without a name that of the only home there is.
[[nodiscard]] Result<std::size_t> findHome(const std::vector<HomeData>& homes,
                                           const std::string& name);

/// The name of the object at `place`, to be read or changed. That of a service may be null.
[[nodiscard]] const NDString& nameAt(const std::vector<HomeData>& homes, ObjectKind kind,
                                     const ObjectPlace& place);
[[nodiscard]] NDString& nameAt(std::vector<HomeData>& homes, ObjectKind kind,
                               const ObjectPlace& place);

/// What names the object at `place` within its home beyond doubt: its UUID; for a service that of
/// its accessory, a slash and its instance ID.
[[nodiscard]] std::string identityAt(const std::vector<HomeData>& homes, ObjectKind kind,
                                     const ObjectPlace& place);

/// Such as "the room Kitchen of Beach House"; a service comes with its accessory: "the service
/// Floor lamp/Lamp of Beach House".
[[nodiscard]] std::string describe(const std::vector<HomeData>& homes, ObjectKind kind,
                                   const ObjectPlace& place);

/// The failure that nothing of a kind is named `name`; names a near miss among `known` spellings.
[[nodiscard]] Failure absenceOf(ObjectKind kind, const std::string& name,
                                const std::vector<std::string>& known);

/// A failure of that message that is the fault of what was given.
[[nodiscard]] Failure badInput(std::string message);

/// Refuses what can be no name that a person sees: a blank text, one that is not UTF-8, and one
/// with control characters.
[[nodiscard]] Status checkName(const std::string& name);

}  // namespace nidus
