#include "nidus/HomeEditing/NewService.h"

#include <algorithm>
#include <array>
#include <compare>
#include <limits>
#include <set>
#include <string_view>

#include "HomePlatform/Store/ValueConversion.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "nidus/HomeEditing/HomeObjects.h"
#include "nidus/Orders/WordChoice.h"

namespace nidus {
namespace {

/// The range that values of a unit usually have.
struct UsualRange {
  std::string_view unit;
  bool isWritten;  ///< Whether it is that of what can be set.
  float minimum;
  float maximum;
  float step;  ///< 0 for none.
};

constexpr std::array<UsualRange, 9> kUsualRanges = {{
    {NDCharacteristicMetadataUnitsPercentage, false, 0, 100, 1},
    {NDCharacteristicMetadataUnitsPercentage, true, 0, 100, 1},
    {NDCharacteristicMetadataUnitsArcDegree, false, 0, 360, 1},
    {NDCharacteristicMetadataUnitsArcDegree, true, 0, 360, 1},
    {NDCharacteristicMetadataUnitsCelsius, false, -40, 100, 0.1F},
    {NDCharacteristicMetadataUnitsCelsius, true, 5, 35, 0.5F},
    {"mired", true, 140, 500, 1},
    {"lux", false, 0, 100'000, 0},
    {"ppm", false, 0, 10'000, 0},
}};

template <class Entry>
Result<const Entry*> entryNamed(const std::string& word, const std::vector<Entry>& entries,
                                const std::string& otherwise) {
  std::vector<std::string_view> names;
  names.reserve(entries.size());
  for (const Entry& entry : entries) names.push_back(entry.assistantName.view());
  const std::string_view* const found = findWord(word, names);
  if (!found) return unknownWord(word, names, otherwise);
  return &entries[static_cast<std::size_t>(found - names.data())];
}

Result<NDString> serviceType(const std::string& word, const Vocabulary& vocabulary) {
  const auto entry = entryNamed(word, vocabulary.services,
                                "there is no such type of service; see nidus vocabulary");
  if (!entry) return entry.failure();
  return (*entry)->serviceType;
}

/// The next number, or where there is none the least that is free.
std::int64_t takeFreeID(std::set<std::int64_t>& used) {
  std::int64_t free = 1;
  if (!used.empty() && *used.rbegin() < std::numeric_limits<std::int64_t>::max()) {
    free = *used.rbegin() + 1;
  } else {
    while (used.count(free) > 0) ++free;
  }
  used.insert(free);
  return free;
}

/// The values that the platform has for the words of an attribute; those alone that can be set,
/// when `isWritten`.
std::vector<NDValueRef> platformValues(const CharacteristicEntry& entry, bool isWritten) {
  std::vector<NDValueRef> values;
  for (auto pair = entry.values.begin(); pair != entry.values.end(); ++pair) {
    const bool isFirst = std::none_of(
        entry.values.begin(), pair,
        [&pair](const ValuePair& earlier) { return earlier.assistant->isEqual(*pair->assistant); });
    if (isFirst || !isWritten) values.push_back(pair->platform);
  }
  return values;
}

bool isBelow(const NDValueRef& a, const NDValueRef& b) { return std::is_lt(a->compare(b)); }

/// The metadata for values that stand for words: numbers of one byte where they fit.
MetadataData metadataOf(const std::vector<NDValueRef>& values) {
  MetadataData metadata;
  const bool areTexts = std::any_of(values.begin(), values.end(),
                                    [](const NDValueRef& value) { return value->isText(); });
  if (areTexts) {
    metadata.format = NDCharacteristicMetadataFormatString;
    return metadata;
  }
  const auto [least, greatest] = std::minmax_element(values.begin(), values.end(), isBelow);
  const bool isByte = convertToFormat(*least, NDCharacteristicMetadataFormatUInt8) &&
                      convertToFormat(*greatest, NDCharacteristicMetadataFormatUInt8);
  metadata.format =
      isByte ? NDCharacteristicMetadataFormatUInt8 : NDCharacteristicMetadataFormatInt;
  metadata.minimumValue = convertToFormat(*least, metadata.format);
  metadata.maximumValue = convertToFormat(*greatest, metadata.format);
  metadata.stepValue = NDValue::integer(1);
  return metadata;
}

MetadataData metadataOf(const CharacteristicEntry& entry, bool isWritten) {
  if (!entry.values.empty()) return metadataOf(platformValues(entry, isWritten));
  MetadataData metadata;
  metadata.format = entry.valueType;
  metadata.units = entry.unit;
  const auto* const range =
      std::find_if(kUsualRanges.begin(), kUsualRanges.end(), [&](const UsualRange& usual) {
        return entry.unit == usual.unit && usual.isWritten == isWritten;
      });
  if (range == kUsualRanges.end()) return metadata;
  const auto limit = [&metadata](float number) {
    return convertToFormat(NDValue::floating(number), metadata.format);
  };
  metadata.minimumValue = limit(range->minimum);
  metadata.maximumValue = limit(range->maximum);
  if (range->step > 0) metadata.stepValue = limit(range->step);
  return metadata;
}

/// A value to start from: zero or off, or what is next to it within the limits; none for a text.
NDValueRef firstValue(const MetadataData& metadata) {
  NDValueRef value = convertToFormat(NDValue::integer(0), metadata.format);
  if (value && metadata.minimumValue && isBelow(value, metadata.minimumValue)) {
    value = metadata.minimumValue;
  }
  return value;
}

/// How an attribute uses one of its characteristics.
struct Use {
  NDString type;
  bool isRead;
  bool isWritten;
};

std::vector<Use> usesOf(const CharacteristicEntry& entry) {
  if (entry.read == entry.write && entry.read) return {{entry.read, true, true}};
  std::vector<Use> uses;
  if (entry.read) uses.push_back({entry.read, true, false});
  // What is set can be asked for as the target, where there is also a reading.
  if (entry.write) uses.push_back({entry.write, static_cast<bool>(entry.read), true});
  return uses;
}

CharacteristicData characteristic(const CharacteristicEntry& entry, const Use& use,
                                  std::int64_t instanceID) {
  CharacteristicData data;
  data.instanceID = instanceID;
  data.characteristicType = use.type;
  if (use.isRead) data.properties.emplace_back(NDCharacteristicPropertyReadable);
  if (use.isWritten) data.properties.emplace_back(NDCharacteristicPropertyWritable);
  if (use.isRead) data.properties.emplace_back(NDCharacteristicPropertyNotifies);
  data.metadata = metadataOf(entry, use.isWritten);
  if (use.isRead) data.value = firstValue(*data.metadata);
  data.deviceValue = data.value;
  return data;
}

}  // namespace

Result<const CharacteristicEntry*> attributeNamed(const std::string& word,
                                                  const Vocabulary& vocabulary) {
  return entryNamed(word, vocabulary.characteristics,
                    "there is no such attribute; see nidus vocabulary");
}

Result<ServiceData> makeService(const ServiceWords& words, const AccessoryData& accessory,
                                const Vocabulary& vocabulary) {
  std::set<std::int64_t> services;
  std::set<std::int64_t> characteristics;
  for (const ServiceData& service : accessory.services) {
    services.insert(service.instanceID);
    for (const auto& data : service.characteristics) characteristics.insert(data.instanceID);
  }
  const auto type = serviceType(words.type, vocabulary);
  if (!type) return type.failure();
  ServiceData made{takeFreeID(services), words.name, *type, nullptr, {}};
  if (!words.associatedType.empty()) {
    const auto associated = serviceType(words.associatedType, vocabulary);
    if (!associated) return associated.failure();
    made.associatedServiceType = *associated;
  }
  std::set<const CharacteristicEntry*> known;
  for (const std::string& word : words.attributes) {
    const auto entry = attributeNamed(word, vocabulary);
    if (!entry) return entry.failure();
    if (!known.insert(*entry).second) continue;
    const auto uses = usesOf(**entry);
    if (uses.empty()) return badInput(word + ": no accessory has this attribute; leave it out");
    for (const Use& use : uses) {
      made.characteristics.push_back(characteristic(**entry, use, takeFreeID(characteristics)));
    }
  }
  return made;
}

}  // namespace nidus
