#include "nidus/Doctor/Remedy.h"

#include <utility>

namespace nidus {
namespace {

constexpr std::string_view kPlain =
    "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789-_./:,+@%";

/// The text before the last `separator`, and what follows it; all is first where there is none.
std::pair<std::string, std::string> cutLast(const std::string& text, std::string_view separator) {
  const auto at = text.rfind(separator);
  if (at == std::string::npos) return {text, {}};
  return {text.substr(0, at), text.substr(at + separator.size())};
}

}  // namespace

std::string shellWord(std::string_view text) {
  if (!text.empty() && text.find_first_not_of(kPlain) == std::string_view::npos) {
    return std::string(text);
  }
  std::string word = "'";
  for (const char c : text) {
    if (c == '\'') {
      word += "'\\''";
    } else {
      word += c;
    }
  }
  return word + '\'';
}

Finding findingOf(const Failure& failure) {
  const auto [problem, remedy] = cutLast(failure.message, "; ");
  const auto colon = problem.find(": ");
  if (colon == std::string::npos) return {Severity::attention, {}, problem, remedy};
  return {Severity::attention, problem.substr(0, colon), problem.substr(colon + 2), remedy};
}

}  // namespace nidus
