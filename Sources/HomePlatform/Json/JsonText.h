#pragma once

#include <string>
#include <string_view>

#include "HomePlatform/Json/JsonValue.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// Each appends JSON to `out`, on one line.

/// `text` must be valid UTF-8 and is written unescaped where JSON allows it.
void appendJsonText(std::string& out, std::string_view text);
/// The shortest decimal that reads back as the same 32-bit float, always with a fraction or an
/// exponent. JSON has neither infinities nor not-a-number: they become `null`.
void appendJsonFloat(std::string& out, float value);
/// A null reference is `null`.
void appendJsonValue(std::string& out, const NDValueRef& value);
void appendJson(std::string& out, const NDDictionaryValue& value);
void appendJson(std::string& out, const NDDictionary& dictionary);
void appendJson(std::string& out, const JsonValue& value);

}  // namespace nidus
