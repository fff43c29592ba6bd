#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

#include "PlatformModel/Home/NDCharacteristicBatch.h"
#include "PlatformModel/Home/NDError.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// What a platform has done for one command or sync, as far as replies depend on it.
struct PlatformFacts {
  /// The calls of one kind.
  struct Calls {
    std::size_t asked = 0;
    std::size_t answered = 0;
    std::size_t locked = 0;  ///< Answered by saying that the device must be unlocked.
    // What the answers say of single objects, up to a locked one.
    std::size_t successes = 0;
    std::size_t unreachable = 0;
    std::size_t readOnly = 0;
    std::size_t failures = 0;
  };
  bool wasAskedForHomes = false;
  std::optional<std::size_t> homes = {};  ///< How many were reported; none without a report.
  bool haveHomesChanged = false;          ///< After they were reported.
  bool isParked = false;                  ///< Something that was asked for will never come.
  bool hasTimedOut = false;               ///< A wait for homes was over before they came.
  Calls reads = {};
  Calls writes = {};
  Calls executions = {};
};

/// Keeps the facts about one command or sync while it lasts. May be used from any thread.
class Ledger {
 public:
  using Calls = PlatformFacts::Calls;
  using Kind = Calls PlatformFacts::*;

  /// Makes `ledger` the current one of the calling thread.
  class Scope {
   public:
    explicit Scope(std::shared_ptr<Ledger> ledger);
    ~Scope();
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

   private:
    std::shared_ptr<Ledger> outer_;
  };
  /// That of the command for which the calling thread works; null when it works for none.
  [[nodiscard]] static const std::shared_ptr<Ledger>& current();

  [[nodiscard]] PlatformFacts facts() const;

  void homesAsked();
  void homesReported(std::size_t count);
  void homesChanged();
  void parked();
  void timedOut();
  void asked(Kind kind);
  void batchAnswered(Kind kind, const std::optional<NDError>& error,
                     const std::vector<NDCharacteristicResponse>& responses);
  void executionAnswered(const std::optional<NDError>& error);

 private:
  mutable NDMutex mutex_;
  PlatformFacts facts_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
