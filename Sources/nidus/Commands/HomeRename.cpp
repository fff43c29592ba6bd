#include <memory>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/HomeChange.h"
#include "nidus/Commands/ObjectArguments.h"
#include "nidus/HomeEditing/HomeRenaming.h"

namespace nidus {
namespace {

constexpr const char kStatuses[] = "Exit status: 0 renamed, 2 bad input, 4 the platform failed.";

struct Renaming {
  ObjectWords object;
  std::string newName;
};

void declareRenamingOf(ObjectKind kind, CommandSyntax& rename, Workspace& workspace) {
  const auto words = std::make_shared<Renaming>();
  words->object.kind = kind;
  CommandSyntax& syntax = rename.command(wordOf(kind), "Renames " + withArticle(kind), kStatuses);
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
  CommandSyntax& rename = home.command("rename", "Renames a home, a room or any other object",
                                       "Examples:\n"
                                       "  nidus home rename room Kitchen Galley\n"
                                       "  nidus home rename service \"Floor lamp/Lamp\" Glow");
  for (const ObjectKind kind : kObjectKinds) declareRenamingOf(kind, rename, workspace);
}

}  // namespace nidus
