#include "AssistantHost/Scenario.h"

#include <utility>

#include "AssistantHost/InputFile.h"
#include "AssistantHost/ScenarioSteps.h"
#include "HomePlatform/Json/JsonBuilder.h"
#include "HomePlatform/Json/JsonReader.h"
#include "HomePlatform/Store/HomeDocument.h"

namespace nidus {
namespace {

constexpr std::string_view kFormat = "nidus-scenario/1";

void checkFormat(const JsonPlaced& format) {
  if (format.text() != kFormat) format.fail("expected \"" + std::string(kFormat) + '"');
}

/// A scenario and, when its homes stand in another file, that file's name.
struct ReadScenario {
  Scenario scenario;
  std::optional<std::string> homeFile;
};

/// Takes a scenario apart while it is read, so that it never stands in memory as a tree: its homes
/// go to a reader of their own, its steps are read one by one.
class ScenarioEvents final : public JsonEvents {
 public:
  void scalar(JsonValue value, const JsonPath& path) override {
    const bool isNull = std::holds_alternative<std::nullptr_t>(value.content);
    if (isHome(path) && !isNull) failHome(path);
    if (isMember(path) && key_ == "format") checkFormat(JsonPlaced(value, path.place()));
    receiver(path).scalar(std::move(value), path);
    endValue(path);
  }

  void beginObject(const JsonPath& path) override {
    if (isHome(path)) homes_ = makeHomeDocumentEvents(read_.scenario.homes);
    if (isSteps(path)) throw JsonError{path.place(), "expected an array"};
    receiver(path).beginObject(path);
  }

  void key(std::string_view key, const JsonPath& path) override {
    if (isMember(path)) key_ = key;
    receiver(path).key(key, path);
  }

  void endObject(const JsonPath& path) override {
    receiver(path).endObject(path);
    endValue(path);
  }

  void beginArray(const JsonPath& path) override {
    if (isHome(path)) failHome(path);
    receiver(path).beginArray(path);
  }

  void endArray(const JsonPath& path) override {
    receiver(path).endArray(path);
    endValue(path);
  }

  /// What has been read, once all of it has.
  [[nodiscard]] ReadScenario finish() {
    const JsonValue value = rest_.take();
    JsonObject object(JsonPlaced(value, ""));
    checkFormat(object.required("format"));
    Scenario& scenario = read_.scenario;
    scenario.preferences = preferencesFromJson(object).value_or(PreferenceChanges());
    scenario.internalBuild = optionalBoolean(object, "internalBuild").value_or(false);
    scenario.metric = optionalBoolean(object, "metric").value_or(true);
    scenario.locked = optionalBoolean(object, "locked").value_or(false);
    finishHomes(object);
    (void)object.required("steps").array();
    object.refuseUnknownKeys();
    return std::move(read_);
  }

 private:
  /// Whether the value at `path` is the whole scenario's own.
  static bool isMember(const JsonPath& path) { return path.depth() == 1; }
  [[nodiscard]] bool isHome(const JsonPath& path) const { return isMember(path) && key_ == "home"; }
  [[nodiscard]] bool isSteps(const JsonPath& path) const {
    return isMember(path) && key_ == "steps";
  }
  [[nodiscard]] bool isWithinSteps(const JsonPath& path) const {
    return path.depth() > 1 && key_ == "steps";
  }
  [[nodiscard]] bool isWithinHomes(const JsonPath& path) const {
    return path.depth() > 0 && key_ == "home" && homes_;
  }

  [[noreturn]] static void failHome(const JsonPath& path) {
    throw JsonError{path.place(), "expected an object"};
  }

  JsonEvents& receiver(const JsonPath& path) {
    if (isWithinSteps(path)) return steps_;
    return isWithinHomes(path) ? *homes_ : rest_;
  }

  void endValue(const JsonPath& path) {
    constexpr std::size_t kDepthOfStep = 2;
    if (!isWithinSteps(path) || path.depth() != kDepthOfStep) return;
    const JsonValue value = steps_.take();
    read_.scenario.steps.push_back(stepFromJson(JsonPlaced(value, path.place())));
  }

  void finishHomes(JsonObject& object) {
    object.allow("home");
    const auto homeFile = object.optional("homeFile");
    if ((homes_ != nullptr) == homeFile.has_value()) {
      object.placed().fail("expected exactly one of the keys \"home\", \"homeFile\"");
    }
    if (homeFile) read_.homeFile = homeFile->text();
  }

  ReadScenario read_;
  std::string key_;                    ///< The key of the scenario whose value is read.
  std::unique_ptr<JsonEvents> homes_;  ///< Once there are homes.
  JsonBuilder steps_{kScenarioLimits.valuesInMemory};
  JsonBuilder rest_{kScenarioLimits.valuesInMemory};
};

Result<ReadScenario> readScenarioFile(const std::filesystem::path& file) {
  auto in = openInput(file);
  if (!in) return in.failure();
  try {
    ScenarioEvents events;
    readJson(*in, events, kScenarioLimits);
    return events.finish();
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
