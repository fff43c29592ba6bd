#pragma once

#include "nidus/CommandSyntax.h"

namespace nidus {

/// Takes the declaration of a command that nobody asks for, and of all below it, and forgets it.
class UnusedSyntax final : public CommandSyntax {
 public:
  CommandSyntax& command(const std::string&, const std::string&, const std::string&) override {
    return *this;
  }
  void flag(const std::string&, bool&, const std::string&) override {}
  void option(const std::string&, const std::string&, std::string&, const std::string&) override {}
  void requiredOption(const std::string&, const std::string&, std::string&,
                      const std::string&) override {}
  void repeatedOption(const std::string&, const std::string&, std::vector<std::string>&,
                      const std::string&) override {}
  void argument(const std::string&, std::string&, const std::string&) override {}
  void requiredArgument(const std::string&, std::string&, const std::string&) override {}
  void optionalArguments(const std::string&, std::vector<std::string>&,
                         const std::string&) override {}
  void requiredArguments(const std::string&, std::vector<std::string>&,
                         const std::string&) override {}
  void candidates(const std::string&, std::vector<Candidates>) override {}
  void hide() override {}
  [[nodiscard]] bool isWanted() const override { return false; }
  void run(std::function<ExitStatus()>) override {}
};

}  // namespace nidus
