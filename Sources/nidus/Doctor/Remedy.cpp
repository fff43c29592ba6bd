#include "nidus/Doctor/Remedy.h"

#include <string_view>
#include <utility>

namespace nidus {
namespace {

/// The text before the last `separator`, and what follows it; all is first where there is none.
std::pair<std::string, std::string> cutLast(const std::string& text, std::string_view separator) {
  const auto at = text.rfind(separator);
  if (at == std::string::npos) return {text, {}};
  return {text.substr(0, at), text.substr(at + separator.size())};
}

}  // namespace

Finding findingOf(const Failure& failure) {
  const auto [problem, remedy] = cutLast(failure.message, "; ");
  const auto colon = problem.find(": ");
  if (colon == std::string::npos) return {Severity::attention, {}, problem, remedy};
  return {Severity::attention, problem.substr(0, colon), problem.substr(colon + 2), remedy};
}

}  // namespace nidus
