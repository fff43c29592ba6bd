#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "Assistant/NDAssistantCommand.h"
#include "Load/Judge.h"
#include "Load/LoadCommand.h"
#include "Load/StressRecord.h"

namespace nidus {

/// Takes all replies of a command that is over: on the thread that lets go of its handler.
using EndHandler = std::function<void(const Replies& replies)>;

/// Performs `command` and counts it in `record`, which outlives it. Gives the command object, which
/// nobody needs to keep.
std::shared_ptr<NDAssistantCommand> perform(const LoadCommand& command, StressRecord& record,
                                            EndHandler onEnd);

/// Performs one sync with a handler of its own, pulls all of its entities and complains of what is
/// wrong. `ledger` is that of the sync; without one the homes come in time. Gives the entities that
/// were pulled.
std::vector<std::shared_ptr<const VAHAEntity>> performSync(StressRecord& record,
                                                           const std::shared_ptr<Ledger>& ledger);

}  // namespace nidus
