#include "PlatformModel/System/NDURL.h"

#include <algorithm>
#include <string>

namespace nidus {
namespace {

/// The place of the colon that ends the scheme of `text`; `npos` without a scheme.
std::size_t schemeEnd(std::string_view text) noexcept {
  const std::size_t end = text.find_first_of(":/?#");
  return end != std::string_view::npos && text[end] == ':' ? end : std::string_view::npos;
}

}  // namespace

NDURLRef NDURL::make(std::string_view scheme, std::string_view host, std::string_view path) {
  std::string text;
  text.reserve(scheme.size() + 3 + host.size() + path.size());
  text.append(scheme).append("://").append(host).append(path);
  return fromText(text);
}

NDURLRef NDURL::fromText(NDString text) { return std::make_shared<NDURL>(std::move(text)); }

NDString NDURL::scheme() const {
  const std::size_t end = schemeEnd(text_.view());
  if (end == std::string_view::npos) return {};
  return text_.view().substr(0, end);
}

std::string_view NDURL::path() const noexcept {
  std::string_view rest = text_.view();
  rest.remove_prefix(schemeEnd(rest) + 1);  // `npos` and one more is none
  rest = rest.substr(0, rest.find_first_of("?#"));
  if (!rest.starts_with("//")) return rest;
  const std::size_t begin = rest.find('/', 2);
  return begin == std::string_view::npos ? std::string_view() : rest.substr(begin);
}

std::vector<NDString> NDURL::pathComponents() const {
  std::string_view rest = path();
  std::vector<NDString> components;
  if (rest.starts_with('/')) components.emplace_back("/");
  while (!rest.empty()) {
    const std::string_view component = rest.substr(0, rest.find('/'));
    if (!component.empty()) components.emplace_back(component);
    rest.remove_prefix(std::min(component.size() + 1, rest.size()));
  }
  return components;
}

NDString NDURL::query() const {
  std::string_view text = text_.view();
  text = text.substr(0, text.find('#'));
  const std::size_t mark = text.find('?');
  if (mark == std::string_view::npos) return {};
  return text.substr(mark + 1);
}

}  // namespace nidus
