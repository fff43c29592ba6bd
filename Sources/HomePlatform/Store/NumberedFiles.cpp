#include "HomePlatform/Store/NumberedFiles.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>
#include <system_error>
#include <utility>

namespace nidus {
namespace {

namespace fs = std::filesystem;

/// At least so many digits, so that a listing of the folder is in order too.
constexpr std::size_t kDigits = 6;

/// What stands around the number in a name.
struct Pattern {
  Pattern(const fs::path& file, std::string_view word)
      : start(file.stem().string().append("-").append(word).append("-")),
        end(file.extension().string()) {}

  [[nodiscard]] std::string nameOf(std::int64_t number) const {
    std::string digits = std::to_string(number);
    digits.insert(0, kDigits - std::min(kDigits, digits.size()), '0');
    return start + digits + end;
  }

  [[nodiscard]] std::optional<std::int64_t> numberOf(const std::string& name) const {
    if (name.size() <= start.size() + end.size() || !name.starts_with(start)) return std::nullopt;
    std::int64_t number = 0;
    const char* const first = name.data() + start.size();
    const auto [stop, error] = std::from_chars(first, name.data() + name.size(), number);
    if (error != std::errc() || nameOf(number) != name) return std::nullopt;
    return number;
  }

  const std::string start;
  const std::string end;
};

using Numbered = std::vector<std::pair<std::int64_t, fs::path>>;

Numbered find(const fs::path& file, const Pattern& pattern) {
  const fs::path folder = file.has_parent_path() ? file.parent_path() : fs::path(".");
  Numbered found;
  std::error_code error;
  for (fs::directory_iterator entry(folder, error), end; !error && entry != end;
       entry.increment(error)) {
    const auto number = pattern.numberOf(entry->path().filename().string());
    if (number) found.emplace_back(*number, entry->path());
  }
  std::sort(found.rbegin(), found.rend());
  return found;
}

}  // namespace

std::vector<fs::path> numberedFiles(const fs::path& file, std::string_view word) {
  std::vector<fs::path> files;
  for (auto& [number, path] : find(file, {file, word})) files.push_back(std::move(path));
  return files;
}

fs::path nextNumberedFile(const fs::path& file, std::string_view word) {
  const Pattern pattern(file, word);
  const Numbered found = find(file, pattern);
  return file.parent_path() / pattern.nameOf(found.empty() ? 1 : found.front().first + 1);
}

}  // namespace nidus
