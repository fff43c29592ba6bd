#include "nidus/Completion/CommandOutline.h"

#include <algorithm>
#include <sstream>
#include <utility>

namespace nidus {
namespace {

/// The names of a declaration such as "-q,--quiet".
std::vector<std::string> namesIn(const std::string& declared) {
  std::vector<std::string> names;
  std::istringstream rest(declared);
  for (std::string name; std::getline(rest, name, ',');) names.push_back(name);
  return names;
}

bool hasName(const CommandOutline::Item& item, std::string_view name) {
  return std::find(item.names.begin(), item.names.end(), name) != item.names.end();
}

}  // namespace

CommandOutline::CommandOutline(std::string name, const CommandOutline* above)
    : name_(std::move(name)), above_(above) {}

CommandSyntax& CommandOutline::command(const std::string& name, const std::string&,
                                       const std::string&) {
  commands_.push_back(std::make_unique<CommandOutline>(name, this));
  return *commands_.back();
}

void CommandOutline::flag(const std::string& name, bool&, const std::string&) {
  options_.push_back({.names = namesIn(name)});
}

void CommandOutline::option(const std::string& name, const std::string&, std::string& target,
                            const std::string&) {
  options_.push_back({.names = namesIn(name), .takesValue = true, .target = &target});
}

void CommandOutline::requiredOption(const std::string& name, const std::string& value,
                                    std::string& target, const std::string& help) {
  option(name, value, target, help);
}

void CommandOutline::repeatedOption(const std::string& name, const std::string&,
                                    std::vector<std::string>&, const std::string&) {
  options_.push_back({.names = namesIn(name), .takesValue = true});
}

void CommandOutline::argument(const std::string& name, std::string&, const std::string&) {
  arguments_.push_back({.names = {name}});
}

void CommandOutline::requiredArgument(const std::string& name, std::string& target,
                                      const std::string& help) {
  argument(name, target, help);
}

void CommandOutline::optionalArguments(const std::string& name, std::vector<std::string>&,
                                       const std::string&) {
  arguments_.push_back({.names = {name}, .takesAllWords = true});
}

void CommandOutline::requiredArguments(const std::string& name, std::vector<std::string>& target,
                                       const std::string& help) {
  optionalArguments(name, target, help);
}

void CommandOutline::candidates(const std::string& name, std::vector<Candidates> ofWords) {
  for (std::vector<Item>* items : {&options_, &arguments_}) {
    for (Item& item : *items) {
      if (item.names == namesIn(name)) item.ofWords = ofWords;
    }
  }
}

const CommandOutline* CommandOutline::findCommand(std::string_view name) const {
  const auto found = std::find_if(commands_.begin(), commands_.end(),
                                  [name](const auto& command) { return command->name_ == name; });
  return found == commands_.end() ? nullptr : found->get();
}

const CommandOutline::Item* CommandOutline::findOption(std::string_view name) const {
  const auto found = std::find_if(options_.begin(), options_.end(),
                                  [name](const Item& item) { return hasName(item, name); });
  if (found != options_.end()) return &*found;
  return above_ ? above_->findOption(name) : nullptr;
}

const Candidates* CommandOutline::findArgument(std::size_t index) const {
  for (const Item& argument : arguments_) {
    const auto& ofWords = argument.ofWords;
    if (index == 0 || argument.takesAllWords) {
      return ofWords.empty() ? nullptr : &ofWords[std::min(index, ofWords.size() - 1)];
    }
    --index;
  }
  return nullptr;
}

}  // namespace nidus
