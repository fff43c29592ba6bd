#include "nidus/HomeEditing/SceneAction.h"

#include <algorithm>
#include <compare>

#include "HomePlatform/Store/ValueConversion.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "nidus/HomeEditing/NewService.h"
#include "nidus/Orders/OrderValue.h"
#include "nidus/Orders/Quantity.h"

namespace nidus {
namespace {

constexpr const char kSpace[] = " \t";

/// Takes the last word off `text`; empty when there is none.
std::string takeLastWord(std::string& text) {
  text.erase(text.find_last_not_of(kSpace) + 1);
  const std::size_t space = text.find_last_of(kSpace);
  const std::size_t start = space == std::string::npos ? 0 : space + 1;
  std::string word = text.substr(start);
  text.erase(start);
  return word;
}

const CharacteristicData* writableOf(const ServiceData& service, const NDString& type) {
  const auto found = std::find_if(
      service.characteristics.begin(), service.characteristics.end(),
      [&type](const CharacteristicData& data) { return data.characteristicType == type; });
  if (!type || found == service.characteristics.end()) return nullptr;
  const auto& words = found->properties;
  const bool isWritable =
      std::find(words.begin(), words.end(), NDCharacteristicPropertyWritable) != words.end();
  return isWritable ? &*found : nullptr;
}

NDValueRef boxed(const VAHAValue& value) {
  if (const auto* boolean = dynamic_cast<const VAHABooleanValue*>(&value)) {
    return NDValue::boolean(boolean->value());
  }
  if (const auto* integer = dynamic_cast<const VAHAIntegerValue*>(&value)) {
    return NDValue::integer(integer->value());
  }
  if (const auto* number = dynamic_cast<const VAHAFloatValue*>(&value)) {
    return NDValue::floating(number->value());
  }
  return NDValue::text(dynamic_cast<const VAHAStringValue&>(value).value());
}

/// The platform's value for the assistant's.
NDValueRef platformValue(const CharacteristicEntry& entry, NDValueRef value) {
  const auto pair =
      std::find_if(entry.values.begin(), entry.values.end(),
                   [&value](const ValuePair& known) { return known.assistant->isEqual(*value); });
  return pair == entry.values.end() ? value : pair->platform;
}

/// What a person wrote, with the unit that they had in mind.
std::string withUnit(const std::string& text, const CharacteristicEntry& entry,
                     const Vocabulary& vocabulary, bool isMetric) {
  const auto quantity = readQuantity(text, vocabulary);
  const bool isBare = quantity && !quantity->unit;
  if (!isBare || !entry.localized || !isTemperature(entry)) return text;
  return text + (isMetric ? 'C' : 'F');
}

/// The value of a characteristic that a person means by `text`.
Result<NDValueRef> valueOf(const std::string& text, CharacteristicEntry entry,
                           const MetadataData& metadata, const Vocabulary& vocabulary,
                           bool isMetric) {
  const std::string quantity = withUnit(text, entry, vocabulary, isMetric);
  if (isTemperature(entry) && isTemperatureUnit(metadata.units)) entry.unit = metadata.units;
  const auto value = OrderValueReader(vocabulary, isMetric).read(quantity, entry, ValueUse::value);
  if (!value) return value.failure();
  NDValueRef converted = convertToFormat(platformValue(entry, boxed(**value)), metadata.format);
  if (!converted) return badInput(text + ": this accessory does not take it; see nidus home show");
  const bool isOutside = std::is_lt(converted->compare(metadata.minimumValue)) ||
                         std::is_gt(converted->compare(metadata.maximumValue));
  if (!isOutside) return converted;
  return badInput(text + ": " + entry.assistantName.str() + " goes from " +
                  description(metadata.minimumValue) + " to " + description(metadata.maximumValue) +
                  " here");
}

}  // namespace

Result<SettingWords> readSetting(const std::string& text, const Vocabulary& vocabulary) {
  std::string rest = text;
  SettingWords words;
  words.value = takeLastWord(rest);
  words.attribute = takeLastWord(rest);
  const std::size_t start = rest.find_first_not_of(kSpace);
  const bool isValueForgotten =
      !attributeNamed(words.attribute, vocabulary) && attributeNamed(words.value, vocabulary);
  if (start != std::string::npos && !isValueForgotten) {
    words.service = rest.substr(start, rest.find_last_not_of(kSpace) + 1 - start);
    return words;
  }
  return badInput(text +
                  ": a setting is a service, an attribute and a value, such as \"Floor lamp "
                  "brightness 40%\"");
}

Result<SceneActionData> sceneAction(const std::vector<HomeData>& homes, const ObjectPlace& place,
                                    const SettingWords& words, const Vocabulary& vocabulary,
                                    bool isMetric) {
  const auto entry = attributeNamed(words.attribute, vocabulary);
  if (!entry) return entry.failure();
  const AccessoryData& accessory = homes[place.home].accessories[place.index];
  const ServiceData& service = accessory.services[place.service];
  const CharacteristicData* const target = writableOf(service, (*entry)->write);
  if (!target) {
    return badInput(describe(homes, ObjectKind::service, place) + " has no " +
                    (*entry)->assistantName.str() + " that can be set; see nidus home show");
  }
  const auto value = valueOf(words.value, **entry, target->metadata.value_or(MetadataData()),
                             vocabulary, isMetric);
  if (!value) return value.failure();
  return SceneActionData{{accessory.uuid, service.instanceID, target->instanceID}, *value};
}

}  // namespace nidus
