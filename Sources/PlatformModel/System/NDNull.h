#pragma once

#include <memory>
#include <type_traits>

namespace nidus {

/// Reads a property of an object that may be null; a property of null is null.
///
/// `read` is a const member function. For a null object the result is the neutral value of the
/// property's type: null, the empty list, false or zero.
///
///     const NDString& homeName = property(property(service, &NDService::accessory), ...);
template <class Pointer, class Object, class Result>
[[nodiscard]] Result property(const Pointer& object, Result (Object::*read)() const) {
  if (object) return ((*object).*read)();
  if constexpr (std::is_reference_v<Result>) {
    static const std::remove_cvref_t<Result> kNone{};
    return kNone;
  } else {
    return Result{};
  }
}

}  // namespace nidus
