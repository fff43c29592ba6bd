#include <memory>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Commands/HomeChange.h"
#include "nidus/Commands/ObjectArguments.h"
#include "nidus/HomeEditing/HomeRenaming.h"

namespace nidus {
namespace {

struct Renaming {
  ObjectWords object;
  std::string newName;
};

void declareRenamingOf(ObjectKind kind, CommandSyntax& rename, Workspace& workspace) {
  const auto words = std::make_shared<Renaming>();
  words->object.kind = kind;
  CommandSyntax& syntax = rename.command(wordOf(kind), "Renames " + withArticle(kind),
                                         "Example:\n  nidus home rename " + wordOf(kind) + ' ' +
                                             exampleName(kind) + " \"New name\"" + kExitStatuses);
  declareObjectArguments(syntax, words->object);
  syntax.requiredArgument("NEWNAME", words->newName, "The name that it gets");
  syntax.run([words, &workspace] {
    return changeHomes(workspace, [&](std::vector<HomeData>& homes, const HomeWording&) {
      return renameObject(homes, words->object, words->newName);
    });
  });
}

}  // namespace

void declareHomeRename(CommandSyntax& home, Workspace& workspace) {
  CommandSyntax& rename =
      home.command("rename", "Renames a home, a room or any other object",
                   std::string("Examples:\n"
                               "  nidus home rename room Kitchen Galley\n"
                               "  nidus home rename service \"Floor lamp/Lamp\" Glow") +
                       kExitStatuses);
  for (const ObjectKind kind : kObjectKinds) declareRenamingOf(kind, rename, workspace);
}

}  // namespace nidus
