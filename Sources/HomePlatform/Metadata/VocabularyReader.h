#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Result.h"

namespace nidus {

/// The vocabulary that the program carries inside itself.
[[nodiscard]] Vocabulary builtInVocabulary();

/// Reads a vocabulary file (`nidus-vocabulary/1`) into `base`: an entry with an assistant name that
/// is there already replaces it in its place, others follow at the end. Fails, with the place in
/// the file, when its form is wrong or an entry contradicts another. `name` stands for the file in
/// messages.
[[nodiscard]] Result<Vocabulary> mergeVocabulary(Vocabulary base, std::string_view text,
                                                 const std::string& name);

/// The built-in vocabulary, extended by the file at `path` if there is one.
[[nodiscard]] Result<Vocabulary> loadVocabulary(const std::optional<std::filesystem::path>& path);

}  // namespace nidus
