#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

class NDURL;
/// A URL or null.
using NDURLRef = std::shared_ptr<const NDURL>;

/// A URL as an immutable object. Nothing is escaped or unescaped; what was given is what is read.
/// May be used from any thread.
///
///     NDURLRef url = NDURL::make("x-corvane-nidus", "local", "/home?id=1");
///     url->text();                // "x-corvane-nidus://local/home?id=1"
///     url->pathComponents()[1];   // "home"
class ND_EXPORT NDURL {
 public:
  /// Builds `scheme://host` followed by `path`, which may carry a query. Never null; each call
  /// gives a new object.
  [[nodiscard]] static NDURLRef make(std::string_view scheme, std::string_view host,
                                     std::string_view path);
  /// Takes any text as it stands; a text without a scheme has a null scheme. Never null.
  [[nodiscard]] static NDURLRef fromText(NDString text);

  /// The whole text, never null.
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

  /// For the factories alone.
  explicit NDURL(NDString text) : text_(std::move(text)) {}

 private:
  [[nodiscard]] std::string_view path() const noexcept;

  NDString text_;
};

}  // namespace nidus
