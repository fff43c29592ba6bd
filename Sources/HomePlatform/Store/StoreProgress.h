#pragma once

#include <cstddef>
#include <functional>

namespace nidus {

/// Hears how many accessories have been stored of a change that may be long: 0 at its beginning,
/// then the number after each of them, up to all; the change becomes lasting after that. Called on
/// the thread of the change, within its transaction: it must be quick and must not call the store.
using StoreProgress = std::function<void(std::size_t accessories)>;

}  // namespace nidus
