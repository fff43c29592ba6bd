#pragma once

#include <concepts>
#include <cstdint>
#include <initializer_list>
#include <span>
#include <string>
#include <string_view>
#include <variant>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// Something that says what it is on one line, for log messages: `description(x)` is found by
/// argument-dependent look-up.
template <class T>
concept WLODescribable = requires(const T& object) {
  { description(object) } -> std::convertible_to<std::string>;
};

/// An argument of a log message: a text, a number, or a reference to something with a description.
/// Nothing is formatted before the message is; what an argument refers to must outlive the call.
class WLOArgument {
 public:
  // NOLINTBEGIN(google-explicit-constructor): arguments stand in a list as they are.
  WLOArgument(const char* text) : content_(std::string_view(text)) {}
  WLOArgument(std::string_view text) : content_(text) {}
  WLOArgument(const std::string& text) : content_(std::string_view(text)) {}
  /// Null is written as "(null)".
  WLOArgument(const NDString& text) : content_(&text) {}
  template <std::integral Number>
  WLOArgument(Number number) : content_(static_cast<std::int64_t>(number)) {}
  template <WLODescribable T>
  WLOArgument(const T& object)
      : content_(Reference{&object, [](const void* it) -> std::string {
                             return description(*static_cast<const T*>(it));
                           }}) {}
  // NOLINTEND(google-explicit-constructor)

  /// Appends the argument's text.
  void appendTo(std::string& out) const;

 private:
  struct Reference {
    const void* object;
    std::string (*describe)(const void* object);
  };
  std::variant<std::string_view, const NDString*, std::int64_t, Reference> content_;
};

}  // namespace nidus

extern "C" {

/// The preference that sets the log level.
ND_EXPORT extern const char kWLOLogLevelKey[];

/// Says whether messages of `level` (0 emergency to 7 debug) are logged now. Always asked before
/// `WLOLog`, so that a suppressed message costs a comparison. May be called from any thread.
ND_EXPORT bool WLOShouldLogAtLevel(int level);

/// Sends one message to the system log; `level` is from 0 to 7 and is not tested here. Each "%@" or
/// "%s" of `format` stands for the next argument, "%%" for a percent sign; a null format sends a
/// message without a text. May be called from any thread.
ND_EXPORT void WLOLog(int level, const char* format,
                      std::initializer_list<nidus::WLOArgument> arguments);
ND_EXPORT void WLOLogV(int level, const char* format,
                       std::span<const nidus::WLOArgument> arguments);
}
