#include "nidus/Watch/ChangeText.h"

#include <array>
#include <string_view>

#include "AssistantHost/JsonLine.h"
#include "HomePlatform/System/OneLine.h"
#include "nidus/Answers/ValueText.h"

namespace nidus {
namespace {

std::string formatted(const std::tm& time, const char* format) {
  std::array<char, 32> text{};
  return {text.data(), std::strftime(text.data(), text.size(), format, &time)};
}

std::string localTime(std::time_t time) {
  std::tm parts = {};
  ::localtime_r(&time, &parts);
  return formatted(parts, "%H:%M:%S");
}

std::string universalTime(std::time_t time) {
  std::tm parts = {};
  ::gmtime_r(&time, &parts);
  return formatted(parts, "%Y-%m-%dT%H:%M:%SZ");
}

std::string pathOf(const ChangePlace& place) {
  std::string path;
  for (const NDString& part : {place.home, place.room, place.accessory, place.service}) {
    if (part) path += (path.empty() ? "" : " / ") + part.str();
  }
  return path;
}

/// A value as the device has it, as a limit is.
std::string valueOf(const NDDictionary& value, const std::string& attribute,
                    const Vocabulary& vocabulary) {
  if (value.empty()) return attribute == "room" ? "no room" : "unknown";
  const std::string_view name(attribute);
  return limitText(value, name.substr(0, name.find(' ')), vocabulary);
}

std::string_view wordOf(HomeChange::Kind kind) {
  switch (kind) {
    case HomeChange::Kind::added:
      return "added";
    case HomeChange::Kind::removed:
      return "removed";
    case HomeChange::Kind::changed:
      break;
  }
  return "changed";
}

}  // namespace

std::string changeText(const HomeChange& change, std::time_t time, const Vocabulary& vocabulary,
                       const TerminalStyle& style) {
  std::string text = coloured(localTime(time), Colour::faint, style) + "  " +
                     onOneLine(pathOf(change.place)) + "  ";
  if (change.kind != HomeChange::Kind::changed) return text.append(wordOf(change.kind)) + '\n';
  return text + onOneLine(change.attribute) + "  " +
         onOneLine(valueOf(change.before, change.attribute, vocabulary)) + " -> " +
         onOneLine(valueOf(change.after, change.attribute, vocabulary)) + '\n';
}

std::string changeJson(const HomeChange& change, std::time_t time) {
  NDDictionary line;
  line.set("time", NDDictionaryValue(NDString(universalTime(time))));
  line.set("change", NDDictionaryValue(NDString(wordOf(change.kind))));
  line.setIfPresent("home", change.place.home);
  line.setIfPresent("room", change.place.room);
  line.setIfPresent("accessory", change.place.accessory);
  line.setIfPresent("service", change.place.service);
  if (change.kind == HomeChange::Kind::changed) {
    line.set("attribute", NDDictionaryValue(NDString(change.attribute)));
    line.set("before", NDDictionaryValue(change.before));
    line.set("after", NDDictionaryValue(change.after));
  }
  return jsonLine(line);
}

}  // namespace nidus
