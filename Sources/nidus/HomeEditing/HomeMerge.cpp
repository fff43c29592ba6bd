#include "nidus/HomeEditing/HomeMerge.h"

#include <map>
#include <sstream>
#include <string>
#include <utility>

#include "HomePlatform/Store/HomeDocument.h"
#include "HomePlatform/Store/ValueConversion.h"
#include "nidus/HomeEditing/HomeDifference.h"

namespace nidus {
namespace {

/// Calls `visit` for each characteristic with its home's UUID and its address.
template <class Homes, class Visit>
void forEachCharacteristic(Homes& homes, const Visit& visit) {
  for (auto& home : homes) {
    for (auto& accessory : home.accessories) {
      for (auto& service : accessory.services) {
        for (auto& characteristic : service.characteristics) {
          visit(
              home.uuid,
              CharacteristicAddress{accessory.uuid, service.instanceID, characteristic.instanceID},
              characteristic);
        }
      }
    }
  }
}

std::vector<HomeData> withoutValues(std::vector<HomeData> homes) {
  forEachCharacteristic(
      homes, [](const NDUUID&, const CharacteristicAddress&, CharacteristicData& characteristic) {
        characteristic.value = nullptr;
        characteristic.deviceValue = nullptr;
      });
  return homes;
}

std::string documentOf(const std::vector<HomeData>& homes) {
  std::ostringstream out;
  writeHomeDocument(out, homes, false);
  return out.str();
}

using Place = std::pair<NDUUID, CharacteristicAddress>;
using Characteristics = std::map<Place, const CharacteristicData*>;

Characteristics characteristicsOf(const std::vector<HomeData>& homes) {
  Characteristics all;
  forEachCharacteristic(homes, [&all](const NDUUID& home, const CharacteristicAddress& address,
                                      const CharacteristicData& characteristic) {
    all.emplace(Place(home, address), &characteristic);
  });
  return all;
}

/// The value that is to be: the current one where the person left the exported one alone, be it in
/// another format, and where the new format can hold it.
NDValueRef mergedValue(const NDValueRef& exported, const NDValueRef& edited,
                       const NDValueRef& current, const NDString& format) {
  if (isSameValue(exported, current)) return edited;
  if (!isSameValue(convertToFormat(exported, format), edited)) return edited;
  NDValueRef carried = convertToFormat(current, format);
  return carried || !current ? carried : edited;
}

}  // namespace

Result<std::vector<HomeData>> mergeEdit(const std::vector<HomeData>& exported,
                                        std::vector<HomeData> edited,
                                        const std::vector<HomeData>& current) {
  const auto before = withoutValues(exported);
  const auto now = withoutValues(current);
  if (documentOf(before) != documentOf(now)) {
    const std::string difference = differenceText(before, now);
    return Failure{Failure::Kind::badInput,
                   "the homes were changed meanwhile (" +
                       (difference.empty() ? "in another order" : difference) +
                       "); edit them again as they are now"};
  }
  const Characteristics old = characteristicsOf(exported);
  const Characteristics present = characteristicsOf(current);
  forEachCharacteristic(edited, [&](const NDUUID& home, const CharacteristicAddress& address,
                                    CharacteristicData& data) {
    const auto was = old.find({home, address});
    if (was == old.end()) return;
    const CharacteristicData& is = *present.at({home, address});
    const NDString format = data.metadata ? data.metadata->format : NDString();
    data.value = mergedValue(was->second->value, data.value, is.value, format);
    data.deviceValue =
        mergedValue(was->second->deviceValue, data.deviceValue, is.deviceValue, format);
  });
  return edited;
}

}  // namespace nidus
