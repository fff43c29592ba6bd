#include "nidus/Shell/LineCompletion.h"

#include <algorithm>
#include <filesystem>
#include <system_error>

#include "nidus/Shell/LineWords.h"

namespace nidus {
namespace {

/// How `words`, which are not empty, all begin; never with a part of a character.
std::string commonStartOf(const std::vector<std::string>& words) {
  std::string start = words.front();
  for (const std::string& word : words) {
    const auto end = std::mismatch(start.begin(), start.end(), word.begin(), word.end()).first;
    start.erase(end, start.end());
  }
  const auto isInsideCharacter = [&words, &start] {
    return std::any_of(words.begin(), words.end(), [&start](const std::string& word) {
      return start.size() < word.size() &&
             (static_cast<unsigned char>(word[start.size()]) & 0xc0) == 0x80;
    });
  };
  while (!start.empty() && isInsideCharacter()) start.pop_back();
  return start;
}

/// What closes a whole word; nothing behind a folder, whose files may follow.
std::string endOf(const std::string& word, char quote) {
  if (!word.empty() && word.back() == '/') return "";
  return std::string(quote == 0 ? 0 : 1, quote) + ' ';
}

}  // namespace

LineCompletion lineCompletion(std::string_view line, const std::vector<std::string>& words) {
  if (words.empty()) return {};
  const UnfinishedLine unfinished = unfinishedLineOf(line);
  const std::size_t typedSize = unfinished.typed.size();
  if (words.size() == 1) {
    const std::string& word = words.front();
    return {typedSize, typedFormOf(word, unfinished) + endOf(word, unfinished.quote), {}};
  }
  const std::string start = commonStartOf(words);
  if (start.size() <= unfinished.words.back().size()) return {0, "", words};
  return {typedSize, typedFormOf(start, unfinished), {}};
}

std::vector<std::string> filesThatBeginWith(const std::string& start) {
  namespace fs = std::filesystem;
  const fs::path folder = fs::path(start).parent_path();
  const std::string name = fs::path(start).filename().string();
  std::vector<std::string> files;
  std::error_code error;
  for (fs::directory_iterator entry(folder.empty() ? "." : folder, error), end;
       !error && entry != end; entry.increment(error)) {
    const std::string found = entry->path().filename().string();
    const bool isHidden = found.front() == '.' && (name.empty() || name.front() != '.');
    if (isHidden || found.compare(0, name.size(), name) != 0) continue;
    std::error_code ignored;
    files.push_back((folder / found).string() + (entry->is_directory(ignored) ? "/" : ""));
  }
  std::sort(files.begin(), files.end());
  return files;
}

}  // namespace nidus
