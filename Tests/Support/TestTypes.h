#pragma once

#include <string_view>

namespace nidus {

/// The platform types that tests use; the assistant has no name for an unknown service and an
/// unmapped characteristic.
inline constexpr std::string_view kLightService = "com.corvane.nidus.service.light";
inline constexpr std::string_view kOutletService = "com.corvane.nidus.service.outlet";
inline constexpr std::string_view kThermostatService = "com.corvane.nidus.service.thermostat";
inline constexpr std::string_view kLockService = "com.corvane.nidus.service.lock";
inline constexpr std::string_view kUnknownService = "com.corvane.nidus.service.unknown";

inline constexpr std::string_view kPower = "com.corvane.nidus.characteristic.power";
inline constexpr std::string_view kBrightness = "com.corvane.nidus.characteristic.brightness";
inline constexpr std::string_view kCurrentTemperature =
    "com.corvane.nidus.characteristic.current-temperature";
inline constexpr std::string_view kTargetTemperature =
    "com.corvane.nidus.characteristic.target-temperature";
inline constexpr std::string_view kCurrentClimateMode =
    "com.corvane.nidus.characteristic.current-climate-mode";
inline constexpr std::string_view kTargetClimateMode =
    "com.corvane.nidus.characteristic.target-climate-mode";
inline constexpr std::string_view kCurrentLockState =
    "com.corvane.nidus.characteristic.current-lock-state";
inline constexpr std::string_view kTargetLockState =
    "com.corvane.nidus.characteristic.target-lock-state";
inline constexpr std::string_view kBatteryLevel = "com.corvane.nidus.characteristic.battery-level";
inline constexpr std::string_view kIdentify = "com.corvane.nidus.characteristic.identify";
inline constexpr std::string_view kUnmapped = "com.corvane.nidus.characteristic.unmapped";

}  // namespace nidus
