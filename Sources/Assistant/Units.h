#pragma once

#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

// Temperatures in the user's units. All functions may be called from any thread; every object
// argument may be null.

/// Says whether the device's locale uses the metric system; false when the locale does not say. The
/// locale is asked once per process, by whoever calls first; a later change is not seen.
[[nodiscard]] bool isMetricLocale();

/// The user's unit, "celsius" or "fahrenheit", when `units` is one of the two; otherwise `units`.
[[nodiscard]] NDString getLocaleUnits(const NDString& units);

/// The platform unit in which values of the characteristic type `type` are told to the assistant,
/// which asked for the platform unit `requested`. For a type that follows the user's unit system
/// the request wins over the locale; for any other the type's own unit is given. May be null.
[[nodiscard]] NDString getReportingUnits(const NDString& requested, const NDString& type);
/// The same with a mapper, which may be null, that has been asked for.
[[nodiscard]] NDString getReportingUnits(const NDString& requested, const NDString& type,
                                         const NDNAPMetadata* mapper);

/// Turns `value` of the assistant attribute `name` into what is to be written. Where the type that
/// is written for `name` does not follow the user's unit system, the mapper's value mapping is all.
/// Otherwise a temperature on a device that is not metric is taken as Fahrenheit unless `units` is
/// the assistant's Celsius, and becomes Celsius. `valueType` is accepted and not looked at.
[[nodiscard]] NDValueRef adjustSetValue(const NDValueRef& value, const NDString& valueType,
                                        const NDString& units, const NDString& name);

/// The other direction: turns the platform's `value` into what the assistant is told. Unlike above,
/// values of any type that follows the user's unit system become Fahrenheit, not only temperatures.
[[nodiscard]] NDValueRef adjustGetValue(const NDValueRef& value, const NDString& valueType,
                                        const NDString& units, const NDString& name);

}  // namespace nidus
