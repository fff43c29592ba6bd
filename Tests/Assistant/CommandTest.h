#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Assistant/CommandRequest.h"
#include "Assistant/NDAssistantCommand.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Support/HomeBuilder.h"
#include "Support/TestHome.h"
#include "Support/TestPlatform.h"

namespace nidus {

/// What a command replied on one line: "COMMAND_SUCCESS; Lamp SUCCESS POWER=true".
using ReplyTexts = std::vector<std::string>;

/// Performs commands on test homes, on the calling thread, and keeps what they reply and log. The
/// locale is metric, the homes are configured, levels up to 6 are logged.
class CommandTest : public ::testing::Test {
 protected:
  CommandTest();
  ~CommandTest() override;

  /// The homes that commands find from now on.
  void useHomes(const std::vector<std::shared_ptr<TestHome>>& homes);
  /// The one home that commands find from now on.
  std::shared_ptr<TestHome> useHome(HomeBuilder& builder);
  std::shared_ptr<TestHome> useHome(HomeBuilder&& builder) { return useHome(builder); }

  void configureHomes(bool areConfigured);
  /// Homes are not reported any more.
  void silencePlatform();
  void setReporting(TestPlatform::Reporting reporting);
  void setLocale(std::optional<bool> isMetric);
  void logLevel(int level);

  /// Performs a command, to its end or until nothing moves any more.
  void perform(std::shared_ptr<NDAssistantCommand> command);
  /// The same; gives the command, with its snapshot, and forgets the replies and the log.
  std::shared_ptr<NDAssistantCommand> performed(std::shared_ptr<NDAssistantCommand> command);
  /// Hands the services of all homes and the action to the handler of the action's type.
  void actInAllHomes(const Action& action);

  /// A handler whose replies are kept.
  [[nodiscard]] VAHAReplyHandler handler();
  /// Is called within each reply.
  void onReply(std::function<void()> callback);
  /// Whether all handlers given out so far have been destroyed.
  [[nodiscard]] bool isHandlerReleased() const;
  [[nodiscard]] ReplyTexts replies() const;
  [[nodiscard]] NDDictionary lastReply() const;
  void clearReplies();

  void runUntilIdle();
  /// Runs one piece of work of the main queue; false when there was none.
  bool runOneOfMainQueue();

  /// The messages in order, each behind its level, such as "4 Filtered object …".
  [[nodiscard]] std::vector<std::string> log() const;
  /// Those of one level.
  [[nodiscard]] std::vector<std::string> log(int level) const;
  void clearLog();

  /// The batches that a home was asked to read.
  [[nodiscard]] static std::vector<NDAssistantCommand::CharacteristicList> batchesRead(
      const TestHome& home);
  /// What was written to a home, each as "Lamp=45".
  [[nodiscard]] static std::vector<std::string> written(const TestHome& home);
  /// One field of the entities of a reply.
  [[nodiscard]] static std::vector<std::string> entityTexts(const NDDictionary& reply,
                                                            std::string_view key);

  /// Runs `body` in a fresh process whose locale is metric, not metric, or does not say; what fails
  /// there fails the test here.
  void inProcessWithLocale(std::optional<bool> isMetric, const std::function<void()>& body);

 private:
  struct State;
  const std::unique_ptr<State> state_;
};

}  // namespace nidus
