#pragma once

#include "PlatformModel/Assistant/VAHAAction.h"
#include "PlatformModel/Assistant/VAHAValue.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

// Conversions between the assistant's typed value objects and the platform's boxed values. All of
// them may be called from any thread, keep no state and never fail; any object argument may be
// null.

/// Boxes the value of `action` as its class says: boolean, float, integer or text. Null when there
/// is no action, no value, or a string value without a string. `type`, the format name of the
/// action's attribute, is accepted and not looked at.
[[nodiscard]] NDValueRef getValueOfType(const NDString& type, const VAHAActionRef& action);

/// Makes the assistant's value object that `format` (a format name of characteristic metadata) asks
/// for, with `units` (may be null) attached as they are. A null `value` reads as false, 0, 0.0 or
/// no string; a number in the format "string" becomes its text. Null for a format that has no value
/// object, or none. No unit is converted here.
[[nodiscard]] VAHAValueRef setValue(const NDValueRef& value, const NDString& format,
                                    const NDString& units);

/// Says whether `a` is of the class of `b` and holds the same value, whatever the units. Floats are
/// compared without tolerance. False when either is null.
[[nodiscard]] bool isAttributeValueEqual(const VAHAValueRef& a, const VAHAValueRef& b);

/// Converts between the platform's unit names "celsius" and "fahrenheit"; a null `value` then reads
/// as 0. For any other pair of units the result is `value`, the same object.
[[nodiscard]] NDValueRef convertValue(const NDValueRef& value, const NDString& fromUnits,
                                      const NDString& toUnits);

/// Convert degrees of one scale to the other, rounded once from 64 to 32 bits.
[[nodiscard]] float fahrenheitToCelsius(float fahrenheit);
[[nodiscard]] float celsiusToFahrenheit(float celsius);

}  // namespace nidus
