#pragma once

#include <string>
#include <string_view>

#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// Appends JSON to a text. A float is the shortest decimal that reads back as the same 32-bit float
/// and always has a fraction or an exponent. Text must be valid UTF-8 and is written unescaped
/// where JSON allows it.
void appendJsonText(std::string& out, std::string_view text);
void appendJsonFloat(std::string& out, float value);
/// Null is `null`.
void appendJsonValue(std::string& out, const NDValueRef& value);
void appendJson(std::string& out, const NDDictionaryValue& value);
void appendJson(std::string& out, const NDDictionary& dictionary);

}  // namespace nidus
