#pragma once

#include <stdexcept>

namespace nidus {

/// The system lacks a library, or has one that lacks what it should have; says so with the remedy.
class MissingLibrary : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// A library of the system that few commands need, loaded by the first one that does, so that the
/// others start without it. It stays loaded until the process ends.
///
///     const SystemLibrary widths("libunistring.so.2");
///     const auto width = widths.function<decltype(u8_width)>("u8_width");
class SystemLibrary {
 public:
  /// Finds the library by the name that the system has it under, as at the start of a program.
  /// Throws MissingLibrary where that fails.
  explicit SystemLibrary(const char* name);

  /// Its function of that name, never null. Throws MissingLibrary where there is none.
  template <typename Function>
  [[nodiscard]] Function* function(const char* name) const {
    return reinterpret_cast<Function*>(address(name));
  }

 private:
  [[nodiscard]] void* address(const char* name) const;

  void* const library_;
};

}  // namespace nidus
