#pragma once

#include <iosfwd>

#include "HomePlatform/Metadata/Vocabulary.h"

namespace nidus {

/// Writes a vocabulary as a document (`nidus-vocabulary/1`), one entry a line, that can be read
/// again; keys that have their default are left out. Errors show in the state of `out`.
void writeVocabulary(std::ostream& out, const Vocabulary& vocabulary);

}  // namespace nidus
