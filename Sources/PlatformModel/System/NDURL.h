#pragma once

#include <cstddef>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// A URL as an immutable object, shared by reference, that may be null. Nothing is escaped or
/// unescaped; what was given is what is read. May be used from any thread.
///
///     NDURL url = NDURL::make("x-corvane-nidus", "local", "/home?id=1");
///     url.text();                // "x-corvane-nidus://local/home?id=1"
///     url.pathComponents()[1];   // "home"
class ND_EXPORT NDURL {
 public:
  /// Makes the null URL, of which no part may be asked for but its text.
  NDURL() noexcept = default;
  NDURL(std::nullptr_t) noexcept {}  // NOLINT(google-explicit-constructor): null is a URL

  /// Builds `scheme://host` followed by `path`, which may carry a query. Never null; each call
  /// gives a new object.
  [[nodiscard]] static NDURL make(std::string_view scheme, std::string_view host,
                                  std::string_view path);
  /// Takes any text as it stands; a text without a scheme has a null scheme. The null
  /// text gives the null URL.
  [[nodiscard]] static NDURL fromText(NDString text);

  /// Says whether there is a URL.
  explicit operator bool() const noexcept { return static_cast<bool>(text_); }
  /// Compares the texts; null equals null alone.
  friend bool operator==(const NDURL& a, const NDURL& b) noexcept { return a.text_ == b.text_; }

  /// The whole text; null for the null URL alone.
  [[nodiscard]] const NDString& text() const noexcept { return text_; }
  /// The part before the first colon; null without a colon, or when a "/", "?" or "#" precedes it.
  [[nodiscard]] NDString scheme() const;
  /// "/" for a path that begins with one, then the path's components without their slashes, none
  /// of them empty; empty without a path. The path ends before the first "?" or "#".
  [[nodiscard]] std::vector<NDString> pathComponents() const;
  /// The component of that index in this URL's own text. Throws `std::out_of_range` for one that
  /// the path has not.
  [[nodiscard]] std::string_view pathComponent(std::size_t index) const;
  /// What follows the first "?" up to a "#"; null without a "?" before the first "#".
  [[nodiscard]] NDString query() const;
  /// The query in this URL's own text; none where `query` gives null.
  [[nodiscard]] std::optional<std::string_view> queryView() const noexcept;

 private:
  explicit NDURL(NDString text) : text_(std::move(text)) {}
  [[nodiscard]] std::string_view path() const noexcept;

  NDString text_;
};

}  // namespace nidus
