#include "AssistantHost/ScenarioSteps.h"

#include <utility>

#include "AssistantHost/JsonChoice.h"

namespace nidus {
namespace {

NDString optionalText(JsonObject& object, std::string_view key) {
  const auto text = object.optional(key);
  return text ? NDString(text->text()) : NDString();
}

ScenarioStep recordsStep(const JsonPlaced& placed) {
  JsonObject(placed).refuseUnknownKeys();
  return RecordsStep();
}

ScenarioStep performStep(const JsonPlaced& placed) { return PerformStep{commandFromJson(placed)}; }

std::vector<NDString> anchorsFromJson(const JsonPlaced& placed) {
  std::vector<NDString> anchors;
  for (const JsonPlaced& anchor : placed.array()) {
    anchors.push_back(anchor.isNull() ? NDString() : NDString(anchor.text()));
  }
  return anchors;
}

ScenarioStep syncStep(const JsonPlaced& placed) {
  SyncStep step;
  JsonObject object(placed);
  step.key = object.required("key").text();
  step.anchor = optionalText(object, "anchor");
  step.validity = optionalText(object, "validity");
  if (const auto after = object.optional("after")) step.after = anchorsFromJson(*after);
  object.refuseUnknownKeys();
  return step;
}

ScenarioStep setStep(const JsonPlaced& placed) {
  SetStep step;
  JsonObject object(placed);
  step.locked = optionalBoolean(object, "locked");
  step.silent = optionalBoolean(object, "silent");
  step.preferences = preferencesFromJson(object);
  object.refuseUnknownKeys();
  return step;
}

ScenarioStep exportStep(const JsonPlaced& placed) {
  JsonObject(placed).refuseUnknownKeys();
  return ExportStep();
}

struct StepKind {
  std::string_view key;
  ScenarioStep (*read)(const JsonPlaced&);
};

constexpr StepKind kStepKinds[] = {
    {"records", recordsStep}, {"perform", performStep}, {"sync", syncStep},
    {"set", setStep},         {"export", exportStep},
};

}  // namespace

std::optional<bool> optionalBoolean(JsonObject& object, std::string_view key) {
  const auto boolean = object.optional(key);
  return boolean ? std::optional(boolean->boolean()) : std::nullopt;
}

std::optional<PreferenceChanges> preferencesFromJson(JsonObject& object) {
  const auto placed = object.optional("preferences");
  if (!placed) return std::nullopt;
  const auto* members = std::get_if<JsonValue::Object>(&placed->value().content);
  if (!members) placed->fail("expected an object");
  return PreferenceChanges(members->begin(), members->end());
}

ScenarioStep stepFromJson(const JsonPlaced& placed) {
  std::vector<std::string_view> keys;
  for (const StepKind& kind : kStepKinds) keys.push_back(kind.key);
  const std::string_view chosen = chosenKey(placed, keys);
  JsonObject object(placed);
  const JsonPlaced content = object.required(chosen);
  object.refuseUnknownKeys();
  for (const StepKind& kind : kStepKinds) {
    if (kind.key == chosen) return kind.read(content);
  }
  placed.fail("no such step");
}

}  // namespace nidus
