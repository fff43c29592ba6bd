#include "nidus/Explain/ActionText.h"

#include <algorithm>

#include "HomePlatform/System/OneLine.h"
#include "nidus/Terminal/TextTable.h"

namespace nidus {
namespace {

constexpr const char kObject[] = "OBJECT";
constexpr const char kRoom[] = "ROOM";
constexpr const char kAttribute[] = "ATTRIBUTE";
constexpr const char kKnown[] = "KNOWN LAST";

/// Puts the explanation of an action together.
class ActionTelling {
 public:
  ActionTelling(const HomeIndex& before, const HomeWords& words, const TerminalStyle& style)
      : before_(before), words_(words), style_(style) {}

  [[nodiscard]] std::string reached(const Rehearsal& rehearsal) const {
    TextTable table({kObject, kRoom, "HOME", kAttribute, kKnown, "LIMITS"});
    for (const HomeCharacteristic& place : rehearsal.reached) {
      if (const auto* found = before_.find(place)) table.addRow(reachedRow(*found));
    }
    return "It reaches:\n" + table.text(style_);
  }

  [[nodiscard]] std::string call(const PlatformCall& call) const {
    const HomeData* home = before_.findHome(call.home);
    const std::string where = home ? onOneLine(home->name.view()) : call.home.UUIDString().str();
    switch (call.kind) {
      case PlatformCall::Kind::read:
        return "It would read, in one batch of " + where + ":\n" + reads(call);
      case PlatformCall::Kind::write:
        return "It would write, in one batch of " + where + ":\n" + writes(call);
      case PlatformCall::Kind::execute:
        break;
    }
    return scene(home, call, where);
  }

  [[nodiscard]] std::string changes(const HomeIndex& after) const {
    TextTable table({kObject, kRoom, kAttribute, kKnown, "AFTERWARDS"});
    for (std::size_t i = 0; i < before_.all().size() && i < after.all().size(); ++i) {
      const PlacedCharacteristic& old = before_.all()[i];
      const PlacedCharacteristic& now = after.all()[i];
      if (now.hasValueOf(old)) continue;
      table.addRow(withObject(
          old, {valueOf(old, old.characteristic->value), valueOf(now, now.characteristic->value)}));
    }
    return table.empty() ? "No value would be another one afterwards.\n"
                         : "Values that would be others afterwards:\n" + table.text(style_);
  }

 private:
  using Row = std::vector<TextCell>;

  [[nodiscard]] std::string valueOf(const PlacedCharacteristic& placed,
                                    const NDValueRef& value) const {
    return words_.valueOf(*placed.characteristic, value);
  }

  /// The object, its room and the attribute, and what follows them.
  [[nodiscard]] Row withObject(const PlacedCharacteristic& placed,
                               const std::vector<std::string>& cells) const {
    Row row = {placed.objectName(), placed.roomName(),
               onOneLine(words_.attributeOf(placed.characteristic->characteristicType))};
    row.insert(row.end(), cells.begin(), cells.end());
    return row;
  }

  [[nodiscard]] Row reachedRow(const PlacedCharacteristic& placed) const {
    Row row = withObject(placed, {valueOf(placed, placed.characteristic->value),
                                  words_.limitsOf(*placed.characteristic)});
    row.insert(row.begin() + 2, onOneLine(placed.home->name.view()));
    return row;
  }

  [[nodiscard]] std::string reads(const PlatformCall& call) const {
    TextTable table({kObject, kRoom, kAttribute, kKnown});
    for (const CharacteristicAddress& address : call.characteristics) {
      const auto* found = before_.find({call.home, address});
      if (found) table.addRow(withObject(*found, {valueOf(*found, found->characteristic->value)}));
    }
    return table.text(style_);
  }

  void addWrite(TextTable& table, const HomeCharacteristic& place, const NDValueRef& value) const {
    const auto* found = before_.find(place);
    if (!found) return;
    table.addRow(withObject(*found, {valueOf(*found, found->characteristic->value),
                                     value ? valueOf(*found, value) : "nothing",
                                     words_.limitsOf(*found->characteristic)}));
  }

  [[nodiscard]] static TextTable writeTable() {
    return TextTable({kObject, kRoom, kAttribute, kKnown, "TO WRITE", "LIMITS"});
  }

  [[nodiscard]] std::string writes(const PlatformCall& call) const {
    TextTable table = writeTable();
    for (std::size_t i = 0; i < call.characteristics.size(); ++i) {
      addWrite(table, {call.home, call.characteristics[i]}, call.values[i]);
    }
    return table.text(style_);
  }

  [[nodiscard]] std::string scene(const HomeData* home, const PlatformCall& call,
                                  const std::string& where) const {
    if (!home) return "It would run a scene of " + where + ".\n";
    const auto found = std::find_if(
        home->actionSets.begin(), home->actionSets.end(),
        [&call](const ActionSetData& candidate) { return candidate.uuid == call.actionSet; });
    if (found == home->actionSets.end()) return "It would run a scene of " + where + ".\n";
    TextTable table = writeTable();
    for (const SceneActionData& action : found->actions) {
      addWrite(table, {call.home, action.target}, action.value);
    }
    const std::string text =
        "It would run the scene " + onOneLine(found->name.view()) + " of " + where;
    return table.empty() ? text + ", which sets nothing.\n"
                         : text + ", which writes:\n" + table.text(style_);
  }

  const HomeIndex& before_;
  const HomeWords& words_;
  const TerminalStyle& style_;
};

}  // namespace

std::string actionText(const Rehearsal& rehearsal, const HomeIndex& before, const HomeWords& words,
                       const TerminalStyle& style) {
  const ActionTelling telling(before, words, style);
  std::string text = rehearsal.reached.empty() ? "" : telling.reached(rehearsal);
  for (const PlatformCall& call : rehearsal.calls) {
    text += (text.empty() ? "" : "\n") + telling.call(call);
  }
  if (rehearsal.calls.empty()) return text + "No device would be asked or set.\n";
  const bool onlyReads =
      std::all_of(rehearsal.calls.begin(), rehearsal.calls.end(),
                  [](const PlatformCall& call) { return call.kind == PlatformCall::Kind::read; });
  return onlyReads ? text : text + '\n' + telling.changes(HomeIndex(rehearsal.after));
}

}  // namespace nidus
