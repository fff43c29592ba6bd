#pragma once

#include <cstdint>
#include <unordered_map>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// What tells an object of a list apart from the others: its UUID, or where it has none its
/// instance ID.
template <class Object>
auto keyOf(const Object& object) {
  if constexpr (requires { object.uuid; }) {
    return object.uuid;
  } else {
    return object.instanceID;
  }
}

/// Calls `visit` with pointers to both states of each object of two lists, null for the one that it
/// does not have: first those of `after`, then those that only `before` has, both in order.
template <class Object, class Visit>
void forEachPair(const std::vector<Object>& before, const std::vector<Object>& after,
                 const Visit& visit) {
  std::unordered_map<decltype(keyOf(before.front())), const Object*> earlier;
  for (const Object& object : before) earlier.emplace(keyOf(object), &object);
  for (const Object& object : after) {
    const auto found = earlier.find(keyOf(object));
    visit(found == earlier.end() ? nullptr : found->second, &object);
    if (found != earlier.end()) earlier.erase(found);
  }
  for (const Object& object : before) {
    if (earlier.count(keyOf(object)) > 0) visit(&object, nullptr);
  }
}

}  // namespace nidus
