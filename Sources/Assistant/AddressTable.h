#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace nidus {

/// Finds values by the address of the object that they belong to. All lie in one block, because a
/// snapshot of a large home would otherwise spend more on the blocks than on all the rest. Not
/// synchronised.
///
///     AddressTable<NDString> zoneNames(rooms.size());
///     zoneNames[room.get()] = "Downstairs";
template <class Value>
class AddressTable {
 public:
  /// Makes room for values of at most `greatestSize` objects.
  explicit AddressTable(std::size_t greatestSize)
      : slots_(std::bit_ceil(2 * greatestSize + 2)),
        unusedBits_(64 - std::countr_zero(slots_.size())) {}

  /// The value of `object`, which is not null; made when there is none.
  [[nodiscard]] Value& operator[](const void* object) {
    Slot& slot = slots_[placeOf(object)];
    slot.object = object;
    return slot.value;
  }

  /// The value of `object`, which is not null; an empty one when there is none.
  [[nodiscard]] const Value& find(const void* object) const {
    return slots_[placeOf(object)].value;
  }

 private:
  struct Slot {
    const void* object = nullptr;
    Value value{};
  };

  /// Where the object is, or the free place that it would take. There always is one.
  [[nodiscard]] std::size_t placeOf(const void* object) const {
    constexpr std::uint64_t kGoldenRatio = 0x9E3779B97F4A7C15;  // spreads addresses of a pattern
    const auto address = static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(object));
    std::size_t place = address * kGoldenRatio >> unusedBits_;
    while (slots_[place].object && slots_[place].object != object) {
      place = (place + 1) & (slots_.size() - 1);
    }
    return place;
  }

  std::vector<Slot> slots_;  // a power of two, at most half of them taken
  int unusedBits_;
};

}  // namespace nidus
