#pragma once

#include <random>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Makes homes that a home document may hold: every kind of part, absent and present optional keys,
/// values of each kind and format at the ends of their ranges, references between the parts. The
/// same seed gives the same homes.
class RandomHome {
 public:
  explicit RandomHome(unsigned seed) : random_(seed) {}

  [[nodiscard]] std::vector<HomeData> homes();
  [[nodiscard]] HomeData home();

 private:
  /// A number from 0 to `greatest`.
  [[nodiscard]] std::size_t upTo(std::size_t greatest);
  [[nodiscard]] bool chance(int percent);
  [[nodiscard]] NDUUID uuid();
  [[nodiscard]] NDString name();
  [[nodiscard]] NDString maybeText();
  [[nodiscard]] std::int32_t code();
  [[nodiscard]] FaultData faults();
  [[nodiscard]] NDValueRef anyValue();
  [[nodiscard]] NDValueRef valueOf(const NDString& format);
  [[nodiscard]] std::vector<NDString> properties();
  [[nodiscard]] MetadataData metadata();
  [[nodiscard]] CharacteristicData characteristic(std::int64_t instanceID);
  [[nodiscard]] AccessoryData accessory(const std::vector<RoomData>& rooms);
  void addGroups(HomeData& home);
  void addActionSets(HomeData& home);

  std::mt19937 random_;
};

/// The document of `homes`, as a text that can be compared.
[[nodiscard]] std::string documentOf(const std::vector<HomeData>& homes);

}  // namespace nidus
