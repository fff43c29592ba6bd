#pragma once

#include <cstddef>

namespace nidus {

/// How large a document and its pieces may be. What is larger is refused while it is read, so that
/// no input costs more memory or time than it is worth. Bytes are those of the text as it is
/// written, escapes included.
struct JsonLimits {
  std::size_t documentBytes = 1'000'000'000;
  std::size_t depth = 64;                  ///< Objects and arrays within each other.
  std::size_t textBytes = 1'000'000;       ///< Of one text.
  std::size_t keyBytes = 1'000;            ///< Of one key, escapes read.
  std::size_t numberBytes = 1'000;         ///< Of one number.
  std::size_t spaceBytes = 1'000'000;      ///< Of white space at a stretch.
  std::size_t arrayElements = 250'000;     ///< Of one array.
  std::size_t objectKeys = 10'000;         ///< Of one object.
  std::size_t valuesInMemory = 1'000'000;  ///< Objects and arrays included; see each document.
};

/// Home documents are read part by part: `valuesInMemory` is what one part may hold beside the
/// parts that it lists.
inline constexpr JsonLimits kHomeDocumentLimits{.valuesInMemory = 300'000};
/// One command, be it a line or a file. `valuesInMemory` is all of its values, as in the following.
inline constexpr JsonLimits kCommandLimits{
    .documentBytes = 4'000'000, .arrayElements = 100'000, .valuesInMemory = 200'000};
/// `valuesInMemory` counts the values of all steps and preferences; the homes do not count.
inline constexpr JsonLimits kScenarioLimits{.valuesInMemory = 400'000};
inline constexpr JsonLimits kVocabularyLimits{.documentBytes = 16'000'000,
                                              .valuesInMemory = 200'000};
inline constexpr JsonLimits kPreferencesLimits{.documentBytes = 1'000'000,
                                               .valuesInMemory = 100'000};

}  // namespace nidus
