#pragma once

#include <optional>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// A platform type of the built-in vocabulary: "light", "power".
[[nodiscard]] NDString serviceTypeOf(const char* name);
[[nodiscard]] NDString characteristicTypeOf(const char* name);

/// Makes small homes as plain data for tests: says what matters and fills in the rest. What belongs
/// to an object follows it.
///
///     const HomeData home = HomeDataBuilder("Cottage").room("Kitchen").light("Lamp").build();
class HomeDataBuilder {
 public:
  explicit HomeDataBuilder(const char* name);

  HomeDataBuilder& primary();
  /// The accessories that follow stand in it.
  HomeDataBuilder& room(const char* name);
  HomeDataBuilder& inNoRoom();
  HomeDataBuilder& accessory(const char* name);
  HomeDataBuilder& unreachable();
  /// `name` may be null.
  HomeDataBuilder& service(const char* name, const NDString& type);
  HomeDataBuilder& characteristic(const NDString& type, NDValueRef value,
                                  const std::optional<MetadataData>& metadata = std::nullopt);
  /// An accessory with a service of its name that can be on or off, and is off.
  HomeDataBuilder& light(const char* name);
  /// Of the rooms, or the accessories (each with its first service), at these indices.
  HomeDataBuilder& zone(const char* name, const std::vector<std::size_t>& rooms);
  HomeDataBuilder& group(const char* name, const std::vector<std::size_t>& accessories);
  HomeDataBuilder& scene(const char* name, const std::vector<std::size_t>& accessories);

  [[nodiscard]] HomeData build() { return home_; }

 private:
  HomeData home_;
  std::optional<NDUUID> room_;
};

}  // namespace nidus
