#pragma once

#include <string>

#include "PlatformModel/Home/NDNAPMetadata.h"

namespace nidus {

/// What people call a characteristic of the platform's `type`: the attribute that commands use,
/// with " target" where it is only written; the type itself when the vocabulary has none.
[[nodiscard]] std::string attributeText(const NDString& type, const NDNAPMetadata& metadata);

}  // namespace nidus
