#pragma once

#include <string>
#include <vector>

#include "nidus/Completion/CommandOutline.h"

namespace nidus {

/// Where an unfinished command stands: what its last word can become.
struct CompletionPoint {
  std::string word;                    ///< The last word, which `texts` complete.
  std::vector<std::string> texts;      ///< Commands, options and words of the command's own.
  std::vector<CandidateKind> kinds;    ///< What else the word, from `valueStart` on, can become.
  std::size_t valueStart = 0;          ///< Past the "--room=" of "--room=Kitchen".
  std::vector<std::string> arguments;  ///< The arguments of the command before the word.
  std::string home;                    ///< The home that an option names; empty for none.
};

/// Finds where `words` stand, given without the program's name; the last one, which may be empty,
/// is unfinished. Values of options are put into their targets, so that --data is known.
[[nodiscard]] CompletionPoint completionPointOf(const CommandOutline& program,
                                                const std::vector<std::string>& words);

}  // namespace nidus
