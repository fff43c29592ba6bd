#include "nidus/Orders/WordChoice.h"

#include <algorithm>

#include "nidus/Orders/NearMiss.h"

namespace nidus {
namespace {

char vocabularyLetter(char c) {
  if (c == ' ' || c == '-') return '_';
  return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
}

}  // namespace

std::string vocabularyWord(std::string_view word) {
  std::string written(word);
  std::transform(written.begin(), written.end(), written.begin(), vocabularyLetter);
  return written;
}

std::string shownWord(const std::string& word) { return word.empty() ? "\"\"" : word; }

const std::string_view* findWord(std::string_view word,
                                 const std::vector<std::string_view>& known) {
  auto found = std::find(known.begin(), known.end(), word);
  if (found == known.end()) {
    const std::string written = vocabularyWord(word);
    found = std::find_if(known.begin(), known.end(), [&written](std::string_view candidate) {
      return vocabularyWord(candidate) == written;
    });
  }
  return found == known.end() ? nullptr : &*found;
}

Failure unknownWord(const std::string& word, const std::vector<std::string_view>& known,
                    const std::string& otherwise) {
  const std::string_view meant = nearMiss(vocabularyWord(word), known);
  return {Failure::Kind::badInput,
          shownWord(word) + ": " +
              (meant.empty() ? otherwise : "did you mean " + std::string(meant) + "?")};
}

Result<std::string> chooseWord(const std::string& word, const std::vector<std::string_view>& known,
                               const std::string& otherwise) {
  const std::string_view* found = findWord(word, known);
  if (!found) return unknownWord(word, known, otherwise);
  return std::string(*found);
}

}  // namespace nidus
