#include "HomePlatform/Store/StoreExamination.h"

#include <utility>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeLoader.h"
#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/StoreDamage.h"
#include "HomePlatform/Store/StoreFailures.h"

namespace nidus {
namespace {

/// The look at one database.
class Look {
 public:
  Look(std::filesystem::path file, std::chrono::milliseconds lockTimeout)
      : file_(std::move(file)), lockTimeout_(lockTimeout) {}

  StoreExamination take() {
    // What is damaged fails each step anew; once is enough.
    attempt([this] {
      database_.emplace(file_.string(), lockTimeout_, Database::MissingFile::isAnError);
      checkVersion();
    });
    if (!found_.failures.empty()) return std::move(found_);
    for (const DatabaseError& error : findDamage(*database_)) add(error);
    attempt([this] { found_.homes = loadMigratedHomes(*database_); });
    return std::move(found_);
  }

 private:
  /// Takes a step, which may throw `DatabaseError`.
  template <class Step>
  void attempt(const Step& step) {
    try {
      step();
    } catch (const DatabaseError& error) {
      if (found_.failures.empty()) add(error);
    }
  }

  void add(const DatabaseError& error) {
    found_.failures.push_back(failureOf(error, file_));
    found_.isDamaged = found_.isDamaged || isDamage(error);
  }

  void checkVersion() {
    // Another process may be making the tables.
    const Transaction oneState(*database_, Transaction::Kind::reading);
    if (const auto problem = schemaProblemOf(*database_, schemaSteps())) {
      found_.failures.push_back(failureOf(*problem, file_));
    }
  }

  const std::filesystem::path file_;
  const std::chrono::milliseconds lockTimeout_;
  std::optional<Database> database_;
  StoreExamination found_;
};

}  // namespace

StoreExamination examineStore(const std::filesystem::path& file,
                              std::chrono::milliseconds lockTimeout) {
  return Look(file, lockTimeout).take();
}

}  // namespace nidus
