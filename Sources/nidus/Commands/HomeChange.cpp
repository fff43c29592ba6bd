#include "nidus/Commands/HomeChange.h"

#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {

ExitStatus changeHomes(Workspace& workspace, const HomeChange& change) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  HomePlatform& platform = (*session)->platform();
  std::string sentence;
  const auto failure = platform.editHomes([&](std::vector<HomeData>& homes) {
    const auto done = change(homes, platform.vocabulary());
    if (!done) return Status(done.failure());
    sentence = *done;
    return Status();
  });
  return failure ? report(*failure) : printText(onOneLine(sentence) + '\n');
}

}  // namespace nidus
