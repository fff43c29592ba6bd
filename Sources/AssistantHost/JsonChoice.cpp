#include "AssistantHost/JsonChoice.h"

#include <algorithm>
#include <string>

namespace nidus {
namespace {

std::string listOf(const std::vector<std::string_view>& keys) {
  std::string list;
  for (const std::string_view key : keys) {
    if (!list.empty()) list += ", ";
    list.append(1, '"').append(key).append(1, '"');
  }
  return list;
}

}  // namespace

std::string_view chosenKey(const JsonPlaced& object, const std::vector<std::string_view>& keys) {
  const auto* members = std::get_if<JsonValue::Object>(&object.value().content);
  if (!members) object.fail("expected an object with one of the keys " + listOf(keys));
  std::vector<std::string_view> chosen;
  for (const std::string_view key : keys) {
    const auto isKey = [key](const JsonValue::Member& member) { return member.first == key; };
    if (std::any_of(members->begin(), members->end(), isKey)) chosen.push_back(key);
  }
  if (chosen.size() != 1) object.fail("expected exactly one of the keys " + listOf(keys));
  return chosen.front();
}

}  // namespace nidus
