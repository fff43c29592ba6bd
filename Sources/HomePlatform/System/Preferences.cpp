#include "HomePlatform/System/Preferences.h"

#include <algorithm>
#include <utility>

namespace nidus {
namespace {

/// Differs from the stamp of any file, and of none: the next reading looks at the file.
constexpr const char* kNoStamp = "not read";

void applyChange(JsonValue::Object& values, const std::string& key, const JsonValue& value) {
  const auto found = std::find_if(values.begin(), values.end(),
                                  [&key](const auto& member) { return member.first == key; });
  const bool isRemoval = std::holds_alternative<std::nullptr_t>(value.content);
  if (found == values.end()) {
    if (!isRemoval) values.emplace_back(key, value);
  } else if (isRemoval) {
    values.erase(found);
  } else {
    found->second = value;
  }
}

void applyChanges(JsonValue::Object& values, const std::map<std::string, JsonValue>& changes) {
  for (const auto& [key, value] : changes) applyChange(values, key, value);
}

struct Boxing {
  NDValueRef operator()(bool value) const { return NDValue::boolean(value); }
  NDValueRef operator()(std::int64_t value) const { return NDValue::integer(value); }
  NDValueRef operator()(float value) const { return NDValue::floating(value); }
  NDValueRef operator()(const std::string& text) const { return NDValue::text(text); }
  template <class Other>
  NDValueRef operator()(const Other& /*none*/) const {
    return nullptr;
  }
};

}  // namespace

Preferences::Preferences(std::optional<PreferencesFile> file, std::string containerPath,
                         std::function<void(const Failure&)> reportFailure)
    : file_(std::move(file)),
      containerPath_(std::move(containerPath)),
      reportFailure_(std::move(reportFailure)) {}

Result<std::shared_ptr<Preferences>> Preferences::open(
    const std::filesystem::path& folder, std::function<void(const Failure&)> reportFailure) {
  std::shared_ptr<Preferences> preferences(new Preferences(
      PreferencesFile(folder / kFileName), folder.string(), std::move(reportFailure)));
  if (Status failure = preferences->read()) return *failure;
  static_cast<void>(preferences->takeChange());
  return preferences;
}

std::shared_ptr<Preferences> Preferences::inMemory(const std::map<std::string, JsonValue>& values,
                                                   std::string containerPath) {
  std::shared_ptr<Preferences> preferences(
      new Preferences(std::nullopt, std::move(containerPath), {}));
  const NDLock lock(preferences->mutex_);
  preferences->content_.values.assign(values.begin(), values.end());
  return preferences;
}

NDPreferences::BooleanReading Preferences::booleanForKey_domain_container(
    const NDString& key, const NDString& domain, const NDString& containerPath) {
  if (!(domain == kDomain) || !(containerPath == std::string_view(containerPath_))) return {};
  readIfStamped();
  const NDLock lock(mutex_);
  const JsonValue* value = find(key.view());
  const bool* boolean = value ? std::get_if<bool>(&value->content) : nullptr;
  return boolean ? BooleanReading{*boolean, true} : BooleanReading{};
}

void Preferences::synchronize() {
  const Status failure = read();
  if (failure) reportOnce(*failure, file_->stamp());
}

std::int64_t Preferences::integerForKey(const NDString& key) {
  const NDLock lock(mutex_);
  const JsonValue* value = find(key.view());
  const auto* integer = value ? std::get_if<std::int64_t>(&value->content) : nullptr;
  return integer ? *integer : 0;
}

NDValueRef Preferences::valueForKey(const std::string& key) {
  const NDLock lock(mutex_);
  const JsonValue* value = find(key);
  return value ? std::visit(Boxing(), value->content) : nullptr;
}

std::map<std::string, JsonValue> Preferences::values() {
  const NDLock lock(mutex_);
  return {content_.values.begin(), content_.values.end()};
}

Status Preferences::change(const std::map<std::string, JsonValue>& changes) {
  if (!file_) {
    const NDLock lock(mutex_);
    applyChanges(content_.values, changes);
    return std::nullopt;
  }
  const NDLock fileLock(fileMutex_);
  Result<PreferencesContent> present = file_->read();
  if (!present) return present.failure();
  applyChanges(present->values, changes);
  Result<PreferencesContent> written = file_->write(std::move(present->values));
  if (!written) return written.failure();
  const NDLock lock(mutex_);
  content_ = std::move(*written);
  stamp_ = kNoStamp;
  return std::nullopt;
}

bool Preferences::takeChange() {
  const NDLock lock(mutex_);
  if (takenText_ == content_.text) return false;
  takenText_ = content_.text;
  return true;
}

Status Preferences::read() {
  if (!file_) return std::nullopt;
  const NDLock fileLock(fileMutex_);
  // Taken before the content, so that a change in between shows as one.
  std::string stamp = file_->stamp();
  Result<PreferencesContent> content = file_->read();
  const NDLock lock(mutex_);
  stamp_ = std::move(stamp);
  if (!content) return content.failure();
  content_ = std::move(*content);
  return std::nullopt;
}

/// Reads the file again when the file system shows that it has been replaced or changed.
void Preferences::readIfStamped() {
  if (!file_) return;
  const std::string stamp = file_->stamp();
  {
    const NDLock lock(mutex_);
    if (stamp == stamp_) return;
  }
  synchronize();
}

const JsonValue* Preferences::find(std::string_view key) const {
  for (const auto& [name, value] : content_.values) {
    if (name == key) return &value;
  }
  return nullptr;
}

void Preferences::reportOnce(const Failure& failure, const std::string& stamp) {
  {
    const NDLock lock(mutex_);
    if (reportedStamp_ == stamp) return;
    reportedStamp_ = stamp;
  }
  reportFailure_(failure);
}

}  // namespace nidus
