#pragma once

#include <memory>
#include <type_traits>

namespace nidus {

/// Reads a property of an object that may be null; a property of null is null.
///
/// `read` is a const member function, `arguments` are what it takes. For a null object the result
/// is the neutral value of the property's type: null, the empty list, false or zero.
///
///     const NDString& unit = property(metadata, &NDCharacteristicMetadata::units);
///     const NDString type = property(mapper, &NDNAPMetadata::mapFromAssistantServiceName, name);
template <class Pointer, class Object, class Result, class... Parameters, class... Arguments>
[[nodiscard]] Result property(const Pointer& object, Result (Object::*read)(Parameters...) const,
                              const Arguments&... arguments) {
  if (object) return ((*object).*read)(arguments...);
  if constexpr (std::is_reference_v<Result>) {
    // Never destroyed: a platform's thread may still read while the process ends.
    static const auto& none = *new const std::remove_cvref_t<Result>{};
    return none;
  } else {
    return Result{};
  }
}

}  // namespace nidus
