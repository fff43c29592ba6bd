#pragma once

#include <optional>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// A call that was made on a home, for those who watch: a replay, a test.
struct PlatformCall {
  enum class Kind { read, write, execute };
  Kind kind = Kind::read;
  NDUUID home;
  std::vector<CharacteristicAddress> characteristics;  ///< Read or written, in the order asked.
  std::vector<NDValueRef> values;  ///< Written, beside `characteristics`; may be null.
  std::optional<NDUUID> actionSet;
};

}  // namespace nidus
