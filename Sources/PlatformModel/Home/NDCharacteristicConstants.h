#pragma once

#include <string_view>

namespace nidus {

/// The property of a characteristic that can be written.
inline constexpr std::string_view NDCharacteristicPropertyWritable = "writable";
/// The property of a characteristic that can be read.
inline constexpr std::string_view NDCharacteristicPropertyReadable = "readable";
/// The property of a characteristic that reports its changes.
inline constexpr std::string_view NDCharacteristicPropertyNotifies = "notifies";

/// The formats of a characteristic's metadata.
inline constexpr std::string_view NDCharacteristicMetadataFormatBool = "bool";
inline constexpr std::string_view NDCharacteristicMetadataFormatInt = "int";
inline constexpr std::string_view NDCharacteristicMetadataFormatUInt8 = "uint8";
inline constexpr std::string_view NDCharacteristicMetadataFormatUInt16 = "uint16";
inline constexpr std::string_view NDCharacteristicMetadataFormatUInt32 = "uint32";
inline constexpr std::string_view NDCharacteristicMetadataFormatUInt64 = "uint64";
inline constexpr std::string_view NDCharacteristicMetadataFormatFloat = "float";
inline constexpr std::string_view NDCharacteristicMetadataFormatString = "string";
inline constexpr std::string_view NDCharacteristicMetadataFormatArray = "array";
inline constexpr std::string_view NDCharacteristicMetadataFormatDictionary = "dictionary";
inline constexpr std::string_view NDCharacteristicMetadataFormatData = "data";
inline constexpr std::string_view NDCharacteristicMetadataFormatTLV8 = "tlv8";

/// The units of a characteristic's metadata.
inline constexpr std::string_view NDCharacteristicMetadataUnitsCelsius = "celsius";
inline constexpr std::string_view NDCharacteristicMetadataUnitsFahrenheit = "fahrenheit";
inline constexpr std::string_view NDCharacteristicMetadataUnitsPercentage = "percentage";
inline constexpr std::string_view NDCharacteristicMetadataUnitsArcDegree = "arcdegrees";

}  // namespace nidus
