#pragma once

#include <memory>
#include <string>
#include <vector>

#include "AssistantHost/CommandReader.h"
#include "HomePlatform/PlatformCall.h"
#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// One step of a command's filter and the records that it left.
struct FilterStep {
  std::string name;
  NDDictionaryList kept;
};

/// What could be seen of one command from outside, and the homes around it.
struct Performance {
  CommandRef command;
  bool isLocked = false;
  std::vector<HomeData> before;
  std::vector<HomeData> after;
  std::vector<FilterStep> steps;
  /// What the last look for characteristics has found.
  std::vector<std::shared_ptr<NDCharacteristic>> reached;
  std::vector<PlatformCall> calls;    ///< In the order in which they were made.
  std::vector<NDDictionary> replies;  ///< In the order in which they came.
  bool isHandlerReleased = false;     ///< Whether nobody can reply any more.
};

}  // namespace nidus
