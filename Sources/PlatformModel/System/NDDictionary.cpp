#include "PlatformModel/System/NDDictionary.h"

#include <algorithm>

namespace nidus {

void NDDictionary::reserve(std::size_t count) { entries_.reserve(count); }

void NDDictionary::set(std::string_view key, NDDictionaryValue value) {
  const auto entry = std::find_if(entries_.begin(), entries_.end(),
                                  [key](const Entry& candidate) { return candidate.first == key; });
  if (entry == entries_.end()) {
    entries_.emplace_back(key, std::move(value));
  } else {
    entry->second = std::move(value);
  }
}

void NDDictionary::setIfPresent(std::string_view key, const NDString& text) {
  if (text) set(key, NDDictionaryValue(text));
}

const NDDictionaryValue* NDDictionary::find(std::string_view key) const noexcept {
  for (const Entry& entry : entries_) {
    if (entry.first == key) return &entry.second;
  }
  return nullptr;
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
