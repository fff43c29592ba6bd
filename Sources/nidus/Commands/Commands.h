#pragma once

namespace nidus {

class CommandSyntax;
class Workspace;

/// The commands of the program. Each is declared by a unit of its own; `workspace` is used when
/// the command runs and must live until then.
void declareHome(CommandSyntax& program, Workspace& workspace);
void declareHomeImport(CommandSyntax& home, Workspace& workspace);
void declareHomeExport(CommandSyntax& home, Workspace& workspace);
void declareHomeShow(CommandSyntax& home, Workspace& workspace);
void declareHomeCheck(CommandSyntax& home);
void declareHomeAdd(CommandSyntax& home, Workspace& workspace);
void declareHomeRename(CommandSyntax& home, Workspace& workspace);
void declareHomeMove(CommandSyntax& home, Workspace& workspace);
void declareHomeRemove(CommandSyntax& home, Workspace& workspace);
void declareHomeEdit(CommandSyntax& home, Workspace& workspace);
void declareHomeRestore(CommandSyntax& home, Workspace& workspace);
void declareOrders(CommandSyntax& program, Workspace& workspace);
void declarePerform(CommandSyntax& program, Workspace& workspace);
void declareSync(CommandSyntax& program, Workspace& workspace);
void declareRecords(CommandSyntax& program, Workspace& workspace);
void declareVocabulary(CommandSyntax& program, Workspace& workspace);
void declarePreferences(CommandSyntax& program, Workspace& workspace);
void declareExplain(CommandSyntax& program, Workspace& workspace);
void declareReplay(CommandSyntax& program);
void declareDemo(CommandSyntax& program);
void declareDoctor(CommandSyntax& program, Workspace& workspace);
void declareWatch(CommandSyntax& program, Workspace& workspace);
void declareShell(CommandSyntax& program, Workspace& workspace);
void declareComplete(CommandSyntax& program, Workspace& workspace);
void declareCompletion(CommandSyntax& program);

}  // namespace nidus
