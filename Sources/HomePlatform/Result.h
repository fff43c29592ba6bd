#pragma once

#include <optional>
#include <string>
#include <utility>
#include <variant>

namespace nidus {

/// Why something that a caller asked for was not done: for people, on one line, naming the file,
/// the place and the remedy.
struct Failure {
  enum class Kind {
    badInput,  ///< What was given is wrong; the program is fine.
    platform,  ///< The database, the module or the machine failed.
  };
  Kind kind = Kind::platform;
  std::string message;
};

/// A value or the failure to get it.
template <class T>
class [[nodiscard]] Result {
 public:
  // NOLINTBEGIN(google-explicit-constructor): a function returns either as it is
  Result(T value) : content_(std::move(value)) {}
  Result(Failure failure) : content_(std::move(failure)) {}
  // NOLINTEND(google-explicit-constructor)

  explicit operator bool() const noexcept { return std::holds_alternative<T>(content_); }
  /// The value; only when there is one.
  [[nodiscard]] T& operator*() { return std::get<T>(content_); }
  [[nodiscard]] const T& operator*() const { return std::get<T>(content_); }
  [[nodiscard]] T* operator->() { return &std::get<T>(content_); }
  [[nodiscard]] const T* operator->() const { return &std::get<T>(content_); }
  /// The failure; only when there is one.
  [[nodiscard]] const Failure& failure() const { return std::get<Failure>(content_); }

 private:
  std::variant<T, Failure> content_;
};

/// Nothing or a failure.
using Status = std::optional<Failure>;

}  // namespace nidus
