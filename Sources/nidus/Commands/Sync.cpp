#include "AssistantHost/JsonLine.h"
#include "AssistantHost/SyncClient.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

std::string resetLine(const NDString& validity) {
  NDDictionary reset;
  reset.set("reset", NDDictionaryValue(validity));
  return jsonLine(reset);
}

std::string changeLine(const SyncChange& change) {
  NDDictionary line;
  line.set("object", entityValue(change.object));
  line.set("postAnchor", NDDictionaryValue(change.postAnchor));
  return jsonLine(line);
}

ExitStatus synchronise(Workspace& workspace) {
  const auto session = workspace.assistant();
  if (!session) return report(session.failure());
  const auto made = SyncClient::make((*session)->module());
  if (!made) return report(made.failure());
  SyncClient& sync = **made;
  sync.begin(kSyncKey);
  const auto resets = sync.resets();
  if (resets.empty()) {
    reportLine("the plug-in did not answer the sync in time; try again");
    return ExitStatus::noReply;
  }
  std::string lines = resetLine(resets.front());
  for (const SyncChange& change : sync.allChanges()) {
    if (change.object) lines += changeLine(change);
  }
  sync.end();
  return (*session)->statusAfter(printText(lines));
}

}  // namespace

void declareSync(CommandSyntax& program, Workspace& workspace) {
  CommandSyntax& syntax = program.command(
      "sync", "Prints the names that the assistant learns",
      "JSON lines: first the reset with its validity, then one entity a line with its anchor.\n\n"
      "Example:\n  nidus sync\n\n"
      "Exit status: 0 success, 2 bad input, 3 no reply, 4 the platform failed.");
  syntax.run([&workspace] { return synchronise(workspace); });
}

}  // namespace nidus
