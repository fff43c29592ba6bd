#include "HomePlatform/Store/StoreExamination.h"

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>
#include <utility>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeLoader.h"
#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/StoreFailures.h"

namespace nidus {
namespace {

/// The lines of a report of the engine, its heading left out, as one.
std::string joinedLines(std::string_view report) {
  std::string line;
  for (std::size_t end = 0; !report.empty();
       report.remove_prefix(std::min(end + 1, report.size()))) {
    end = std::min(report.find('\n'), report.size());
    const std::string_view part = report.substr(0, end);
    if (!part.starts_with("***")) line.append(line.empty() ? "" : ", ").append(part);
  }
  return line;
}

/// The look at one database. Each step throws `DatabaseError` when it cannot be taken.
class Look {
 public:
  Look(Database& database, const std::string& name) : database_(database), name_(name) {}

  StoreExamination take() {
    attempt([this] { checkVersion(); });
    if (!found_.failures.empty()) return std::move(found_);
    attempt([this] { checkIntegrity(); });
    attempt([this] { checkReferences(); });
    attempt([this] { loadHomes(); });
    return std::move(found_);
  }

 private:
  template <class Step>
  void attempt(const Step& step) {
    try {
      step();
    } catch (const DatabaseError& error) {
      // What is damaged fails each step anew; once is enough.
      if (found_.failures.empty()) found_.failures.push_back(failureOf(error, name_));
    }
  }

  void checkVersion() {
    if (const auto problem = schemaProblemOf(database_, schemaSteps())) {
      found_.failures.push_back(failureOf(*problem, name_));
    }
  }

  void addDamage(const std::string& message) {
    found_.failures.push_back(failureOf({DatabaseError::Kind::damaged, message}, name_));
  }

  void checkIntegrity() {
    Statement row(database_, "PRAGMA integrity_check(10)");
    while (row.step()) {
      if (row.text(0) != "ok") addDamage(joinedLines(row.text(0)));
    }
  }

  void checkReferences() {
    Statement row(database_,
                  "SELECT \"table\", count(*) FROM pragma_foreign_key_check GROUP BY 1 ORDER BY 1");
    while (row.step()) {
      addDamage("references of the table " + std::string(row.text(0)) +
                " that lead nowhere: " + std::to_string(row.integer(1)));
    }
  }

  /// What has an earlier version is read as it would be migrated, and left as it is.
  void loadHomes() {
    const bool isCurrent = isSchemaCurrent(database_, schemaSteps());
    const Transaction undone(database_,
                             isCurrent ? Transaction::Kind::reading : Transaction::Kind::writing);
    if (!isCurrent) runSchemaSteps(database_, schemaSteps());
    found_.homes = loadHomesFrom(database_);
  }

  Database& database_;
  const std::string& name_;
  StoreExamination found_;
};

}  // namespace

StoreExamination examineStore(const std::filesystem::path& file,
                              std::chrono::milliseconds lockTimeout) {
  const std::string name = file.string();
  try {
    Database database(name, lockTimeout, Database::MissingFile::isAnError);
    return Look(database, name).take();
  } catch (const DatabaseError& error) {
    return {{failureOf(error, name)}, std::nullopt};
  }
}

}  // namespace nidus
