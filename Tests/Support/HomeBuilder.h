#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

#include "Support/CharacteristicSpec.h"
#include "Support/TestHome.h"

namespace nidus {

/// Makes small homes for tests: says what matters and fills in the rest, fixed UUIDs and instance
/// IDs included.
///
///     auto home = HomeBuilder("Cabin").primary()
///                     .room("Kitchen").light("Lamp", {power(true), brightness(40)})
///                     .group("Evening", {"Lamp"}).scene("Good night").build();
class HomeBuilder {
 public:
  using Characteristics = std::vector<CharacteristicSpec>;
  using Names = std::vector<NDString>;

  explicit HomeBuilder(const NDString& name);
  /// Furnishes `home` (never null), which the test has made and in which there is nothing yet.
  explicit HomeBuilder(std::shared_ptr<TestHome> home);

  HomeBuilder& primary();
  /// The object that is added next has that UUID.
  HomeBuilder& uuid(const NDUUID& uuid);
  /// Adds a room; the accessories that follow stand in it.
  HomeBuilder& room(const NDString& name);
  /// The accessories that follow stand in the first room of that name, which must be there.
  HomeBuilder& inRoom(const NDString& name);
  /// The accessories that follow stand in no room, which is the home's default room; so do those
  /// before the first `room`.
  HomeBuilder& inNoRoom();
  /// Adds an accessory; the services that follow belong to it.
  HomeBuilder& accessory(const NDString& name);
  /// Adds a service, whose name may be null, to the accessory named last, which must be there.
  HomeBuilder& service(const NDString& name, const NDString& type, const Characteristics& list);
  /// Changes the service named last.
  HomeBuilder& associated(const NDString& serviceType);
  HomeBuilder& serviceID(std::int64_t instanceID);
  /// Adds an accessory with one service of the same name.
  HomeBuilder& light(const NDString& name, const Characteristics& list = {power(false)});
  HomeBuilder& thermostat(const NDString& name, const Characteristics& list);
  /// The rooms, and the services, must be there; the first of the name is meant.
  HomeBuilder& zone(const NDString& name, const Names& rooms = {});
  HomeBuilder& group(const NDString& name, const Names& services = {});
  HomeBuilder& scene(const NDString& name);
  HomeBuilder& trigger(const NDString& name);

  /// Gives the home; the builder is not used any more.
  [[nodiscard]] std::shared_ptr<TestHome> build() { return home_; }

 private:
  NDUUID nextUUID();

  // First, because making the default room counts already.
  std::uint32_t objectCount_ = 0;
  std::optional<NDUUID> givenUUID_;
  std::int64_t characteristicCount_ = 0;
  std::shared_ptr<TestHome> home_;
  std::shared_ptr<NDRoom> room_;
  std::shared_ptr<TestAccessory> accessory_;
  std::shared_ptr<TestService> service_;
};

}  // namespace nidus
