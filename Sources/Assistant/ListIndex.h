#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <type_traits>
#include <unordered_map>

#include "PlatformModel/System/NDArray.h"

namespace nidus {

/// Finds elements of one list by what `keyOf` gives, over and over: always the first that has the
/// key, as a walk over the list finds it. The first few are found by walking, and those of a short
/// list always; after that a table answers. A list that takes the place of the former is noticed.
/// Keys stay what they are. Not synchronised.
///
///     ListIndex<NDAccessory, &NDAccessory::uuid> accessories;
///     const auto found = accessories.find(home->accessories(), uuid);
template <class Element, auto keyOf>
class ListIndex {
 public:
  using Key = std::remove_cvref_t<std::invoke_result_t<decltype(keyOf), const Element&>>;

  /// The first element of `list` with that key; null when there is none, or no key.
  [[nodiscard]] std::shared_ptr<Element> find(const NDArray<Element>& list,
                                              const std::optional<Key>& key) {
    if (!key) return nullptr;
    if (list.size() <= kShortList) return walkTo(*key, list);
    if (list.begin() != list_.begin()) *this = ListIndex(list);
    if (walks_ < kWalks) {
      ++walks_;
      return walkTo(*key, list);
    }
    if (first_.empty()) fillTable();
    const auto found = first_.find(*key);
    return found == first_.end() ? nullptr : *found->second;
  }

  ListIndex() = default;

 private:
  static constexpr std::size_t kShortList = 32;
  static constexpr int kWalks = 4;

  // The list is held, so no other one can begin at the same place.
  explicit ListIndex(const NDArray<Element>& list) : list_(list) {}

  static std::shared_ptr<Element> walkTo(const Key& key, const NDArray<Element>& list) {
    for (const auto& element : list) {
      if (std::invoke(keyOf, *element) == key) return element;
    }
    return nullptr;
  }

  void fillTable() {
    first_.reserve(list_.size());
    for (const auto& element : list_) first_.try_emplace(std::invoke(keyOf, *element), &element);
  }

  NDArray<Element> list_;
  int walks_ = 0;
  std::unordered_map<Key, const std::shared_ptr<Element>*> first_;
};

}  // namespace nidus
