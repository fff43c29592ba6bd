#include "nidus/HomeWords.h"

#include "nidus/Answers/ValueText.h"
#include "nidus/AttributeText.h"

namespace nidus {
namespace {

/// A value as replies have it.
NDDictionary dictionaryOf(const NDValue& value, const NDString& unit) {
  NDDictionary dictionary;
  if (value.isBoolean()) dictionary.set("boolean", NDDictionaryValue(value.boolValue()));
  if (value.isInteger()) dictionary.set("integer", NDDictionaryValue(value.integerValue()));
  if (value.isFloating()) dictionary.set("float", NDDictionaryValue(value.floatValue()));
  if (value.isText()) dictionary.set("string", NDDictionaryValue(value.stringValue()));
  dictionary.setIfPresent("units", unit);
  return dictionary;
}

}  // namespace

HomeWords::HomeWords(HomePlatform& platform)
    : vocabulary_(platform.vocabulary()), metadata_(platform.metadata()) {}

std::string HomeWords::serviceTypeOf(const NDString& type) const {
  const NDString name = metadata_->mapToAssistantServiceName(type);
  return name ? name.str() : type.str();
}

std::string HomeWords::attributeOf(const NDString& type) const {
  return attributeText(type, *metadata_);
}

std::string HomeWords::valueOf(const CharacteristicData& characteristic,
                               const NDValueRef& value) const {
  if (!value) return "unknown";
  const NDString& type = characteristic.characteristicType;
  const bool hasUnit = characteristic.metadata && characteristic.metadata->units;
  const NDString unit =
      hasUnit ? characteristic.metadata->units : metadata_->characteristicValueUnit(type);
  const NDValueRef shown = metadata_->mapToAssistantCharacteristicValue_name(value, type);
  const NDString name = metadata_->mapToAssistantCharacteristicName(type);
  return valueText(dictionaryOf(*shown, unit), name.view(), vocabulary_);
}

std::string HomeWords::limitsOf(const CharacteristicData& characteristic) const {
  if (!characteristic.metadata) return {};
  const NDValueRef& minimum = characteristic.metadata->minimumValue;
  const NDValueRef& maximum = characteristic.metadata->maximumValue;
  if (minimum && maximum) {
    return valueOf(characteristic, minimum) + " to " + valueOf(characteristic, maximum);
  }
  if (minimum) return "from " + valueOf(characteristic, minimum);
  return maximum ? "up to " + valueOf(characteristic, maximum) : "";
}

}  // namespace nidus
