#pragma once

#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// Converts `value` to a metadata format: "bool" takes any number (non-zero is true), the integer
/// formats any number that lies in their range after rounding half away from zero, "float" any
/// number, "string" a text; no format, or another one, takes anything but null as it is. What no
/// document could hold stays itself nowhere: infinities, not-a-number, texts that are not UTF-8.
/// Gives null when the value is null or does not fit; the same object when nothing changes.
[[nodiscard]] NDValueRef convertToFormat(const NDValueRef& value, const NDString& format);

/// Whether a reader of a document could not tell two values, which may be null, apart: they are of
/// one kind and equal, floats bit by bit.
[[nodiscard]] bool isSameValue(const NDValueRef& a, const NDValueRef& b);

}  // namespace nidus
