#pragma once

#include <functional>
#include <utility>
#include <vector>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeStore.h"

namespace nidus {

/// What the stores in a file and in memory have in common: which changes there are and what is
/// read. How a transaction is made is theirs.
class SqliteHomeStore : public HomeStore {
 public:
  Status replaceHomes(const std::vector<HomeData>& homes, const StoreProgress& progress) final;
  Status mergeHomes(const std::vector<HomeData>& homes, const StoreProgress& progress) final;
  Status editHomes(const HomeEdit& edit) final;
  Result<std::vector<HomeData>> loadHomes() final;
  Result<std::int64_t> countHomes() final;

 protected:
  /// Changes the tables, or fails; may throw `DatabaseError`.
  using Change = std::function<Status(Database&)>;
  /// Reads the tables; may throw `DatabaseError`.
  using Read = std::function<void(Database&)>;
  /// Whether the homes are kept as they were before a change.
  enum class Backup { none, first };

  /// Makes a change of the homes in one transaction, whole or not at all.
  [[nodiscard]] virtual Status change(Backup backup, const Change& change) = 0;
  /// Reads one state of the database.
  [[nodiscard]] virtual Status read(const Read& read) = 0;

 private:
  template <class Value, class Load>
  Result<Value> load(const Load& load) {
    Value value{};
    const Status failed = read([&](Database& database) { value = load(database); });
    if (failed) return *failed;
    return value;
  }
};

}  // namespace nidus
