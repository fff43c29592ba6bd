#include <memory>
#include <utility>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Commands/HomeChange.h"
#include "nidus/Commands/ObjectArguments.h"
#include "nidus/HomeEditing/HomeRemoval.h"
#include "nidus/StandardStreams.h"
#include "nidus/Terminal/Question.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

struct RemovalWords {
  ObjectWords object;
  bool isConfirmed = false;
};

ExitStatus removeConfirmed(const ObjectWords& object, Workspace& workspace) {
  return changeHomes(workspace, [&](std::vector<HomeData>& homes, const HomeWording&) {
    auto removed = removeObject(homes, object);
    return removed ? Result<std::string>("removed " + *removed) : removed;
  });
}

/// Removes what a person has agreed to, which was `agreed` then.
ExitStatus removeAgreed(const ObjectWords& object, const std::string& agreed,
                        Workspace& workspace) {
  return changeHomes(workspace, [&](std::vector<HomeData>& homes, const HomeWording&) {
    auto removed = removeObject(homes, object);
    if (!removed) return removed;
    if (*removed == agreed) return Result<std::string>("removed " + agreed);
    return Result<std::string>(badInput("the homes were changed meanwhile, this would remove " +
                                        *removed + "; remove it again"));
  });
}

/// What would be removed, without doing it.
Result<std::string> preview(const ObjectWords& object, Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return session.failure();
  auto homes = (*session)->platform().exportHomes();
  if (!homes) return homes.failure();
  return removeObject(*homes, object);
}

ExitStatus remove(const RemovalWords& words, Workspace& workspace) {
  if (words.isConfirmed) return removeConfirmed(words.object, workspace);
  const auto what = preview(words.object, workspace);
  if (!what) return report(what.failure());
  if (!canAsk()) {
    return report(badInput("nothing was removed; give --yes to remove " + *what));
  }
  if (ask("Remove " + *what + "?")) return removeAgreed(words.object, *what, workspace);
  const ExitStatus printed = printText("nothing was removed\n");
  return printed == ExitStatus::success ? ExitStatus::otherOutcome : printed;
}

void declareRemovalOf(ObjectKind kind, CommandSyntax& parent, Workspace& workspace) {
  const auto words = std::make_shared<RemovalWords>();
  words->object.kind = kind;
  CommandSyntax& syntax = parent.command(wordOf(kind), "Removes " + withArticle(kind),
                                         "Example:\n  nidus home remove " + wordOf(kind) + ' ' +
                                             exampleName(kind) + kQuestionExitStatuses);
  declareObjectArguments(syntax, words->object);
  syntax.flag("--yes", words->isConfirmed, "Remove without a question");
  syntax.run([words, &workspace] { return remove(*words, workspace); });
}

}  // namespace

void declareHomeRemove(CommandSyntax& home, Workspace& workspace) {
  CommandSyntax& syntax = home.command(
      "remove", "Removes a home, a room or any other object",
      std::string("Says first what else it touches and asks, or, without a terminal, wants --yes: "
                  "accessories\n"
                  "of a room that is removed stand in no room, services that are removed leave "
                  "their groups\n"
                  "and scenes, a home goes with all that is in it.\n\n"
                  "Examples:\n"
                  "  nidus home remove room Attic\n"
                  "  nidus home remove accessory \"Floor lamp\" --home \"Beach House\" --yes") +
          kQuestionExitStatuses);
  for (const ObjectKind kind : kObjectKinds) declareRemovalOf(kind, syntax, workspace);
}

}  // namespace nidus
