#include "AssistantHost/CommandReader.h"
#include "Support/CommandText.h"
#include "Support/Finding.h"
#include "Support/Refusal.h"

// Commands: what is refused is refused well, what is read survives.

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const auto command = nidus::readCommand(nidus::textOf(data, size), "line 7");
  if (command) {
    nidus::checkCommandSurvives(**command);
  } else {
    nidus::checkRefusal(command.failure(), "line 7");
  }
  return 0;
}
