#pragma once

#include <cstddef>
#include <functional>
#include <string_view>
#include <unordered_set>

#include "PlatformModel/System/NDString.h"

namespace nidus {

/// Keeps one copy of each text that many objects have in common, such as types and units, up to a
/// number that no home comes near. Not synchronised.
class SharedTexts {
 public:
  [[nodiscard]] NDString text(std::string_view characters) {
    const auto known = texts_.find(characters);
    if (known != texts_.end()) return *known;
    if (texts_.size() >= kMost) return {characters};
    return *texts_.emplace(characters).first;
  }

 private:
  static constexpr std::size_t kMost = 4096;

  struct Hash {
    using is_transparent = void;
    std::size_t operator()(std::string_view text) const {
      return std::hash<std::string_view>{}(text);
    }
    std::size_t operator()(const NDString& text) const { return (*this)(text.view()); }
  };
  struct Equal {
    using is_transparent = void;
    bool operator()(const NDString& a, const NDString& b) const { return a == b; }
    bool operator()(std::string_view a, const NDString& b) const { return b == a; }
    bool operator()(const NDString& a, std::string_view b) const { return a == b; }
  };
  std::unordered_set<NDString, Hash, Equal> texts_;
};

}  // namespace nidus
