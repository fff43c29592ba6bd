#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "nidus/CommandSyntax.h"

namespace nidus {

/// A command as it was declared, to be looked at: its options, its arguments and the commands below
/// it. Runs nothing.
///
///     CommandOutline program;
///     declareProgram(program, workspace);
///     for (const auto& command : program.commands()) print(command->name());
class CommandOutline final : public CommandSyntax {
 public:
  /// An option or an argument.
  struct Item {
    std::vector<std::string> names;  ///< Of an option, such as "-q" and "--quiet"; else one.
    bool takesValue = false;
    bool takesAllWords = false;
    std::vector<Candidates> ofWords = {};
    std::string* target = nullptr;  ///< Of an option with one value.
  };

  explicit CommandOutline(std::string name = "nidus", const CommandOutline* above = nullptr);

  CommandSyntax& command(const std::string& name, const std::string& help,
                         const std::string& details) override;
  void flag(const std::string& name, bool& target, const std::string& help) override;
  void option(const std::string& name, const std::string& value, std::string& target,
              const std::string& help) override;
  void requiredOption(const std::string& name, const std::string& value, std::string& target,
                      const std::string& help) override;
  void repeatedOption(const std::string& name, const std::string& value,
                      std::vector<std::string>& target, const std::string& help) override;
  void argument(const std::string& name, std::string& target, const std::string& help) override;
  void requiredArgument(const std::string& name, std::string& target,
                        const std::string& help) override;
  void optionalArguments(const std::string& name, std::vector<std::string>& target,
                         const std::string& help) override;
  void requiredArguments(const std::string& name, std::vector<std::string>& target,
                         const std::string& help) override;
  void candidates(const std::string& name, std::vector<Candidates> ofWords) override;
  void hide() override { isHidden_ = true; }
  void run(std::function<ExitStatus()> action) override { action_ = std::move(action); }

  [[nodiscard]] const std::string& name() const { return name_; }
  [[nodiscard]] bool isHidden() const { return isHidden_; }
  /// The options of this command alone, then its arguments, as declared.
  [[nodiscard]] const std::vector<Item>& options() const { return options_; }
  [[nodiscard]] const std::vector<Item>& arguments() const { return arguments_; }
  /// None of them is null.
  [[nodiscard]] const std::vector<std::unique_ptr<CommandOutline>>& commands() const {
    return commands_;
  }
  /// The command that this one is below; null for the program.
  [[nodiscard]] const CommandOutline* above() const { return above_; }

  /// The command of this name below this one; null when there is none.
  [[nodiscard]] const CommandOutline* findCommand(std::string_view name) const;
  /// The option of this name of this command or of one above it; null when there is none.
  [[nodiscard]] const Item* findOption(std::string_view name) const;
  /// What may stand as the argument at `index`; null when there is no such argument.
  [[nodiscard]] const Candidates* findArgument(std::size_t index) const;

 private:
  std::string name_;
  const CommandOutline* above_;
  bool isHidden_ = false;
  std::vector<Item> options_;
  std::vector<Item> arguments_;
  std::vector<std::unique_ptr<CommandOutline>> commands_;
  std::function<ExitStatus()> action_;  ///< Keeps the targets alive.
};

}  // namespace nidus
