#include "nidus/HomeEditing/HomeMerge.h"

#include <cstddef>
#include <map>
#include <string>
#include <utility>

#include "HomePlatform/Store/ValueConversion.h"
#include "nidus/HomeEditing/HomeDifference.h"

namespace nidus {
namespace {

/// A characteristic's address within all homes.
using CharacteristicPlace = std::pair<NDUUID, CharacteristicAddress>;

/// Calls `visit` for each characteristic, in order.
template <class Visit>
void forEachCharacteristic(std::vector<HomeData>& homes, const Visit& visit) {
  for (HomeData& home : homes) {
    for (AccessoryData& accessory : home.accessories) {
      for (ServiceData& service : accessory.services) {
        for (CharacteristicData& data : service.characteristics) {
          visit(
              CharacteristicPlace(home.uuid, {accessory.uuid, service.instanceID, data.instanceID}),
              data);
        }
      }
    }
  }
}

struct Values {
  NDValueRef value;
  NDValueRef deviceValue;
};

/// Takes the values out of the homes, in the order of their characteristics.
std::vector<Values> takeValues(std::vector<HomeData>& homes) {
  std::vector<Values> values;
  forEachCharacteristic(homes, [&values](const CharacteristicPlace&, CharacteristicData& data) {
    values.push_back(
        {std::exchange(data.value, nullptr), std::exchange(data.deviceValue, nullptr)});
  });
  return values;
}

/// What became of the values of a characteristic while a person edited the homes.
struct ValuesChange {
  Values before;
  Values now;
};
using ValuesChanges = std::map<CharacteristicPlace, ValuesChange>;

/// The values of `homes` that differ; both lists are in the order of the characteristics.
ValuesChanges changesBetween(const std::vector<Values>& before, const std::vector<Values>& now,
                             std::vector<HomeData>& homes) {
  ValuesChanges changes;
  std::size_t i = 0;
  forEachCharacteristic(homes, [&](const CharacteristicPlace& place, const CharacteristicData&) {
    const bool isSame = isSameValue(before[i].value, now[i].value) &&
                        isSameValue(before[i].deviceValue, now[i].deviceValue);
    if (!isSame) changes.emplace(place, ValuesChange{before[i], now[i]});
    ++i;
  });
  return changes;
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

Result<std::vector<HomeData>> mergeEdit(std::vector<HomeData> exported,
                                        std::vector<HomeData> edited,
                                        std::vector<HomeData> current) {
  const auto before = takeValues(exported);
  const auto now = takeValues(current);
  if (!isSame(exported, current)) {
    const std::string difference = differenceText(exported, current);
    return Failure{Failure::Kind::badInput,
                   "the homes were changed meanwhile (" +
                       (difference.empty() ? "in another order" : difference) +
                       "); edit them again as they are now"};
  }
  const ValuesChanges changes = changesBetween(before, now, current);
  forEachCharacteristic(
      edited, [&changes](const CharacteristicPlace& place, CharacteristicData& data) {
        const auto found = changes.find(place);
        if (found == changes.end()) return;
        const auto& [was, is] = found->second;
        const NDString format = data.metadata ? data.metadata->format : NDString();
        data.value = mergedValue(was.value, data.value, is.value, format);
        data.deviceValue = mergedValue(was.deviceValue, data.deviceValue, is.deviceValue, format);
      });
  return edited;
}

}  // namespace nidus
