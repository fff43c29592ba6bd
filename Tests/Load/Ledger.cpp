#include "Load/Ledger.h"

#include <utility>

namespace nidus {
namespace {

thread_local std::shared_ptr<Ledger> currentLedger;

bool isLocked(const std::optional<NDError>& error) {
  return error && error->code == kNDErrorMustUnlock;
}

void count(PlatformFacts::Calls& calls, const std::optional<NDError>& error) {
  if (!error) {
    ++calls.successes;
  } else if (error->code == kNDErrorUnreachable) {
    ++calls.unreachable;
  } else if (error->code == kNDErrorNotWritable) {
    ++calls.readOnly;
  } else {
    ++calls.failures;
  }
}

}  // namespace

Ledger::Scope::Scope(std::shared_ptr<Ledger> ledger)
    : outer_(std::exchange(currentLedger, std::move(ledger))) {}

Ledger::Scope::~Scope() { currentLedger.swap(outer_); }

const std::shared_ptr<Ledger>& Ledger::current() { return currentLedger; }

PlatformFacts Ledger::facts() const {
  const NDLock lock(mutex_);
  return facts_;
}

void Ledger::homesAsked() {
  const NDLock lock(mutex_);
  facts_.wasAskedForHomes = true;
}

void Ledger::homesReported(std::size_t count) {
  const NDLock lock(mutex_);
  facts_.homes = count;
}

void Ledger::homesChanged() {
  const NDLock lock(mutex_);
  facts_.haveHomesChanged = true;
}

void Ledger::parked() {
  const NDLock lock(mutex_);
  facts_.isParked = true;
}

void Ledger::timedOut() {
  const NDLock lock(mutex_);
  facts_.hasTimedOut = true;
}

void Ledger::asked(Kind kind) {
  const NDLock lock(mutex_);
  ++(facts_.*kind).asked;
}

void Ledger::batchAnswered(Kind kind, const std::optional<NDError>& error,
                           const std::vector<NDCharacteristicResponse>& responses) {
  const NDLock lock(mutex_);
  Calls& calls = facts_.*kind;
  ++calls.answered;
  // What an update writes is looked at to the end: a locked object is a failure like any other.
  const bool isUpdate = kind == &PlatformFacts::writes && facts_.reads.asked > 0;
  if (isLocked(error) && !isUpdate) {
    ++calls.locked;
    return;
  }
  for (const auto& response : responses) {
    if (isLocked(response.error) && !isUpdate) {
      ++calls.locked;
      return;
    }
    count(calls, response.error);
  }
}

void Ledger::executionAnswered(const std::optional<NDError>& error) {
  const NDLock lock(mutex_);
  ++facts_.executions.answered;
  if (isLocked(error)) {
    ++facts_.executions.locked;
  } else {
    count(facts_.executions, error);
  }
}

}  // namespace nidus
