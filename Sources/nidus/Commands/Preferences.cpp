#include <memory>
#include <utility>

#include "HomePlatform/Json/JsonText.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Preferences/PreferenceReport.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

struct PreferenceInput {
  std::string key;
  std::string value;
  bool isJson = false;
};

/// What the plug-in reads from the preferences of `session`, whose module is open.
Result<NDLogThreshold> thresholdOf(const Session& session) {
  NDLogThreshold threshold;
  std::string message;
  if (session.module().readLogThreshold(threshold, message)) return threshold;
  return Failure{Failure::Kind::platform, message};
}

/// Reports on preferences of the homes that a workspace has.
class PreferenceReader {
 public:
  [[nodiscard]] static Result<PreferenceReader> open(Workspace& workspace) {
    const auto session = workspace.assistant();
    if (!session) return session.failure();
    const auto threshold = thresholdOf(**session);
    if (!threshold) return threshold.failure();
    return PreferenceReader((*session)->platform(), *threshold);
  }

  [[nodiscard]] std::vector<PreferenceReport> all() const {
    std::vector<PreferenceReport> reports;
    for (const PreferenceKey& key : preferenceKeys()) {
      reports.push_back(reportOn(key, platform_, threshold_));
    }
    for (const auto& [name, value] : platform_.preferenceValues()) {
      if (!findPreferenceKey(name)) reports.push_back(reportOnUnread(name, value));
    }
    return reports;
  }

  [[nodiscard]] Result<PreferenceReport> one(const std::string& name) const {
    for (PreferenceReport& report : all()) {
      if (report.name == name) return std::move(report);
    }
    return unknownPreference(name);
  }

  [[nodiscard]] const NDLogThreshold& threshold() const { return threshold_; }

 private:
  PreferenceReader(HomePlatform& platform, const NDLogThreshold& threshold)
      : platform_(platform), threshold_(threshold) {}

  HomePlatform& platform_;
  NDLogThreshold threshold_;
};

std::string lineOf(const JsonValue& value) {
  std::string line;
  appendJson(line, value);
  return line + '\n';
}

ExitStatus listPreferences(const PreferenceInput& input, Workspace& workspace) {
  const auto reader = PreferenceReader::open(workspace);
  if (!reader) return report(reader.failure());
  std::string text;
  JsonValue::Array list;
  for (const PreferenceReport& each : reader->all()) {
    if (!text.empty()) text += '\n';
    text += textOf(each);
    list.push_back(jsonOf(each));
  }
  if (!input.isJson) return printText(text);
  return printText(lineOf({JsonValue::Object{{"preferences", {std::move(list)}},
                                             {"logThreshold", jsonOf(reader->threshold())}}}));
}

ExitStatus getPreference(const PreferenceInput& input, Workspace& workspace) {
  const auto reader = PreferenceReader::open(workspace);
  if (!reader) return report(reader.failure());
  const auto found = reader->one(input.key);
  if (!found) return report(found.failure());
  return printText(input.isJson ? lineOf(jsonOf(*found)) : textOf(*found));
}

/// Changes a preference and tells what came of it.
ExitStatus change(const std::string& key, const JsonValue& value, Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  if (auto failure = (*session)->platform().changePreferences({{key, value}})) {
    return report(*failure);
  }
  if (!findPreferenceKey(key)) return printText(key + ": not set\n");
  return getPreference({key, "", false}, workspace);
}

ExitStatus setPreference(const PreferenceInput& input, Workspace& workspace) {
  const PreferenceKey* key = findPreferenceKey(input.key);
  if (!key) return report(unknownPreference(input.key));
  const auto value = readPreference(*key, input.value);
  return value ? change(input.key, *value, workspace) : report(value.failure());
}

/// Also removes what stands in the file although nothing reads it.
ExitStatus unsetPreference(const PreferenceInput& input, Workspace& workspace) {
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  const bool isThere = (*session)->platform().preferenceValues().count(input.key) > 0;
  if (!isThere && !findPreferenceKey(input.key)) return report(unknownPreference(input.key));
  return change(input.key, JsonValue(), workspace);
}

/// Declares the commands below `nidus preferences`.
class PreferenceCommands {
 public:
  PreferenceCommands(CommandSyntax& preferences, Workspace& workspace)
      : preferences_(preferences), workspace_(workspace) {}

  void declareAll() const {
    Below list = declare("list", "Lists all preferences with what they do now",
                         "Example: nidus preferences list", listPreferences);
    list.syntax.flag("--json", list.input.isJson, "Print one JSON object");
    Below get = declare("get", "Tells one preference and what it does now",
                        "Example: nidus preferences get NidusLogLevel", getPreference);
    declareKey(get);
    get.syntax.flag("--json", get.input.isJson, "Print one JSON object");
    Below set = declare("set", "Sets a preference",
                        "Example: log everything\n  nidus preferences set NidusLogLevel debug",
                        setPreference);
    declareKey(set);
    set.syntax.requiredArgument("VALUE", set.input.value,
                                "true or false (or yes, no); a log level or its name");
    Below unset = declare("unset", "Removes a preference, so that its default counts",
                          "Example: nidus preferences unset NidusLogLevel", unsetPreference);
    declareKey(unset);
  }

 private:
  using Action = ExitStatus (*)(const PreferenceInput&, Workspace&);
  struct Below {
    CommandSyntax& syntax;
    PreferenceInput& input;
  };

  [[nodiscard]] Below declare(const char* name, const char* help, const char* details,
                              Action action) const {
    const auto input = std::make_shared<PreferenceInput>();
    CommandSyntax& syntax = preferences_.command(name, help, std::string(details) + kExitStatuses);
    syntax.run([input, action, &workspace = workspace_] { return action(*input, workspace); });
    return {syntax, *input};
  }

  static void declareKey(const Below& below) {
    std::vector<std::string> names;
    for (const PreferenceKey& key : preferenceKeys()) names.emplace_back(key.name);
    below.syntax.requiredArgument("KEY", below.input.key, "The preference");
    below.syntax.candidates("KEY", {Candidates(std::move(names))});
  }

  CommandSyntax& preferences_;
  Workspace& workspace_;
};

}  // namespace

void declarePreferences(CommandSyntax& program, Workspace& workspace) {
  CommandSyntax& preferences = program.command(
      "preferences", "Shows and changes preferences, and says what each one does now",
      std::string(
          "They are kept in preferences.json in the data folder. Programs that run hear of a "
          "change.\n\nExample:\n  nidus preferences list") +
          kExitStatuses);
  PreferenceCommands(preferences, workspace).declareAll();
}

}  // namespace nidus
