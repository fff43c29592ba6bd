#pragma once

#include <string_view>

namespace nidus {

/// The assistant's enumerated texts. All comparisons with them are exact.

// Entity types.
inline constexpr std::string_view VAHAEntityTypeHOMEValue = "HOME";
inline constexpr std::string_view VAHAEntityTypeSERVICEValue = "SERVICE";
inline constexpr std::string_view VAHAEntityTypeGROUPValue = "GROUP";
inline constexpr std::string_view VAHAEntityTypeROOMValue = "ROOM";
inline constexpr std::string_view VAHAEntityTypeZONEValue = "ZONE";
inline constexpr std::string_view VAHAEntityTypeSCENEValue = "SCENE";
inline constexpr std::string_view VAHAEntityTypeTRIGGERValue = "TRIGGER";

// Action types.
inline constexpr std::string_view VAHAActionTypeGETValue = "GET";
inline constexpr std::string_view VAHAActionTypeGET_TARGET_VALUEValue = "GET_TARGET_VALUE";
inline constexpr std::string_view VAHAActionTypeGET_MINIMUMValue = "GET_MINIMUM";
inline constexpr std::string_view VAHAActionTypeGET_MAXIMUMValue = "GET_MAXIMUM";
inline constexpr std::string_view VAHAActionTypeGET_STEP_VALUEValue = "GET_STEP_VALUE";
inline constexpr std::string_view VAHAActionTypeSETValue = "SET";
inline constexpr std::string_view VAHAActionTypeSET_TO_MINIMUMValue = "SET_TO_MINIMUM";
inline constexpr std::string_view VAHAActionTypeSET_TO_MAXIMUMValue = "SET_TO_MAXIMUM";
inline constexpr std::string_view VAHAActionTypeINCREASEValue = "INCREASE";
inline constexpr std::string_view VAHAActionTypeDECREASEValue = "DECREASE";
inline constexpr std::string_view VAHAActionTypeTOGGLEValue = "TOGGLE";

// Outcomes of a command.
inline constexpr std::string_view VAHACommandOutcomeCOMMAND_SUCCESSValue = "COMMAND_SUCCESS";
inline constexpr std::string_view VAHACommandOutcomeCOMMAND_FAILUREValue = "COMMAND_FAILURE";
inline constexpr std::string_view VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue =
    "FOUND_NO_MATCHING_ENTITIES";
inline constexpr std::string_view VAHACommandOutcomeREQUIRES_UNLOCKValue = "REQUIRES_UNLOCK";

// Outcomes of one object.
inline constexpr std::string_view VAHAActionOutcomeSUCCESSValue = "SUCCESS";
inline constexpr std::string_view VAHAActionOutcomeFAILUREValue = "FAILURE";
inline constexpr std::string_view VAHAActionOutcomeREAD_ONLYValue = "READ_ONLY";
inline constexpr std::string_view VAHAActionOutcomeUNREACHABLEValue = "UNREACHABLE";

// Attributes and units that the plug-in treats specially.
inline constexpr std::string_view VAHAAttributeTEMPERATUREValue = "TEMPERATURE";
inline constexpr std::string_view VAHAAttributeENABLEDValue = "ENABLED";
inline constexpr std::string_view VAHAValueUnitsCELSIUSValue = "CELSIUS";

// Class identifiers of the filters.
inline constexpr std::string_view VAHASearchCriteriaFilterClassIdentifier =
    "VAHASearchCriteriaFilter";
inline constexpr std::string_view VAHAIdentifierFilterClassIdentifier = "VAHAIdentifierFilter";

}  // namespace nidus
