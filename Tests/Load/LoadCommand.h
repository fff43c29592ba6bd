#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "Load/Random.h"
#include "PlatformModel/Assistant/VAHACommand.h"
#include "PlatformModel/Assistant/VAHAValue.h"

namespace nidus {

/// A command in short: what it names, what it does, and what that comes to. What is not named is
/// null.
struct LoadCommand {
  /// What the plug-in does with the objects that are found.
  enum class Aim {
    tell,    ///< Tells what is known without asking the homes.
    read,    ///< Reads, one batch per home.
    write,   ///< Writes, one batch per home.
    update,  ///< Reads, then writes.
    scene,   ///< Runs a scene.
    refuse,  ///< Answers with a failure.
  };
  Aim aim = Aim::read;
  NDString home = {};
  NDString room = {};
  NDString group = {};
  NDString service = {};
  NDString scene = {};
  NDString actionType = {};
  NDString attribute = {};
  VAHAValueRef value = {};

  /// The command as the assistant gives it.
  [[nodiscard]] std::unique_ptr<VAHACommand> request() const;
  /// The command on one line, for people.
  [[nodiscard]] std::string description() const;
};

/// Draws commands of every kind.
struct CommandMix {
  std::vector<std::size_t> homes;  ///< The numbers of the homes that are meant.
  std::size_t rooms = 0;           ///< How many rooms each has.
  bool isHomeNamed = true;         ///< Whether each command says which home it means.
  [[nodiscard]] LoadCommand draw(Random& random) const;
};

[[nodiscard]] VAHAValueRef booleanOf(bool value);
[[nodiscard]] VAHAValueRef integerOf(std::int64_t value);

}  // namespace nidus
