#include "nidus/Shell/LineWords.h"

#include <utility>

namespace nidus {
namespace {

constexpr std::string_view kWhiteSpace = " \t\r\n";
/// What a backslash keeps within "...".
constexpr std::string_view kKeptInQuotes = "\\\"$`";
/// What means nothing to a shell, nor to how it finds the word under the cursor.
constexpr std::string_view kPlain =
    "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789_-./,+%";

bool isIn(char c, std::string_view set) { return set.find(c) != std::string_view::npos; }

/// Takes a line apart, character by character.
class LineReader {
 public:
  explicit LineReader(std::string_view line) : line_(line) {
    for (; next_ < line_.size() && !isComment_; ++next_) read(line_[next_]);
  }

  std::vector<std::string> words;
  bool isInWord = false;          ///< The last of `words` has not ended.
  char quote = 0;                 ///< The open quote.
  bool hasOpenBackslash = false;  ///< The line ends with one that keeps nothing.
  std::size_t wordStart = 0;      ///< Of the last of `words`.

 private:
  void read(char c) {
    const bool isBackslash = c == '\\' && quote != '\'';
    if (isBackslash) {
      readBackslash();
    } else if (quote != 0) {
      readLiterally(c);
    } else if (isIn(c, kWhiteSpace)) {
      isInWord = false;
    } else if (c == '#' && !isInWord) {
      isComment_ = true;
    } else if (isIn(c, "'\"")) {
      beginWord();
      quote = c;
    } else {
      add(c);
    }
  }

  void readLiterally(char c) {
    if (c == quote) {
      quote = 0;
    } else {
      add(c);
    }
  }

  void readBackslash() {
    if (next_ + 1 == line_.size()) {
      beginWord();
      hasOpenBackslash = true;
    } else if (quote == '"' && !isIn(line_[next_ + 1], kKeptInQuotes)) {
      add('\\');
    } else {
      beginWord();
      words.back() += line_[++next_];
    }
  }

  void add(char c) {
    beginWord();
    words.back() += c;
  }

  void beginWord() {
    if (isInWord) return;
    isInWord = true;
    wordStart = next_;
    words.emplace_back();
  }

  std::string_view line_;
  std::size_t next_ = 0;
  bool isComment_ = false;
};

/// `text` as it is typed where `quote` is open.
std::string typedWithin(std::string_view text, char quote) {
  std::string typed;
  for (const char c : text) {
    if (quote == '\'') {
      typed += c == '\'' ? "'\\''" : std::string(1, c);
      continue;
    }
    const bool isAscii = static_cast<unsigned char>(c) < 0x80;
    const bool isSpecial = quote == '"' ? isIn(c, kKeptInQuotes) : isAscii && !isIn(c, kPlain);
    if (isSpecial) typed += '\\';
    typed += c;
  }
  return typed;
}

}  // namespace

Result<std::vector<std::string>> wordsOf(std::string_view line) {
  LineReader reader(line);
  if (reader.quote != 0) {
    return Failure{
        Failure::Kind::badInput,
        std::string("a quote is open at the end of the line; close it with ") + reader.quote};
  }
  if (reader.hasOpenBackslash) {
    return Failure{Failure::Kind::badInput,
                   "the line ends with a backslash; write two of them to mean one"};
  }
  return std::move(reader.words);
}

UnfinishedLine unfinishedLineOf(std::string_view line) {
  LineReader reader(line);
  UnfinishedLine unfinished;
  unfinished.quote = reader.quote;
  unfinished.words = std::move(reader.words);
  if (reader.isInWord) {
    unfinished.typed = line.substr(reader.wordStart);
    if (reader.hasOpenBackslash) unfinished.typed.pop_back();
  } else {
    unfinished.words.emplace_back();
  }
  return unfinished;
}

std::string typedFormOf(const std::string& word, const UnfinishedLine& line) {
  const std::string& begun = line.words.back();
  if (word.compare(0, begun.size(), begun) == 0) {
    return line.typed + typedWithin(std::string_view(word).substr(begun.size()), line.quote);
  }
  return std::string(line.quote == 0 ? 0 : 1, line.quote) + typedWithin(word, line.quote);
}

}  // namespace nidus
