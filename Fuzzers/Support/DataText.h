#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Data field by field, as a text that differs whenever anything in it does: null and empty, kinds
/// of values and the bits of floats included. It owes nothing to the writers of documents, which it
/// is there to judge.
[[nodiscard]] std::string dataText(const std::vector<HomeData>& homes);
[[nodiscard]] std::string dataText(const Vocabulary& vocabulary);

}  // namespace nidus
