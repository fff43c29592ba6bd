#include "Replay/TranscriptComparison.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <vector>

#include "HomePlatform/Json/JsonText.h"
#include "HomePlatform/Json/JsonValue.h"

namespace nidus {
namespace {

using Difference = std::optional<std::string>;

/// The lists whose elements may stand in any order, by their keys.
constexpr std::array<std::string_view, 5> kUnorderedLists = {"replies", "actionResults", "platform",
                                                             "writes", "log"};

Difference compare(const JsonValue& expected, const JsonValue& printed, const std::string& place);

std::string shown(const JsonValue& value) {
  std::string text;
  appendJson(text, value);
  return text;
}

Difference differs(const std::string& place, const std::string& expected,
                   const std::string& printed) {
  return place + ": expected " + expected + ", printed " + printed;
}

Difference compareLengths(const JsonValue::Array& expected, const JsonValue::Array& printed,
                          const std::string& place) {
  if (expected.size() == printed.size()) return std::nullopt;
  return differs(place, std::to_string(expected.size()) + " elements",
                 std::to_string(printed.size()));
}

Difference compareInOrder(const JsonValue::Array& expected, const JsonValue::Array& printed,
                          const std::string& place) {
  for (std::size_t i = 0; i < std::min(expected.size(), printed.size()); ++i) {
    if (auto found = compare(expected[i], printed[i], place + "/" + std::to_string(i))) {
      return found;
    }
  }
  return compareLengths(expected, printed, place);
}

/// Pairs every expected element with a printed one of its own. Patterns may match several printed
/// elements, so an element that is taken is given up when its owner finds another.
class Pairing {
 public:
  Pairing(const JsonValue::Array& expected, const JsonValue::Array& printed)
      : expected_(expected), printed_(printed), owners_(printed.size()) {}

  /// Returns whether the expected element `index` got a printed one.
  bool pair(std::size_t index) {
    std::vector<bool> tried(printed_.size());
    return pair(index, tried);
  }

 private:
  bool pair(std::size_t index, std::vector<bool>& tried) {
    for (std::size_t i = 0; i < printed_.size(); ++i) {
      if (tried[i] || compare(expected_[index], printed_[i], "")) continue;
      tried[i] = true;
      if (owners_[i] && !pair(*owners_[i], tried)) continue;
      owners_[i] = index;
      return true;
    }
    return false;
  }

  const JsonValue::Array& expected_;
  const JsonValue::Array& printed_;
  std::vector<std::optional<std::size_t>> owners_;  ///< The expected element of each printed one.
};

Difference compareInAnyOrder(const JsonValue::Array& expected, const JsonValue::Array& printed,
                             const std::string& place) {
  Pairing pairing(expected, printed);
  for (std::size_t i = 0; i < expected.size(); ++i) {
    if (!pairing.pair(i)) return differs(place, shown(expected[i]), "nothing that matches it");
  }
  return compareLengths(expected, printed, place);
}

Difference compareMember(const std::string& key, const JsonValue& expected,
                         const JsonValue& printed, const std::string& place) {
  const auto* expectedList = std::get_if<JsonValue::Array>(&expected.content);
  const auto* printedList = std::get_if<JsonValue::Array>(&printed.content);
  const bool isUnordered =
      std::find(kUnorderedLists.begin(), kUnorderedLists.end(), key) != kUnorderedLists.end();
  if (isUnordered && expectedList != nullptr && printedList != nullptr) {
    return compareInAnyOrder(*expectedList, *printedList, place);
  }
  return compare(expected, printed, place);
}

const JsonValue* find(const JsonValue::Object& object, const std::string& key) {
  for (const JsonValue::Member& member : object) {
    if (member.first == key) return &member.second;
  }
  return nullptr;
}

Difference compareObjects(const JsonValue::Object& expected, const JsonValue::Object& printed,
                          const std::string& place) {
  for (const JsonValue::Member& member : printed) {
    if (find(expected, member.first) == nullptr) {
      return differs(place + "/" + member.first, "nothing", shown(member.second));
    }
  }
  for (const JsonValue::Member& member : expected) {
    const std::string memberPlace = place + "/" + member.first;
    const JsonValue* value = find(printed, member.first);
    if (value == nullptr) return differs(memberPlace, shown(member.second), "nothing");
    if (auto found = compareMember(member.first, member.second, *value, memberPlace)) return found;
  }
  return std::nullopt;
}

Difference compare(const JsonValue& expected, const JsonValue& printed, const std::string& place) {
  if (expected.content.index() == printed.content.index()) {
    if (const auto* object = std::get_if<JsonValue::Object>(&expected.content)) {
      return compareObjects(*object, std::get<JsonValue::Object>(printed.content), place);
    }
    if (const auto* list = std::get_if<JsonValue::Array>(&expected.content)) {
      return compareInOrder(*list, std::get<JsonValue::Array>(printed.content), place);
    }
    if (const auto* text = std::get_if<std::string>(&expected.content)) {
      if (matchesPattern(*text, std::get<std::string>(printed.content))) return std::nullopt;
    } else if (expected.content == printed.content) {
      return std::nullopt;
    }
  }
  return differs(place, shown(expected), shown(printed));
}

std::vector<std::string_view> linesOf(std::string_view text) {
  std::vector<std::string_view> lines;
  while (!text.empty()) {
    const std::size_t end = std::min(text.find('\n'), text.size());
    lines.push_back(text.substr(0, end));
    text.remove_prefix(std::min(end + 1, text.size()));
  }
  return lines;
}

Difference compareLines(std::string_view expected, std::string_view printed) {
  try {
    return compare(parseJson(expected), parseJson(printed), "");
  } catch (const JsonError& error) {
    return "not JSON: " + error.message;
  }
}

}  // namespace

bool matchesPattern(std::string_view pattern, std::string_view text) {
  const std::size_t star = pattern.find('*');
  if (star == std::string_view::npos) return pattern == text;
  if (text.substr(0, star) != pattern.substr(0, star)) return false;
  const std::string_view rest = pattern.substr(star + 1);
  for (std::size_t skipped = star; skipped <= text.size(); ++skipped) {
    if (matchesPattern(rest, text.substr(skipped))) return true;
  }
  return false;
}

std::optional<std::string> transcriptDifference(std::string_view expected,
                                                std::string_view printed) {
  const std::vector<std::string_view> expectedLines = linesOf(expected);
  const std::vector<std::string_view> printedLines = linesOf(printed);
  for (std::size_t i = 0; i < std::max(expectedLines.size(), printedLines.size()); ++i) {
    const std::string number = "line " + std::to_string(i + 1);
    if (i >= printedLines.size()) return number + " is missing: " + std::string(expectedLines[i]);
    if (i >= expectedLines.size()) return number + " is too much: " + std::string(printedLines[i]);
    if (auto found = compareLines(expectedLines[i], printedLines[i])) {
      return number + *found + "\n  expected: " + std::string(expectedLines[i]) +
             "\n  printed:  " + std::string(printedLines[i]);
    }
  }
  return std::nullopt;
}

}  // namespace nidus
