#include "nidus/Commands/HomeChange.h"

#include <optional>

#include "HomePlatform/System/OneLine.h"
#include "nidus/InterruptionHold.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {

ExitStatus changeHomes(Workspace& workspace, const ChangeOfHomes& change) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  HomePlatform& platform = (*session)->platform();
  const HomeWording wording{platform.vocabulary(),
                            platform.locale()->usesMetricSystem().value_or(false)};
  std::string sentence;
  std::optional<InterruptionHold> hold;
  const auto failure = platform.editHomes([&](std::vector<HomeData>& homes) {
    hold.emplace();  // until the change is lasting and the preferences suit it
    const auto done = change(homes, wording);
    if (!done) return Status(done.failure());
    sentence = *done;
    return Status();
  });
  return failure ? report(*failure) : printText(onOneLine(sentence) + '\n');
}

}  // namespace nidus
