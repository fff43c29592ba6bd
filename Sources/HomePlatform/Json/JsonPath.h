#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace nidus {

/// Appends one step to a JSON pointer: `/` and the key with `~` and `/` escaped.
void appendPointerStep(std::string& place, std::string_view key);

/// Where a reader stands in a document, kept while its events pass by. The text of the place is
/// only made when somebody asks for it. Not synchronised.
class JsonPath {
 public:
  /// `base` is the pointer of the value that is read, empty for a whole document.
  explicit JsonPath(std::string base = {}) : base_(std::move(base)) {}

  void enterObject() { steps_.emplace_back(); }
  void enterArray() { steps_.emplace_back().isArray = true; }
  void leave() { steps_.pop_back(); }
  /// The next value belongs to `key` of the innermost object.
  void setKey(std::string_view key) {
    steps_.back().key = key;
    steps_.back().isNamed = true;
  }
  /// A value has ended; in an array the next one follows, in an object the next key.
  void endValue() {
    if (steps_.empty()) return;
    ++steps_.back().index;
    steps_.back().isNamed = false;
  }

  /// The number of objects and arrays that are open.
  [[nodiscard]] std::size_t depth() const noexcept { return steps_.size(); }
  /// Whether the innermost of them is an array.
  [[nodiscard]] bool isInArray() const noexcept { return !steps_.empty() && steps_.back().isArray; }
  /// How many values have ended within the innermost one.
  [[nodiscard]] std::size_t index() const noexcept {
    return steps_.empty() ? 0 : steps_.back().index;
  }
  /// The pointer of the value that comes next, or of the object or array that has just ended; that
  /// of the object where a key comes next.
  [[nodiscard]] std::string place() const;

 private:
  struct Step {
    std::string key;
    std::size_t index = 0;
    bool isArray = false;
    bool isNamed = false;  ///< Whether the next value has its key.
  };
  std::string base_;
  std::vector<Step> steps_;
};

}  // namespace nidus
