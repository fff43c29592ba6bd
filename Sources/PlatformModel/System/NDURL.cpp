#include "PlatformModel/System/NDURL.h"

#include <algorithm>
#include <stdexcept>

namespace nidus {
namespace {

/// The place of the colon that ends the scheme of `text`; `npos` without a scheme.
std::size_t schemeEnd(std::string_view text) noexcept {
  const auto endsScheme = [](char c) { return c == ':' || c == '/' || c == '?' || c == '#'; };
  const auto* const end = std::find_if(text.begin(), text.end(), endsScheme);
  if (end == text.end() || *end != ':') return std::string_view::npos;
  return static_cast<std::size_t>(end - text.begin());
}

/// `text` up to the first `mark`; all of it without one.
std::string_view upTo(char mark, std::string_view text) noexcept {
  return text.substr(0, text.find(mark));
}

/// Takes the next component, which is never empty, off the front of a path; empty at the end.
std::string_view takeComponent(std::string_view& path) noexcept {
  path.remove_prefix(std::min(path.find_first_not_of('/'), path.size()));
  const std::string_view component = path.substr(0, path.find('/'));
  path.remove_prefix(component.size());
  return component;
}

}  // namespace

NDURL NDURL::make(std::string_view scheme, std::string_view host, std::string_view path) {
  return fromText(NDString::joined({scheme, "://", host, path}));
}

NDURL NDURL::fromText(NDString text) { return NDURL(std::move(text)); }

NDString NDURL::scheme() const {
  const std::size_t end = schemeEnd(text_.view());
  if (end == std::string_view::npos) return {};
  return text_.view().substr(0, end);
}

std::string_view NDURL::path() const noexcept {
  std::string_view rest = text_.view();
  rest.remove_prefix(schemeEnd(rest) + 1);  // `npos` and one more is none
  rest = upTo('?', upTo('#', rest));
  if (!rest.starts_with("//")) return rest;
  const std::size_t begin = rest.find('/', 2);
  return begin == std::string_view::npos ? std::string_view() : rest.substr(begin);
}

std::vector<NDString> NDURL::pathComponents() const {
  std::string_view rest = path();
  std::vector<NDString> components;
  if (rest.starts_with('/')) components.emplace_back("/");
  for (;;) {
    const std::string_view component = takeComponent(rest);
    if (component.empty()) return components;
    components.emplace_back(component);
  }
}

std::string_view NDURL::pathComponent(std::size_t index) const {
  std::string_view rest = path();
  std::string_view component = rest.substr(0, 1);
  if (component != "/") component = takeComponent(rest);
  for (; index > 0 && !component.empty(); --index) component = takeComponent(rest);
  if (component.empty()) throw std::out_of_range("A path of a URL has too few components");
  return component;
}

std::optional<std::string_view> NDURL::queryView() const noexcept {
  const std::string_view text = upTo('#', text_.view());
  const std::size_t mark = text.find('?');
  if (mark == std::string_view::npos) return std::nullopt;
  return text.substr(mark + 1);
}

NDString NDURL::query() const {
  const std::optional<std::string_view> query = queryView();
  return query ? NDString(*query) : NDString();
}

}  // namespace nidus
