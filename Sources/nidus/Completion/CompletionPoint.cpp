#include "nidus/Completion/CompletionPoint.h"

#include <algorithm>
#include <string_view>
#include <utility>

namespace nidus {
namespace {

/// Walks over the finished words of a command and remembers where it has come.
class CommandWalk {
 public:
  explicit CommandWalk(const CommandOutline& program) : command_(&program) {}

  void pass(const std::string& word) {
    if (const auto* option = std::exchange(awaitsValue_, nullptr)) {
      setValue(*option, word);
    } else if (isOption(word)) {
      passOption(word);
    } else if (const auto* below = arguments_.empty() ? command_->findCommand(word) : nullptr) {
      command_ = below;
    } else {
      arguments_.push_back(word);
    }
  }

  [[nodiscard]] CompletionPoint pointOf(const std::string& word) const {
    CompletionPoint point;
    point.word = word;
    point.arguments = arguments_;
    point.home = home_;
    if (awaitsValue_) {
      addValues(point, *awaitsValue_);
    } else if (isOption(word)) {
      addOptions(point);
    } else {
      addWords(point);
    }
    return point;
  }

 private:
  [[nodiscard]] bool isOption(std::string_view word) const {
    return !hasOnlyArguments_ && !word.empty() && word.front() == '-';
  }

  void passOption(const std::string& word) {
    if (word == "--") {
      hasOnlyArguments_ = true;
      return;
    }
    const std::size_t equals = word.find('=');
    const auto* option = command_->findOption(word.substr(0, equals));
    if (!option || !option->takesValue) return;
    if (equals == std::string::npos) {
      awaitsValue_ = option;
    } else {
      setValue(*option, word.substr(equals + 1));
    }
  }

  void setValue(const CommandOutline::Item& option, const std::string& value) {
    if (option.target) *option.target = value;
    if (option.ofWords.empty()) return;
    const auto& kinds = option.ofWords.front().kinds;
    if (std::find(kinds.begin(), kinds.end(), CandidateKind::homes) != kinds.end()) home_ = value;
  }

  static void add(CompletionPoint& point, const Candidates* candidates) {
    if (!candidates) return;
    point.kinds = candidates->kinds;
    for (const std::string& word : candidates->words) {
      point.texts.push_back(point.word.substr(0, point.valueStart) + word);
    }
  }

  static void addValues(CompletionPoint& point, const CommandOutline::Item& option) {
    if (!option.ofWords.empty()) add(point, &option.ofWords.front());
  }

  void addOptions(CompletionPoint& point) const {
    const std::size_t equals = point.word.find('=');
    if (equals != std::string::npos) {
      point.valueStart = equals + 1;
      const auto* option = command_->findOption(point.word.substr(0, equals));
      if (option) addValues(point, *option);
      return;
    }
    for (const auto* command = command_; command; command = command->above()) {
      for (const auto& option : command->options()) {
        point.texts.insert(point.texts.end(), option.names.begin(), option.names.end());
      }
    }
    point.texts.emplace_back("--help");
    if (!command_->above()) point.texts.emplace_back("--version");
  }

  void addWords(CompletionPoint& point) const {
    for (const auto& below : command_->commands()) {
      if (!below->isHidden() && arguments_.empty()) point.texts.push_back(below->name());
    }
    add(point, command_->findArgument(arguments_.size()));
  }

  const CommandOutline* command_;
  const CommandOutline::Item* awaitsValue_ = nullptr;
  bool hasOnlyArguments_ = false;
  std::vector<std::string> arguments_;
  std::string home_;
};

}  // namespace

CompletionPoint completionPointOf(const CommandOutline& program,
                                  const std::vector<std::string>& words) {
  CommandWalk walk(program);
  for (std::size_t i = 0; i + 1 < words.size(); ++i) walk.pass(words[i]);
  return walk.pointOf(words.empty() ? "" : words.back());
}

}  // namespace nidus
