#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "nidus/HomeEditing/HomeObjects.h"

namespace nidus {

/// What a scene sets, in a person's words.
struct SettingWords {
  std::string service;    ///< As in `ObjectWords`.
  std::string attribute;  ///< In either case.
  std::string value;      ///< As in an order: "on", "40%", "70F".
};

/// Takes "Floor lamp/Lamp brightness 40%" apart: the last word is the value, the one before it the
/// attribute, and all before that the service. A failure is bad input: one of the three is missing;
/// the vocabulary tells a value that was forgotten.
[[nodiscard]] Result<SettingWords> readSetting(const std::string& text,
                                               const Vocabulary& vocabulary);

/// Makes the action of a scene that sets an attribute of the service at `place`. The value is that
/// of the characteristic, in its own unit and within its limits; a temperature without a unit is in
/// Celsius where the device `isMetric`, else in Fahrenheit. A failure is bad input.
[[nodiscard]] Result<SceneActionData> sceneAction(const std::vector<HomeData>& homes,
                                                  const ObjectPlace& place,
                                                  const SettingWords& words,
                                                  const Vocabulary& vocabulary, bool isMetric);

}  // namespace nidus
