#pragma once

#include <memory>
#include <optional>
#include <utility>

#include "HomePlatform/Result.h"
#include "nidus/Session.h"
#include "nidus/Settings.h"

namespace nidus {

/// What the commands of one process share: what was asked for on the command line, and the session,
/// which is opened when a command first needs it and then kept.
///
/// Used by the main thread alone.
///
///     const auto session = workspace.assistant();
///     if (!session) return report(session.failure());
///     (*session)->runner().perform(**command);
class Workspace {
 public:
  Workspace() = default;
  /// Works on the platform of these options, whatever folder the settings name.
  explicit Workspace(HomePlatformOptions options) : options_(std::move(options)) {}

  /// What was asked for; read when a command runs.
  [[nodiscard]] Settings& settings() noexcept { return settings_; }
  [[nodiscard]] const Settings& settings() const noexcept { return settings_; }

  /// The session with its platform; never null, valid as long as this. The device is locked or not
  /// as the settings say now.
  [[nodiscard]] Result<Session*> home();
  /// The same with the plug-in's module open.
  [[nodiscard]] Result<Session*> assistant();
  /// Ends the session, so that another platform can be registered; the next use opens a new one.
  void close() { session_.reset(); }

 private:
  [[nodiscard]] Result<HomePlatformOptions> options() const;

  const std::optional<HomePlatformOptions> options_;
  Settings settings_;
  std::unique_ptr<Session> session_;
};

}  // namespace nidus
