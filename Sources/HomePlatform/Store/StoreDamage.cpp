#include "HomePlatform/Store/StoreDamage.h"

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <string>
#include <string_view>

namespace nidus {
namespace {

constexpr auto kDamaged = DatabaseError::Kind::damaged;

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

void checkPages(Database& database, std::vector<DatabaseError>& found) {
  const WorkLimit limit(database);
  Statement page(database, "PRAGMA integrity_check(10)");
  while (page.step()) {
    if (page.text(0) != "ok") found.push_back({kDamaged, joinedLines(page.text(0))});
  }
}

void checkReferences(Database& database, std::vector<DatabaseError>& found) {
  const WorkLimit limit(database);
  Statement table(database,
                  "SELECT \"table\", count(*) FROM pragma_foreign_key_check GROUP BY 1 ORDER BY 1");
  while (table.step()) {
    found.push_back({kDamaged, "references of the table " + std::string(table.text(0)) +
                                   " that lead nowhere: " + std::to_string(table.integer(1))});
  }
}

}  // namespace

std::vector<DatabaseError> findDamage(Database& database) {
  std::vector<DatabaseError> found;
  try {
    // The engine reports a page that the disk failed to give like one that is not sound. In memory
    // there are none of the first kind: they fail the copy.
    Database copy(Database::kInMemory, std::chrono::milliseconds(0));
    copy.copyFrom(database);
    checkPages(copy, found);
    checkReferences(copy, found);
  } catch (const DatabaseError& error) {
    // What has been found explains why no more can be looked at.
    if (found.empty()) found.push_back(error);
  }
  return found;
}

}  // namespace nidus
