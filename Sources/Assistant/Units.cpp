#include "Assistant/Units.h"

#include "Assistant/Values.h"
#include "Logging/WLOLog.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"
#include "PlatformModel/NDPlatform.h"
#include "PlatformModel/System/NDNull.h"
#include "PlatformModel/System/NDRunOnce.h"

namespace nidus {
namespace {

constinit NDRunOnce metricFlagOnce;
constinit bool metricFlag = false;

bool readMetricFlag() {
  const auto platform = NDPlatform::registered();
  return platform && platform->locale()->usesMetricSystem().value_or(false);
}

/// Whether a number without a word to the contrary is in Fahrenheit.
bool speaksFahrenheit(const NDString& units) {
  return !isMetricLocale() && !(units == VAHAValueUnitsCELSIUSValue);
}

}  // namespace

bool isMetricLocale() {
  metricFlagOnce.run([] { metricFlag = readMetricFlag(); });
  return metricFlag;
}

NDString getLocaleUnits(const NDString& units) {
  const bool isTemperature = units == NDCharacteristicMetadataUnitsCelsius ||
                             units == NDCharacteristicMetadataUnitsFahrenheit;
  if (!isTemperature) return units;
  return isMetricLocale() ? NDCharacteristicMetadataUnitsCelsius
                          : NDCharacteristicMetadataUnitsFahrenheit;
}

NDString getReportingUnits(const NDString& requested, const NDString& type) {
  return getReportingUnits(requested, type, NDNAPMetadata::getSharedInstance().get());
}

NDString getReportingUnits(const NDString& requested, const NDString& type,
                           const NDNAPMetadata* mapper) {
  NDString native = property(mapper, &NDNAPMetadata::characteristicValueUnit, type);
  if (!property(mapper, &NDNAPMetadata::supportsLocalization, type)) return native;
  return requested ? requested : getLocaleUnits(native);
}

NDValueRef adjustSetValue(const NDValueRef& value, const NDString& /*valueType*/,
                          const NDString& units, const NDString& name) {
  const auto mapper = NDNAPMetadata::getSharedInstance();
  const NDString type =
      property(mapper, &NDNAPMetadata::mapWriteCharcteristicFromAssistantName, name);
  if (!property(mapper, &NDNAPMetadata::supportsLocalization, type)) {
    return property(mapper, &NDNAPMetadata::mapFromAssistantCharacteristicValue_name, value, name);
  }
  if (!(name == VAHAAttributeTEMPERATUREValue) || !speaksFahrenheit(units)) return value;
  NDValueRef adjusted =
      NDValue::floating(fahrenheitToCelsius(property(value, &NDValue::floatValue)));
  if (WLOShouldLogAtLevel(6)) {
    WLOLog(6, "adjustSet: Attribute %@ value %@  locale-adjusted to %@", {name, value, adjusted});
  }
  return adjusted;
}

NDValueRef adjustGetValue(const NDValueRef& value, const NDString& /*valueType*/,
                          const NDString& units, const NDString& name) {
  const auto mapper = NDNAPMetadata::getSharedInstance();
  const NDString type =
      property(mapper, &NDNAPMetadata::mapWriteCharcteristicFromAssistantName, name);
  if (!property(mapper, &NDNAPMetadata::supportsLocalization, type)) {
    return property(mapper, &NDNAPMetadata::mapToAssistantCharacteristicValue_name, value, name);
  }
  if (!speaksFahrenheit(units)) return value;
  NDValueRef adjusted =
      NDValue::floating(celsiusToFahrenheit(property(value, &NDValue::floatValue)));
  if (WLOShouldLogAtLevel(6)) {
    WLOLog(6, "adjustGet: Characteristic %@ value %@  locale-adjusted to %@",
           {type, value, adjusted});
  }
  return adjusted;
}

}  // namespace nidus
