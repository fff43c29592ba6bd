#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// A service in a person's words.
struct ServiceWords {
  std::string name;
  std::string type;            ///< A service type, in either case: "light".
  std::string associatedType;  ///< What it is used as, "light" for a lamp's outlet; or empty.
  std::vector<std::string> attributes;  ///< In either case: "brightness".
};

/// Gives the entry of the vocabulary for an attribute, in either case; never null. The failure is
/// bad input and names a near miss.
[[nodiscard]] Result<const CharacteristicEntry*> attributeNamed(const std::string& word,
                                                                const Vocabulary& vocabulary);

/// Makes a service that `accessory` can take: with instance IDs that are free there, and for each
/// attribute the characteristics that are read and written for it, with the format, unit and limits
/// that suit the vocabulary's entry and a value to start from. A failure is bad input.
[[nodiscard]] Result<ServiceData> makeService(const ServiceWords& words,
                                              const AccessoryData& accessory,
                                              const Vocabulary& vocabulary);

}  // namespace nidus
