#pragma once

#include <array>
#include <functional>
#include <optional>
#include <string>

#include "Load/Judge.h"
#include "Load/StressRecord.h"

namespace nidus {

/// The room of one caller in the home that nobody else commands: each reply is known beforehand,
/// to the value. Used by one thread at a time.
class OwnRoom {
 public:
  /// Performs a command to its end and judges what can be judged of any.
  using Perform = std::function<Replies(const LoadCommand&)>;
  /// Gives another number when others may have taken back what was written, and none while they do.
  using Epoch = std::function<std::optional<std::size_t>()>;

  /// `record` outlives the room.
  OwnRoom(std::size_t room, StressRecord& record, Perform perform, Epoch epoch);

  /// The next command, of eight in turn.
  void step();
  /// The brightness of the lamp that was written last; none when others may have changed it.
  [[nodiscard]] std::optional<std::int64_t> level() const;

 private:
  using Step = void (OwnRoom::*)();
  static const std::array<Step, 8> kSteps;

  void readRoom();
  void writeLamp();
  void raiseLamp();
  void toggleLocked();
  void readUnreachable();
  void runScene();
  void nameNothing();
  void askUnknown();

  [[nodiscard]] Replies perform(LoadCommand command) const;
  void expect(bool holds, const std::string& what) const;
  void expectOne(const Replies& replies, std::string_view outcome, std::size_t results,
                 const std::string& what) const;
  void expectLevel(const Replies& replies, const std::string& what);

  const std::size_t room_;
  StressRecord& record_;
  const Perform perform_;
  const Epoch epoch_;
  std::size_t steps_ = 0;
  std::int64_t level_ = 0;
  std::optional<std::size_t> levelEpoch_;  ///< None while the level is not known.
};

}  // namespace nidus
