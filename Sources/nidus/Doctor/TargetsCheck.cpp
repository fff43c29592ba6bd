#include <algorithm>
#include <string>
#include <unordered_set>
#include <vector>

#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {
namespace {

NDUUID accessoryOf(const ServiceAddress& address) { return address.accessory; }
NDUUID accessoryOf(const SceneActionData& action) { return action.target.accessory; }

/// What is said of a kind of object.
struct Words {
  const char* kind;
  const char* isEmpty;
  const char* fill;  ///< What to do when it is empty.
};

constexpr Words kGroupWords = {"group", "it has no services: an order for it finds nothing",
                               "nidus home move service SERVICE --to-group GROUP"};
constexpr Words kSceneWords = {"scene", "it has no actions: to run it does nothing",
                               "give it some with nidus home edit"};

/// Looks at the groups and scenes of one home.
class TargetLook {
 public:
  TargetLook(const HomeData& home, Findings& findings) : home_(home), findings_(findings) {
    for (const AccessoryData& accessory : home.accessories) {
      if (accessory.reachable) reachable_.insert(accessory.uuid);
    }
  }

  void take() {
    for (const ServiceGroupData& group : home_.serviceGroups) {
      check(group, group.services, kGroupWords);
    }
    for (const ActionSetData& scene : home_.actionSets) {
      check(scene, scene.actions, kSceneWords);
    }
  }

 private:
  template <class Object, class Target>
  void check(const Object& object, const std::vector<Target>& targets, const Words& words) {
    if (targets.empty()) {
      return add(
          object.name, words.isEmpty,
          std::string(words.fill) + ", or nidus home remove " + words.kind + ' ' + wordsOf(object));
    }
    const bool isReached = std::any_of(targets.begin(), targets.end(), [this](const auto& target) {
      return reachable_.count(accessoryOf(target)) > 0;
    });
    if (isReached) return;
    add(object.name, std::string("no accessory of the ") + words.kind + " can be reached",
        "see to these accessories, which are listed below");
  }

  void add(const NDString& name, std::string message, std::string remedy) {
    findings_.push_back({Severity::attention, home_.name.str() + " / " + name.str(),
                         std::move(message), std::move(remedy)});
  }

  const HomeData& home_;
  Findings& findings_;
  std::unordered_set<NDUUID> reachable_;
};

}  // namespace

void checkTargets(const Examination& examination, Findings& findings) {
  for (const HomeData& home : *examination.homes) TargetLook(home, findings).take();
}

}  // namespace nidus
