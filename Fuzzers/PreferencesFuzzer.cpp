#include <algorithm>

#include "HomePlatform/System/Preferences.h"
#include "Support/Finding.h"
#include "Support/Refusal.h"
#include "Support/TestFolder.h"

// Preferences files: what is refused is refused well and left as it is; of what is read, each kind
// of reader sees values of its own type alone, and it survives being written.

namespace nidus {
namespace {

const TestFolder& folder() {
  static const TestFolder kFolder;
  return kFolder;
}

void checkReadings(Preferences& preferences, const JsonValue::Member& member) {
  const auto& [key, value] = member;
  const auto* boolean = std::get_if<bool>(&value.content);
  const auto reading = preferences.booleanForKey_domain_container(key, Preferences::kDomain,
                                                                  preferences.containerPath());
  if (reading.keyExistsAndIsValid != (boolean != nullptr) ||
      reading.value != (boolean && *boolean)) {
    reportFinding("The boolean reading of \"" + key + "\" is wrong.");
  }
  const auto* integer = std::get_if<std::int64_t>(&value.content);
  if (preferences.integerForKey(key) != (integer ? *integer : 0)) {
    reportFinding("The integer reading of \"" + key + "\" is wrong.");
  }
}

/// Changes one key, and with it writes the file anew: all others stay.
void checkChange(Preferences& preferences, const PreferencesFile& file,
                 JsonValue::Object expected) {
  const JsonValue::Member change = {"NidusLogLevel", {std::int64_t{5}}};
  if (const Status failure = preferences.change({change})) {
    reportFinding("Preferences cannot be changed: " + failure->message);
  }
  const auto isChanged = [&change](const auto& member) { return member.first == change.first; };
  const auto known = std::find_if(expected.begin(), expected.end(), isChanged);
  if (known != expected.end()) {
    known->second = change.second;
  } else {
    expected.push_back(change);
  }
  const auto content = file.read();
  if (!content) reportFinding("Written preferences are refused: " + content.failure().message);
  if (content->values != expected) reportFinding("Preferences change more than they should.");
}

void tryPreferences(std::string_view text) {
  const std::string path = folder().write(Preferences::kFileName, text);
  const PreferencesFile file(path);
  const auto content = file.read();
  const auto opened = Preferences::open(folder().path(), [](const Failure& failure) {
    reportFinding("A file that nobody changes becomes damaged: " + failure.message);
  });
  if (static_cast<bool>(content) != static_cast<bool>(opened)) {
    reportFinding("The file is read or the preferences are opened, but not both.");
  }
  if (!content) {
    checkRefusal(content.failure(), path);
    expectSameText("A damaged file is changed", text, contentOfFile(path));
    return;
  }
  for (const JsonValue::Member& member : content->values) checkReadings(**opened, member);
  checkChange(**opened, file, content->values);
}

}  // namespace
}  // namespace nidus

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  nidus::tryPreferences(nidus::textOf(data, size));
  return 0;
}
