#include <functional>
#include <memory>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Commands/HomeChange.h"
#include "nidus/Commands/ObjectArguments.h"
#include "nidus/HomeEditing/HomeMoving.h"

namespace nidus {
namespace {

struct AccessoryMove {
  ObjectWords accessory{ObjectKind::accessory, "", ""};
  std::string room;
  bool isOut = false;
};

Result<std::string> move(std::vector<HomeData>& homes, const AccessoryMove& words) {
  if (words.room.empty() != words.isOut) {
    return badInput("it is not said where to; give either --to ROOM or --to-no-room");
  }
  return moveAccessory(homes, words.accessory, words.room);
}

void declareAccessoryMove(CommandSyntax& move, Workspace& workspace) {
  const auto words = std::make_shared<AccessoryMove>();
  CommandSyntax& syntax =
      move.command("accessory", "Puts an accessory into another room of its home, or into none",
                   std::string("Examples:\n"
                               "  nidus home move accessory \"Floor lamp\" --to Study\n"
                               "  nidus home move accessory \"Floor lamp\" --to-no-room") +
                       kExitStatuses);
  declareObjectArguments(syntax, words->accessory);
  syntax.option("--to", "ROOM", words->room, "The name or UUID of the room");
  syntax.candidates("--to", {candidatesOf(ObjectKind::room)});
  syntax.flag("--to-no-room", words->isOut, "It stands in no room of its home");
  syntax.run([words, &workspace] {
    return changeHomes(workspace, [&](std::vector<HomeData>& homes, const HomeWording&) {
      return nidus::move(homes, *words);
    });
  });
}

/// What moves between lists of its home: rooms between zones, services between groups.
struct MoveBetweenLists {
  ObjectKind member;
  ObjectKind list;
  const char* help;
  const char* example;
  Result<std::string> (*move)(std::vector<HomeData>& homes, const ObjectWords& member,
                              const ListChange& lists);
};

constexpr MoveBetweenLists kRooms{
    ObjectKind::room, ObjectKind::zone, "Puts a room into a zone, takes it out of one, or both",
    "nidus home move room Study --from-zone Upstairs --to-zone Attic", moveRoom};
constexpr MoveBetweenLists kServices{
    ObjectKind::service, ObjectKind::group,
    "Puts a service into a group, takes it out of one, or both",
    "nidus home move service \"Floor lamp/Lamp\" --to-group \"Reading corner\"", moveService};

void declareMoveBetweenLists(const MoveBetweenLists& kind, CommandSyntax& move,
                             Workspace& workspace) {
  struct Words {
    ObjectWords member;
    ListChange lists;
  };
  const auto words = std::make_shared<Words>();
  words->member.kind = kind.member;
  CommandSyntax& syntax = move.command(wordOf(kind.member), kind.help,
                                       std::string("Example:\n  ") + kind.example + kExitStatuses);
  declareObjectArguments(syntax, words->member);
  const std::string list = wordOf(kind.list);
  syntax.option("--to-" + list, "NAME", words->lists.to, "The name or UUID of the " + list);
  syntax.option("--from-" + list, "NAME", words->lists.from, "The name or UUID of the " + list);
  syntax.candidates("--to-" + list, {candidatesOf(kind.list)});
  syntax.candidates("--from-" + list, {candidatesOf(kind.list)});
  syntax.run([words, &kind, &workspace] {
    return changeHomes(workspace, [&](std::vector<HomeData>& homes, const HomeWording&) {
      return kind.move(homes, words->member, words->lists);
    });
  });
}

}  // namespace

void declareHomeMove(CommandSyntax& home, Workspace& workspace) {
  CommandSyntax& move =
      home.command("move", "Moves an accessory to a room, a room to a zone, a service to a group",
                   std::string("Example:\n  nidus home move accessory \"Floor lamp\" --to Study") +
                       kExitStatuses);
  declareAccessoryMove(move, workspace);
  declareMoveBetweenLists(kRooms, move, workspace);
  declareMoveBetweenLists(kServices, move, workspace);
}

}  // namespace nidus
