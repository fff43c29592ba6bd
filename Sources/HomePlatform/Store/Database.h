#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"
#include "PlatformModel/System/NDValue.h"

struct sqlite3;
struct sqlite3_stmt;

namespace nidus {

/// Why the database did not do what it was asked: thrown by the three classes below, turned into a
/// `Failure` by the home store.
struct DatabaseError {
  enum class Kind {
    locked,        ///< Another process or connection held it for longer than the timeout.
    damaged,       ///< It is a database with contents that can not be.
    notADatabase,  ///< The file is something else.
    notWritable,   ///< The file or its folder may not be opened or written.
    full,          ///< There is no room left on the disk.
    other,
  };
  Kind kind = Kind::other;
  std::string message;  ///< The engine's own words, for people who look for the cause.
};

/// One connection to an SQLite file, closed with this object. Foreign keys are enforced, a commit
/// is on disk when it returns, and whoever finds the file locked waits. Not synchronised.
///
///     Database database("/home/mia/home.db", std::chrono::seconds(10));
///     Statement names(database, "SELECT name FROM home");
///     while (names.step()) print(names.text(0));
class Database {
 public:
  static constexpr const char* kInMemory = ":memory:";

  /// Whether a file that is missing is made or an error.
  enum class MissingFile { isMade, isAnError };

  /// Opens the file `path`, or with `kInMemory` a database of this object alone. Waits up to
  /// `lockTimeout` where another connection holds a lock.
  Database(const std::string& path, std::chrono::milliseconds lockTimeout,
           MissingFile missingFile = MissingFile::isMade);
  ~Database();
  Database(const Database&) = delete;
  Database& operator=(const Database&) = delete;

  /// Turns the write-ahead log on; it stays on in the file.
  void useWriteAheadLog();
  /// Puts all of `source` in place of what is here, which is to be in memory. What others write
  /// meanwhile is in it as a whole or not at all.
  void copyFrom(Database& source);
  /// Runs one or more statements that give no rows.
  void run(const std::string& statements);
  /// The first column of the first row of `query`, which has one.
  [[nodiscard]] std::int64_t number(const char* query);
  /// The row that the last insertion made.
  [[nodiscard]] std::int64_t lastRow() const;

 private:
  friend class Statement;
  friend class WorkLimit;
  void configure(std::chrono::milliseconds lockTimeout);
  void limitSizes();
  void check(int code) const;
  [[noreturn]] void fail(int code) const;

  sqlite3* connection_ = nullptr;
};

/// A prepared statement: bound, stepped, and used again after `reset`. Parameters count from 1,
/// columns from 0. The database must outlive it. Not synchronised.
class Statement {
 public:
  Statement(Database& database, const char* statement);
  ~Statement();
  Statement(const Statement&) = delete;
  Statement& operator=(const Statement&) = delete;

  /// Binds the parameters from 1 on and runs the statement, which gives no rows.
  template <class... Values>
  void run(const Values&... values) {
    bindAll(values...);
    step();
    reset();
  }
  /// Binds the parameters from 1 on.
  template <class... Values>
  void bindAll(const Values&... values) {
    int index = 0;
    (bind(++index, values), ...);
  }
  void bind(int index, std::int64_t number);
  void bind(int index, std::int32_t number) { bind(index, std::int64_t{number}); }
  void bind(int index, std::size_t number) { bind(index, static_cast<std::int64_t>(number)); }
  void bind(int index, bool flag) { bind(index, std::int64_t{flag}); }
  /// A null text binds null.
  void bind(int index, const NDString& text);
  void bind(int index, const NDUUID& uuid);
  /// A boxed value keeps its kind and its bits; a null one binds null.
  void bind(int index, const NDValueRef& value);
  void bind(int index, const std::optional<std::int64_t>& number);

  /// Goes to the next row; false when there is none.
  bool step();
  /// Ends the rows and forgets the parameters.
  void reset();

  [[nodiscard]] std::int64_t integer(int column) const;
  [[nodiscard]] std::int32_t smallInteger(int column) const;
  [[nodiscard]] bool flag(int column) const { return integer(column) != 0; }
  [[nodiscard]] bool isNull(int column) const;
  /// Empty for null. Valid until the next step. What is not UTF-8 counts as damage.
  [[nodiscard]] std::string_view text(int column) const;
  [[nodiscard]] NDUUID uuid(int column) const;
  [[nodiscard]] NDValueRef value(int column) const;

 private:
  void bindBytes(int index, const void* bytes, std::size_t length);
  [[noreturn]] void failDamaged(int column) const;

  Database& database_;
  sqlite3_stmt* statement_ = nullptr;
};

/// While it lives, statements that take far more steps than all that a sound database of this size
/// holds can ask for fail, as for a damaged one: pages that lead to one another again and again
/// could otherwise be read without end. One at a time for a database, which must outlive it.
class WorkLimit {
 public:
  explicit WorkLimit(Database& database);
  ~WorkLimit();
  WorkLimit(const WorkLimit&) = delete;
  WorkLimit& operator=(const WorkLimit&) = delete;

 private:
  Database& database_;
  std::int64_t stepsLeft_;
};

/// A change that is made whole or not at all: undone with this object unless committed.
class Transaction {
 public:
  /// A reading transaction sees one state; a writing one is the only one at its time.
  enum class Kind { reading, writing };
  Transaction(Database& database, Kind kind);
  ~Transaction();
  Transaction(const Transaction&) = delete;
  Transaction& operator=(const Transaction&) = delete;

  /// Makes the change last; it is on disk when this returns.
  void commit();

 private:
  Database& database_;
  bool isOpen_ = true;
};

}  // namespace nidus
