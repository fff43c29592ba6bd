#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "nidus/Completion/CompletionPoint.h"
#include "nidus/Completion/HomeNames.h"

namespace nidus {

/// What an unfinished word can become.
struct Completion {
  std::vector<std::string> words;  ///< Whole words, each once, in order.
  bool isFile = false;             ///< The name of a file as well.
};

/// Whether completing at `point` looks at the names and the vocabulary of the user.
[[nodiscard]] bool needsHome(const CompletionPoint& point);

/// Completes the word at `point`. What begins with it is taken; where nothing does, what begins
/// with it when case and accents are ignored.
[[nodiscard]] Completion completionAt(const CompletionPoint& point,
                                      const std::vector<HomeName>& names,
                                      const Vocabulary& vocabulary);

}  // namespace nidus
