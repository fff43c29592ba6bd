#include "nidus/Orders/OrderValue.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <limits>
#include <optional>
#include <system_error>

#include "HomePlatform/Store/ValueConversion.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "nidus/Orders/Quantity.h"
#include "nidus/Orders/ValueWords.h"
#include "nidus/Orders/WordChoice.h"

namespace nidus {
namespace {

constexpr std::array<std::string_view, 6> kNumberFormats = {
    NDCharacteristicMetadataFormatInt,    NDCharacteristicMetadataFormatUInt8,
    NDCharacteristicMetadataFormatUInt16, NDCharacteristicMetadataFormatUInt32,
    NDCharacteristicMetadataFormatUInt64, NDCharacteristicMetadataFormatFloat};

template <class Number>
std::optional<Number> numberFrom(const std::string& text) {
  Number number{};
  const char* const end = text.data() + text.size();
  const auto read = std::from_chars(text.data(), end, number);
  if (read.ec != std::errc() || read.ptr != end) return std::nullopt;
  return number;
}

/// A boxed number; null beyond what can be boxed.
NDValueRef boxed(double number) {
  if (std::abs(number) > std::numeric_limits<float>::max()) return nullptr;
  return NDValue::floating(static_cast<float>(number));
}

/// The number of a text in the value type of `entry`; null for one that it does not take.
NDValueRef numberFor(const CharacteristicEntry& entry, const std::string& text) {
  if (entry.valueType == NDCharacteristicMetadataFormatFloat) {
    const auto number = numberFrom<double>(text);
    return number ? boxed(*number) : nullptr;
  }
  const auto number = numberFrom<std::int64_t>(text);
  return number ? convertToFormat(NDValue::integer(*number), entry.valueType) : nullptr;
}

VAHAValueRef booleanValue(const std::string& text, const CharacteristicEntry& entry) {
  const auto boolean = booleanOf(text, entry.assistantName.view());
  if (!boolean) return nullptr;
  auto value = VAHABooleanValue::booleanValue();
  value->setValue(*boolean);
  return value;
}

VAHAValueRef numberValue(const NDValueRef& number, const NDString& units) {
  if (!number) return nullptr;
  if (number->isInteger()) {
    auto value = VAHAIntegerValue::integerValue();
    value->setValue(number->integerValue());
    value->setUnits(units);
    return value;
  }
  auto value = VAHAFloatValue::floatValue();
  value->setValue(number->floatValue());
  value->setUnits(units);
  return value;
}

Result<VAHAValueRef> textValue(const std::string& text, const CharacteristicEntry& entry) {
  auto value = VAHAStringValue::stringValue();
  value->setValue(text);
  if (const auto known = textsOf(entry); !known.empty()) {
    const auto chosen =
        chooseWord(text, known, entry.assistantName.str() + " takes " + expectationOf(entry));
    if (!chosen) return chosen.failure();
    value->setValue(*chosen);
  }
  return VAHAValueRef(std::move(value));
}

}  // namespace

bool isNumeric(const CharacteristicEntry& entry) {
  return std::find(kNumberFormats.begin(), kNumberFormats.end(), entry.valueType.view()) !=
         kNumberFormats.end();
}

Result<VAHAValueRef> OrderValueReader::read(const std::string& text,
                                            const CharacteristicEntry& entry, ValueUse use) const {
  if (entry.valueType == NDCharacteristicMetadataFormatString) return textValue(text, entry);
  const bool isBoolean = entry.valueType == NDCharacteristicMetadataFormatBool;
  if (!isBoolean && !isNumeric(entry)) {
    return Failure{Failure::Kind::badInput, text + ": values of " + entry.assistantName.str() +
                                                " can not be written in words; use nidus perform"};
  }
  auto value = isBoolean ? booleanValue(text, entry) : readNumber(text, entry, use);
  if (value) return value;
  return Failure{Failure::Kind::badInput, shownWord(text) + ": " + entry.assistantName.str() +
                                              " takes " + expectationOf(entry)};
}

VAHAValueRef OrderValueReader::ofLimit(const NDValueRef& number,
                                       const CharacteristicEntry& entry) const {
  return numberValue(number, isTemperature(entry) ? assistantUnit(entry.unit) : nullptr);
}

VAHAValueRef OrderValueReader::readNumber(const std::string& text, const CharacteristicEntry& entry,
                                          ValueUse use) const {
  const auto quantity = readQuantity(text, vocabulary_);
  if (!quantity) return nullptr;
  if (isTemperature(entry) && (!quantity->unit || isTemperatureUnit(quantity->unit))) {
    const auto number = numberFrom<double>(quantity->number);
    return number ? temperature(*number, quantity->unit, entry, use) : nullptr;
  }
  if (quantity->unit && quantity->unit != entry.unit) return nullptr;
  return numberValue(numberFor(entry, quantity->number), nullptr);
}

VAHAValueRef OrderValueReader::temperature(double number, const NDString& unit,
                                           const CharacteristicEntry& entry, ValueUse use) const {
  const Degrees sent = degreesToSend({number, unit}, use, entry, isMetric_);
  const NDValueRef degrees = convertToFormat(boxed(sent.number), entry.valueType);
  return numberValue(degrees, assistantUnit(sent.unit));
}

NDString OrderValueReader::assistantUnit(const NDString& unit) const {
  for (const UnitEntry& known : vocabulary_.units) {
    if (unit && known.unit == unit) return known.assistantName;
  }
  return nullptr;
}

}  // namespace nidus
