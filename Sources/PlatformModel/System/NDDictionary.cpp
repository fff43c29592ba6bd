#include "PlatformModel/System/NDDictionary.h"

#include <algorithm>

namespace nidus {
namespace {

auto entryIn(auto& entries, std::string_view key) noexcept {
  return std::find_if(entries.begin(), entries.end(),
                      [key](const auto& entry) { return entry.first == key; });
}

/// Makes a new value in its place: a reply has very many.
template <class Plain>
void setIn(std::vector<NDDictionary::Entry>& entries, std::string_view key, Plain&& plain) {
  const auto entry = entryIn(entries, key);
  if (entry == entries.end()) {
    entries.emplace_back(key, std::forward<Plain>(plain));
  } else {
    entry->second = NDDictionaryValue(std::forward<Plain>(plain));
  }
}

}  // namespace

void NDDictionary::reserve(std::size_t count) { entries_.reserve(count); }

void NDDictionary::set(std::string_view key, NDDictionaryValue value) {
  setIn(entries_, key, std::move(value));
}

void NDDictionary::setIfPresent(std::string_view key, const NDString& text) {
  if (text) setIn(entries_, key, text);
}

const NDDictionaryValue* NDDictionary::find(std::string_view key) const noexcept {
  const auto entry = entryIn(entries_, key);
  return entry == entries_.end() ? nullptr : &entry->second;
}

bool NDDictionary::empty() const noexcept { return entries_.empty(); }

std::size_t NDDictionary::size() const noexcept { return entries_.size(); }

std::vector<NDDictionary::Entry>::const_iterator NDDictionary::begin() const noexcept {
  return entries_.begin();
}

std::vector<NDDictionary::Entry>::const_iterator NDDictionary::end() const noexcept {
  return entries_.end();
}

bool operator==(const NDDictionary& a, const NDDictionary& b) { return a.entries_ == b.entries_; }

NDDictionaryValue::NDDictionaryValue(NDString value)
    : content_(value ? Content(std::move(value)) : Content(nullptr)) {}

bool operator==(const NDDictionaryValue& a, const NDDictionaryValue& b) {
  return a.content_ == b.content_;
}

}  // namespace nidus
