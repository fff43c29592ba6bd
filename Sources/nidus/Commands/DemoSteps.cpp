#include "nidus/Commands/DemoSteps.h"

namespace nidus {

const std::vector<DemoStep>& demoSteps() {
  static const std::vector<DemoStep> kSteps = {
      {"One of the two homes, as a tree of rooms, accessories and services",
       R"(home show "Lake Cabin")"},
      {"A read: how bright are the lights in the living room?",
       R"(get brightness --room "Living Room" --type light)"},
      {"A question: which lights are on? One cannot be asked, and is not forgotten",
       R"(get power is on --type light)"},
      {"A set, with a unit: the thermostat counts in Celsius and is told what was meant",
       R"(set temperature 70F --service Thermostat)"},
      {"A raise by 50 from 80: it stops at the limit",
       R"(raise brightness 50 --service "Kitchen Ceiling")"},
      {"A toggle", R"(toggle power --service "Desk Lamp")"},
      {"The limits of a value", R"(limits temperature --service Thermostat)"},
      {"The front door, asked for while the assistant's device is locked: two replies",
       R"(--locked set locked no --service "Front Door" --type lock)", ExitStatus::otherOutcome},
      {"The same while it is unlocked", R"(set locked no --service "Front Door" --type lock)"},
      {"A lamp that cannot be reached", R"(set power on --service "Garage Light")"},
      {"A lamp in an outlet is a light", R"(set power on --service "Window Lamp" --type light)"},
      {"A room whose name has an accent, written without it",
       R"(set brightness 40% --room "Cafe Corner" --type light)"},
      {"Both homes have a kitchen. The home decides; an object is told once for each such room",
       R"(get power --room Kitchen --home "Lake Cabin" --type light)"},
      {"A scene", R"(run Soirée)"},
      {"A room that there is not", R"(get power --room Attic)", ExitStatus::otherOutcome},
      {"Why was that? What the filter kept, step by step", R"(explain get power --room Attic)"},
  };
  return kSteps;
}

}  // namespace nidus
