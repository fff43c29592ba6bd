#pragma once

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// The entity types as texts that all records and entities share. They are made on first use and
/// never destroyed, because a platform's thread may still gather while the process ends.
struct EntityTypes {
  NDString home = VAHAEntityTypeHOMEValue;
  NDString service = VAHAEntityTypeSERVICEValue;
  NDString group = VAHAEntityTypeGROUPValue;
  NDString room = VAHAEntityTypeROOMValue;
  NDString zone = VAHAEntityTypeZONEValue;
  NDString scene = VAHAEntityTypeSCENEValue;
  NDString trigger = VAHAEntityTypeTRIGGERValue;
};

[[nodiscard]] inline const EntityTypes& entityTypes() {
  static const EntityTypes& types = *new EntityTypes;
  return types;
}

}  // namespace nidus
