#include "Load/OwnRoom.h"

#include <set>
#include <utility>
#include <variant>

#include "Load/LoadHome.h"
#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

using Aim = LoadCommand::Aim;

constexpr std::size_t kHome = 0;
constexpr std::size_t kLamp = 1;
constexpr std::int64_t kStep = 5;

std::optional<std::int64_t> integerOf(const NDDictionary& result) {
  const NDDictionaryValue* value = result.find("resultValue");
  const auto* form = value ? std::get_if<NDDictionary>(&value->content()) : nullptr;
  const NDDictionaryValue* number = form ? form->find("integer") : nullptr;
  const auto* integer = number ? std::get_if<std::int64_t>(&number->content()) : nullptr;
  return integer ? std::optional(*integer) : std::nullopt;
}

}  // namespace

const std::array<OwnRoom::Step, 8> OwnRoom::kSteps = {
    &OwnRoom::readRoom,        &OwnRoom::writeLamp, &OwnRoom::raiseLamp,   &OwnRoom::toggleLocked,
    &OwnRoom::readUnreachable, &OwnRoom::runScene,  &OwnRoom::nameNothing, &OwnRoom::askUnknown};

OwnRoom::OwnRoom(std::size_t room, StressRecord& record, Perform perform, Epoch epoch)
    : room_(room), record_(record), perform_(std::move(perform)), epoch_(std::move(epoch)) {}

void OwnRoom::step() { (this->*kSteps.at(steps_++ % kSteps.size()))(); }

std::optional<std::int64_t> OwnRoom::level() const {
  const bool isKnown = levelEpoch_ && levelEpoch_ == epoch_();
  return isKnown ? std::optional(level_) : std::nullopt;
}

void OwnRoom::expect(bool holds, const std::string& what) const {
  record_.expect(holds, what, roomName(kHome, room_).str());
}

Replies OwnRoom::perform(LoadCommand command) const {
  command.home = homeName(kHome);
  return perform_(command);
}

void OwnRoom::expectOne(const Replies& replies, std::string_view outcome, std::size_t results,
                        const std::string& what) const {
  expect(replies.size() == 1, what + ": number of replies");
  if (replies.size() != 1) return;
  expect(textOf(replies.front(), "commandOutcome") == outcome, what + ": outcome");
  expect(resultsOf(replies.front()).size() == results, what + ": number of results");
}

/// The value is known as long as nobody has taken it back since it was written.
void OwnRoom::expectLevel(const Replies& replies, const std::string& what) {
  expectOne(replies, VAHACommandOutcomeCOMMAND_SUCCESSValue, 1, what);
  const auto results = replies.empty() ? std::vector<NDDictionary>() : resultsOf(replies.front());
  if (results.size() != 1) return;
  const auto told = integerOf(results.front());
  if (level()) expect(told == level_, what + ": value");
}

void OwnRoom::readRoom() {
  const Replies replies = perform({.aim = Aim::read,
                                   .room = roomName(kHome, room_),
                                   .actionType = VAHAActionTypeGETValue,
                                   .attribute = "BRIGHTNESS"});
  // The unlock, and what was read before the locked lamp.
  std::multiset<std::string> outcomes;
  for (const auto& reply : replies) outcomes.insert(textOf(reply, "commandOutcome").str());
  expect(outcomes == std::multiset<std::string>{"COMMAND_SUCCESS", "REQUIRES_UNLOCK"},
         "read of a room with a locked lamp: outcomes");
}

void OwnRoom::writeLamp() {
  levelEpoch_ = epoch_();
  level_ = static_cast<std::int64_t>(steps_ % 60);
  expectLevel(perform({.aim = Aim::write,
                       .service = lampName(kHome, room_, kLamp),
                       .actionType = VAHAActionTypeSETValue,
                       .attribute = "BRIGHTNESS",
                       .value = nidus::integerOf(level_)}),
              "write");
}

void OwnRoom::raiseLamp() {
  level_ += kStep;
  expectLevel(perform({.aim = Aim::update,
                       .service = lampName(kHome, room_, kLamp),
                       .actionType = VAHAActionTypeINCREASEValue,
                       .attribute = "BRIGHTNESS"}),
              "raise");
}

void OwnRoom::toggleLocked() {
  expectOne(perform({.aim = Aim::update,
                     .service = lockedLampName(kHome, room_),
                     .actionType = VAHAActionTypeTOGGLEValue,
                     .attribute = "POWER"}),
            VAHACommandOutcomeREQUIRES_UNLOCKValue, 0, "toggle of a locked lamp");
}

void OwnRoom::readUnreachable() {
  const Replies replies = perform({.aim = Aim::read,
                                   .service = unreachableLampName(kHome, room_),
                                   .actionType = VAHAActionTypeGETValue,
                                   .attribute = "POWER"});
  expectOne(replies, VAHACommandOutcomeCOMMAND_SUCCESSValue, 1, "unreachable");
  for (const auto& result : replies.empty() ? Replies() : resultsOf(replies.front())) {
    expect(textOf(result, "outcome") == VAHAActionOutcomeUNREACHABLEValue,
           "unreachable: outcome of the object");
  }
}

void OwnRoom::runScene() {
  expectOne(perform({.aim = Aim::scene,
                     .scene = sceneName(kHome, room_),
                     .actionType = VAHAActionTypeSETValue,
                     .attribute = VAHAAttributeENABLEDValue,
                     .value = booleanOf(true)}),
            VAHACommandOutcomeCOMMAND_SUCCESSValue, 1, "scene");
}

void OwnRoom::nameNothing() {
  expectOne(perform({.aim = Aim::read,
                     .service = "Nothing",
                     .actionType = VAHAActionTypeGETValue,
                     .attribute = "POWER"}),
            VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue, 0, "no match");
}

void OwnRoom::askUnknown() {
  expectOne(perform({.aim = Aim::refuse,
                     .service = lampName(kHome, room_, kLamp),
                     .actionType = "FLY",
                     .attribute = "POWER"}),
            VAHACommandOutcomeCOMMAND_FAILUREValue, 0, "unknown action");
}

}  // namespace nidus
