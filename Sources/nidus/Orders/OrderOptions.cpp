#include "nidus/Orders/OrderOptions.h"

namespace nidus {

void declareFilterOptions(CommandSyntax& syntax, OrderFilter& filter) {
  syntax.option("--home", "NAME", filter.home,
                "In the home of this name; else in the primary one, or the only one");
  syntax.candidates("--home", {{CandidateKind::homes}});
  syntax.option("--room", "NAME", filter.room, "In the room of this name");
  syntax.candidates("--room", {{CandidateKind::rooms}});
  syntax.option("--zone", "NAME", filter.zone, "In the rooms of this zone");
  syntax.candidates("--zone", {{CandidateKind::zones}});
  syntax.option("--group", "NAME", filter.group, "In the service group of this name");
  syntax.candidates("--group", {{CandidateKind::groups}});
  syntax.option("--service", "NAME", filter.service, "The services of this name");
  syntax.candidates("--service", {{CandidateKind::services}});
  syntax.option("--scene", "NAME", filter.scene, "The scene of this name");
  syntax.candidates("--scene", {{CandidateKind::scenes}});
  syntax.option("--type", "TYPE", filter.type,
                "Services of this type, such as light; nidus vocabulary lists them");
  syntax.candidates("--type", {{CandidateKind::serviceTypes}});
  syntax.option("--entity", "KIND", filter.entity,
                "Objects of this kind: home, room, zone, group, service, scene or trigger; else "
                "services");
  syntax.candidates("--entity", {{CandidateKind::entityTypes}});
}

}  // namespace nidus
