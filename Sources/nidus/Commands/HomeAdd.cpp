#include <memory>

#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Commands/HomeChange.h"
#include "nidus/Commands/ObjectArguments.h"
#include "nidus/HomeEditing/HomeAddition.h"

namespace nidus {
namespace {

/// What a person said about a new object; each kind uses its part of it.
struct AdditionWords {
  NewObject object;
  bool isPrimary = false;
  AccessoryPlace place;
  std::string accessory;
  ServiceWords service;
  std::vector<std::string> parts;  ///< The rooms of a zone, services of a group, scene's settings.
};

using Homes = std::vector<HomeData>;
using Addition = Result<std::string> (*)(Homes& homes, const AdditionWords& words,
                                         const HomeWording& wording);

/// Declares the command that adds an object of a kind: its argument, and what it runs.
class AdditionSyntax {
 public:
  AdditionSyntax(CommandSyntax& add, Workspace& workspace) : add_(add), workspace_(workspace) {}

  /// Declares the command; the options of the kind are declared on what it gives.
  CommandSyntax& declare(ObjectKind kind, const std::string& example, Addition addition) {
    words_ = std::make_shared<AdditionWords>();
    CommandSyntax& syntax = add_.command(wordOf(kind), "Adds " + withArticle(kind),
                                         "Example:\n  nidus home add " + example + kExitStatuses);
    syntax.requiredArgument("NAME", words_->object.name, "The name that it gets");
    if (kind != ObjectKind::home) {
      syntax.option("--home", "HOME", words_->object.home,
                    "The name or UUID of its home, where there are several");
      syntax.candidates("--home", {{CandidateKind::homes}});
    }
    syntax.run([words = words_, addition, &workspace = workspace_] {
      return changeHomes(workspace, [&](Homes& homes, const HomeWording& wording) {
        return addition(homes, *words, wording);
      });
    });
    return syntax;
  }
  /// What the command that was declared last takes.
  [[nodiscard]] AdditionWords& words() { return *words_; }

 private:
  CommandSyntax& add_;
  Workspace& workspace_;
  std::shared_ptr<AdditionWords> words_;
};

void declareSimpleKinds(AdditionSyntax& add) {
  add.declare(ObjectKind::home, "home \"Beach House\"",
              [](Homes& homes, const AdditionWords& words, const HomeWording&) {
                return addHome(homes, words.object.name, words.isPrimary);
              })
      .flag("--primary", add.words().isPrimary, "It is the primary home");
  add.declare(ObjectKind::room, "room Kitchen --home \"Beach House\"",
              [](Homes& homes, const AdditionWords& words, const HomeWording&) {
                return addRoom(homes, words.object);
              });
  add.declare(ObjectKind::trigger, "trigger \"At sunset\"",
              [](Homes& homes, const AdditionWords& words, const HomeWording&) {
                return addTrigger(homes, words.object);
              });
}

void declareZone(AdditionSyntax& add) {
  CommandSyntax& zone =
      add.declare(ObjectKind::zone, "zone Downstairs --room Kitchen --room Hall",
                  [](Homes& homes, const AdditionWords& words, const HomeWording&) {
                    return addZone(homes, words.object, words.parts);
                  });
  zone.repeatedOption("--room", "ROOM", add.words().parts, "A room of the zone; may be repeated");
  zone.candidates("--room", {{CandidateKind::rooms}});
}

void declareAccessory(AdditionSyntax& add) {
  CommandSyntax& accessory =
      add.declare(ObjectKind::accessory, "accessory \"Floor lamp\" --room Study",
                  [](Homes& homes, const AdditionWords& words, const HomeWording&) {
                    return addAccessory(homes, words.object, words.place);
                  });
  accessory.option("--room", "ROOM", add.words().place.room, "Where it stands; else in no room");
  accessory.candidates("--room", {{CandidateKind::rooms}});
  accessory.flag("--requires-unlock", add.words().place.requiresUnlock,
                 "It obeys only while the device is unlocked");
}

void declareService(AdditionSyntax& add) {
  CommandSyntax& service = add.declare(
      ObjectKind::service,
      "service Lamp --accessory \"Floor lamp\" --type light --attribute power \\\n"
      "    --attribute brightness\n\n"
      "nidus vocabulary lists the types and attributes. Format, unit and limits of an attribute\n"
      "are the usual ones; nidus home edit changes them.",
      [](Homes& homes, const AdditionWords& words, const HomeWording& wording) {
        ServiceWords named = words.service;
        named.name = words.object.name;
        return addService(homes, {ObjectKind::accessory, words.accessory, words.object.home}, named,
                          wording.vocabulary);
      });
  AdditionWords& words = add.words();
  service.requiredOption("--accessory", "ACCESSORY", words.accessory, "What it is a service of");
  service.requiredOption("--type", "TYPE", words.service.type, "What it is, such as light");
  service.option("--as", "TYPE", words.service.associatedType,
                 "What it is used as, such as light for an outlet with a lamp");
  service.repeatedOption("--attribute", "ATTRIBUTE", words.service.attributes,
                         "What it has, such as brightness; may be repeated");
  service.candidates("--type", {{CandidateKind::serviceTypes}});
  service.candidates("--as", {{CandidateKind::serviceTypes}});
  service.candidates("--attribute", {{CandidateKind::attributes}});
}

void declareGroup(AdditionSyntax& add) {
  CommandSyntax& group =
      add.declare(ObjectKind::group, "group \"Reading corner\" --service \"Floor lamp/Lamp\"",
                  [](Homes& homes, const AdditionWords& words, const HomeWording&) {
                    return addGroup(homes, words.object, words.parts);
                  });
  group.repeatedOption("--service", "SERVICE", add.words().parts,
                       "A service of the group, or ACCESSORY/SERVICE; may be repeated");
  group.candidates("--service", {{CandidateKind::services}});
}

void declareScene(AdditionSyntax& add) {
  CommandSyntax& scene = add.declare(
      ObjectKind::scene,
      "scene \"Movie night\" --set \"Floor lamp/Lamp brightness 20%\" \\\n"
      "    --set \"Ceiling lamp power off\"",
      [](Homes& homes, const AdditionWords& words, const HomeWording& wording) {
        return addScene(homes, words.object, words.parts, wording.vocabulary, wording.isMetric);
      });
  scene.repeatedOption("--set", "SETTING", add.words().parts,
                       "A service, an attribute and a value; may be repeated");
}

}  // namespace

void declareHomeAdd(CommandSyntax& home, Workspace& workspace) {
  CommandSyntax& syntax =
      home.command("add", "Adds a home, a room or any other object",
                   std::string("Each kind has a help of its own.\n\n"
                               "Examples:\n"
                               "  nidus home add home \"Beach House\"\n"
                               "  nidus home add room Study\n"
                               "  nidus home add accessory \"Floor lamp\" --room Study") +
                       kExitStatuses);
  AdditionSyntax add(syntax, workspace);
  declareSimpleKinds(add);
  declareZone(add);
  declareAccessory(add);
  declareService(add);
  declareGroup(add);
  declareScene(add);
}

}  // namespace nidus
