#pragma once

#include <cstddef>
#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDString.h"

namespace nidus {

/// An ordered list of texts, itself shared by reference, because many objects of a home have the
/// same characteristics or are in the same groups. Copying costs one reference count. May be read
/// from any thread.
///
///     record.objectGroups = {"Evening", "Night"};
class TextList {
 public:
  using value_type = NDString;
  using const_iterator = const NDString*;

  /// Makes the empty list.
  TextList() noexcept = default;
  TextList(std::initializer_list<NDString> texts) {
    if (texts.size() > 0) texts_ = std::make_shared<Texts>(texts);
  }

  /// Puts `text` behind the others. Other copies of the list stay as they are; one that nobody else
  /// has grows in place. No other thread may use this object meanwhile.
  void append(NDString text) {
    if (texts_.use_count() != 1) texts_ = std::make_shared<Texts>(begin(), end());
    texts_->push_back(std::move(text));
  }

  [[nodiscard]] std::size_t size() const noexcept { return texts_ ? texts_->size() : 0; }
  [[nodiscard]] bool empty() const noexcept { return !texts_; }
  [[nodiscard]] const_iterator begin() const noexcept { return texts_ ? texts_->data() : nullptr; }
  [[nodiscard]] const_iterator end() const noexcept { return begin() + size(); }

 private:
  using Texts = std::vector<NDString>;

  std::shared_ptr<Texts> texts_;  // null or not empty
};

}  // namespace nidus
