#pragma once

namespace nidus {

class CommandSyntax;
struct Settings;

/// The commands of the program. Each is declared by a unit of its own; `settings` are read when the
/// command runs and must live until then.
void declareHome(CommandSyntax& program, const Settings& settings);
void declareHomeImport(CommandSyntax& home, const Settings& settings);
void declareHomeExport(CommandSyntax& home, const Settings& settings);
void declareHomeShow(CommandSyntax& home, const Settings& settings);
void declareHomeCheck(CommandSyntax& home);
void declarePerform(CommandSyntax& program, const Settings& settings);
void declareSync(CommandSyntax& program, const Settings& settings);
void declareRecords(CommandSyntax& program, const Settings& settings);
void declareReplay(CommandSyntax& program);
void declareDemo(CommandSyntax& program);

}  // namespace nidus
