#include "AssistantHost/Scenario.h"

#include <utility>

#include "AssistantHost/InputFile.h"
#include "AssistantHost/JsonChoice.h"
#include "HomePlatform/Json/JsonObject.h"
#include "HomePlatform/Store/HomeDocument.h"

namespace nidus {
namespace {

constexpr std::string_view kFormat = "nidus-scenario/1";

NDString optionalText(JsonObject& object, std::string_view key) {
  const auto text = object.optional(key);
  return text ? NDString(text->text()) : NDString();
}

std::optional<bool> optionalBoolean(JsonObject& object, std::string_view key) {
  const auto boolean = object.optional(key);
  return boolean ? std::optional(boolean->boolean()) : std::nullopt;
}

std::optional<PreferenceChanges> optionalPreferences(JsonObject& object) {
  const auto placed = object.optional("preferences");
  if (!placed) return std::nullopt;
  const auto* members = std::get_if<JsonValue::Object>(&placed->value().content);
  if (!members) placed->fail("expected an object");
  return PreferenceChanges(members->begin(), members->end());
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
  step.preferences = optionalPreferences(object);
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

/// A scenario and, when its homes stand in another file, that file's name.
struct ReadScenario {
  Scenario scenario;
  std::optional<std::string> homeFile;
};

void readHomes(JsonObject& object, ReadScenario& read) {
  const auto home = object.optional("home");
  const auto homeFile = object.optional("homeFile");
  if (home.has_value() == homeFile.has_value()) {
    object.placed().fail("expected exactly one of the keys \"home\", \"homeFile\"");
  }
  if (home) read.scenario.homes = homesFromJson(*home);
  if (homeFile) read.homeFile = homeFile->text();
}

ReadScenario scenarioFromJson(const JsonPlaced& document) {
  ReadScenario read;
  Scenario& scenario = read.scenario;
  JsonObject object(document);
  const JsonPlaced format = object.required("format");
  if (format.text() != kFormat) format.fail("expected \"" + std::string(kFormat) + '"');
  scenario.preferences = optionalPreferences(object).value_or(PreferenceChanges());
  scenario.internalBuild = optionalBoolean(object, "internalBuild").value_or(false);
  scenario.metric = optionalBoolean(object, "metric").value_or(true);
  scenario.locked = optionalBoolean(object, "locked").value_or(false);
  readHomes(object, read);
  for (const JsonPlaced& step : object.required("steps").array()) {
    scenario.steps.push_back(stepFromJson(step));
  }
  object.refuseUnknownKeys();
  return read;
}

Result<ReadScenario> readScenarioFile(const std::filesystem::path& file) {
  auto in = openInput(file);
  if (!in) return in.failure();
  const auto text = readAll(*in, file.string());
  if (!text) return text.failure();
  try {
    const JsonValue document = parseJson(*text);
    return scenarioFromJson(JsonPlaced(document, ""));
  } catch (const JsonError& error) {
    return failureOf(error, file.string());
  }
}

Result<std::vector<HomeData>> readHomeFile(const std::filesystem::path& file) {
  auto in = openInput(file);
  if (!in) return in.failure();
  return readHomeDocument(*in, file.string());
}

}  // namespace

Result<Scenario> readScenario(const std::filesystem::path& file) {
  auto read = readScenarioFile(file);
  if (!read) return read.failure();
  if (read->homeFile) {
    auto homes = readHomeFile(file.parent_path() / *read->homeFile);
    if (!homes) return homes.failure();
    read->scenario.homes = std::move(*homes);
  }
  return std::move(read->scenario);
}

}  // namespace nidus
