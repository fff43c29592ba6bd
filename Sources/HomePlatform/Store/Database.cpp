#include "HomePlatform/Store/Database.h"

#include <sqlite3.h>

#include <array>
#include <bit>
#include <cmath>
#include <cstring>
#include <limits>

#include "PlatformModel/System/NDTextMatching.h"

namespace nidus {
namespace {

DatabaseError::Kind kindOf(int code) {
  switch (code & 0xFF) {
    case SQLITE_BUSY:
    case SQLITE_LOCKED:
      return DatabaseError::Kind::locked;
    case SQLITE_CORRUPT:
    case SQLITE_INTERRUPT:  // by the limit of work alone
      return DatabaseError::Kind::damaged;
    case SQLITE_NOTADB:
      return DatabaseError::Kind::notADatabase;
    case SQLITE_READONLY:
    case SQLITE_CANTOPEN:
    case SQLITE_PERM:
    case SQLITE_AUTH:
      return DatabaseError::Kind::notWritable;
    case SQLITE_FULL:
      return DatabaseError::Kind::full;
    default:
      return DatabaseError::Kind::other;
  }
}

/// The engine counts the memory that it uses, under a lock each time, unless it is told before its
/// first use that nobody asks.
void leaveMemoryUncounted() {
  static const int kCode = sqlite3_config(SQLITE_CONFIG_MEMSTATUS, 0);
  static_cast<void>(kCode);  // an engine already in use counts on
}

}  // namespace

Database::Database(const std::string& path, std::chrono::milliseconds lockTimeout,
                   MissingFile missingFile) {
  const int making = missingFile == MissingFile::isMade ? SQLITE_OPEN_CREATE : 0;
  const int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX | making;
  leaveMemoryUncounted();
  try {
    check(sqlite3_open_v2(path.c_str(), &connection_, flags, nullptr));
    configure(lockTimeout);
  } catch (...) {
    sqlite3_close_v2(connection_);
    throw;
  }
}

Database::~Database() { sqlite3_close_v2(connection_); }

void Database::configure(std::chrono::milliseconds lockTimeout) {
  sqlite3_extended_result_codes(connection_, 1);
  limitSizes();
  check(sqlite3_busy_timeout(connection_, static_cast<int>(lockTimeout.count())));
  check(sqlite3_db_config(connection_, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr));
  if (sqlite3_db_readonly(connection_, "main") != 0) {
    throw DatabaseError{DatabaseError::Kind::notWritable, "the file is read-only"};
  }
  run("PRAGMA foreign_keys = ON; PRAGMA trusted_schema = OFF; PRAGMA synchronous = FULL");
}

/// Far above all that this program writes: what is larger is no work of its own.
void Database::limitSizes() {
  constexpr int kBytesOfRow = 16'000'000;
  constexpr int kBytesOfStatement = 10'000;
  sqlite3_limit(connection_, SQLITE_LIMIT_LENGTH, kBytesOfRow);
  sqlite3_limit(connection_, SQLITE_LIMIT_SQL_LENGTH, kBytesOfStatement);
}

void Database::useWriteAheadLog() {
  Statement mode(*this, "PRAGMA journal_mode = WAL");
  mode.step();
  if (mode.text(0) != "wal") {
    throw DatabaseError{DatabaseError::Kind::other, "the write-ahead log cannot be used here"};
  }
}

void Database::copyFrom(Database& source) {
  constexpr const char* kMain = "main";
  constexpr int kAllPages = -1;
  sqlite3_backup* const copy = sqlite3_backup_init(connection_, kMain, source.connection_, kMain);
  if (!copy) fail(sqlite3_extended_errcode(connection_));
  sqlite3_backup_step(copy, kAllPages);
  check(sqlite3_backup_finish(copy));  // tells of a step that failed too
}

void Database::run(const std::string& statements) {
  check(sqlite3_exec(connection_, statements.c_str(), nullptr, nullptr, nullptr));
}

std::int64_t Database::number(const char* query) {
  Statement statement(*this, query);
  if (!statement.step()) throw DatabaseError{DatabaseError::Kind::damaged, "a row is missing"};
  return statement.integer(0);
}

std::int64_t Database::lastRow() const { return sqlite3_last_insert_rowid(connection_); }

void Database::check(int code) const {
  if (code != SQLITE_OK) fail(code);
}

void Database::fail(int code) const {
  if (code == SQLITE_INTERRUPT) {
    throw DatabaseError{kindOf(code), "its pages lead to one another again and again"};
  }
  throw DatabaseError{kindOf(code),
                      connection_ ? sqlite3_errmsg(connection_) : sqlite3_errstr(code)};
}

Statement::Statement(Database& database, const char* statement) : database_(database) {
  constexpr unsigned kFlags = 0;
  const int code =
      sqlite3_prepare_v3(database_.connection_, statement, -1, kFlags, &statement_, nullptr);
  // The statements are right, so it is the tables that are not.
  if (code == SQLITE_ERROR) database_.fail(SQLITE_CORRUPT);
  database_.check(code);
}

Statement::~Statement() { sqlite3_finalize(statement_); }

void Statement::bind(int index, std::int64_t number) {
  database_.check(sqlite3_bind_int64(statement_, index, number));
}

void Statement::bind(int index, const NDString& text) {
  if (!text) {
    database_.check(sqlite3_bind_null(statement_, index));
    return;
  }
  const std::string_view characters = text.view();
  database_.check(sqlite3_bind_text64(statement_, index, characters.data(), characters.size(),
                                      SQLITE_TRANSIENT, SQLITE_UTF8));
}

void Statement::bind(int index, const NDUUID& uuid) {
  bindBytes(index, uuid.bytes().data(), uuid.bytes().size());
}

void Statement::bind(int index, const std::optional<std::int64_t>& number) {
  if (number) {
    bind(index, *number);
  } else {
    database_.check(sqlite3_bind_null(statement_, index));
  }
}

/// Integers, floats and texts are kept as what they are. A boolean becomes one byte, and
/// not-a-number, which the engine takes for null, its four.
void Statement::bind(int index, const NDValueRef& value) {
  if (!value) {
    database_.check(sqlite3_bind_null(statement_, index));
  } else if (value->isBoolean()) {
    const auto byte = static_cast<std::uint8_t>(value->boolValue());
    bindBytes(index, &byte, sizeof byte);
  } else if (value->isInteger()) {
    bind(index, value->integerValue());
  } else if (value->isText()) {
    bind(index, value->stringValue());
  } else if (const float number = value->floatValue(); std::isnan(number)) {
    bindBytes(index, &number, sizeof number);
  } else {
    database_.check(sqlite3_bind_double(statement_, index, number));
  }
}

void Statement::bindBytes(int index, const void* bytes, std::size_t length) {
  database_.check(sqlite3_bind_blob64(statement_, index, bytes, length, SQLITE_TRANSIENT));
}

bool Statement::step() {
  const int code = sqlite3_step(statement_);
  if (code == SQLITE_ROW) return true;
  if (code == SQLITE_DONE) return false;
  sqlite3_reset(statement_);
  // A text that is bound is never too long, so it is one of the tables.
  database_.fail(code == SQLITE_TOOBIG ? SQLITE_CORRUPT : code);
}

void Statement::reset() {
  sqlite3_reset(statement_);
  sqlite3_clear_bindings(statement_);
}

std::int64_t Statement::integer(int column) const {
  return sqlite3_column_int64(statement_, column);
}

std::int32_t Statement::smallInteger(int column) const {
  return sqlite3_column_int(statement_, column);
}

bool Statement::isNull(int column) const {
  return sqlite3_column_type(statement_, column) == SQLITE_NULL;
}

std::string_view Statement::text(int column) const {
  const auto* characters = sqlite3_column_text(statement_, column);
  if (!characters) return {};
  const std::string_view text(reinterpret_cast<const char*>(characters),
                              static_cast<std::size_t>(sqlite3_column_bytes(statement_, column)));
  if (!isUTF8(text)) failDamaged(column);
  return text;
}

NDUUID Statement::uuid(int column) const {
  std::array<std::uint8_t, 16> bytes{};
  const void* stored = sqlite3_column_blob(statement_, column);
  if (sqlite3_column_bytes(statement_, column) != static_cast<int>(bytes.size())) {
    failDamaged(column);
  }
  std::memcpy(bytes.data(), stored, bytes.size());
  return NDUUID(bytes);
}

NDValueRef Statement::value(int column) const {
  switch (sqlite3_column_type(statement_, column)) {
    case SQLITE_NULL:
      return nullptr;
    case SQLITE_INTEGER:
      return NDValue::integer(integer(column));
    case SQLITE_FLOAT:
      return NDValue::floating(static_cast<float>(sqlite3_column_double(statement_, column)));
    case SQLITE_TEXT:
      return NDValue::text(NDString(text(column)));
    default:
      break;
  }
  const void* bytes = sqlite3_column_blob(statement_, column);
  const int length = sqlite3_column_bytes(statement_, column);
  if (length == 1) return NDValue::boolean(*static_cast<const std::uint8_t*>(bytes) != 0);
  if (length != sizeof(float)) failDamaged(column);
  float number = 0;
  std::memcpy(&number, bytes, sizeof number);
  return NDValue::floating(number);
}

void Statement::failDamaged(int column) const {
  throw DatabaseError{DatabaseError::Kind::damaged, std::string("unexpected contents of column ") +
                                                        sqlite3_column_name(statement_, column)};
}

WorkLimit::WorkLimit(Database& database) : database_(database) {
  // Reading and examining the densest tables that a home document can fill takes half a step for a
  // byte of the database.
  constexpr std::int64_t kStepsOfByte = 2;
  constexpr std::int64_t kStepsOfNothing = 1'000'000;
  constexpr int kStepsAtOnce = 1000;
  stepsLeft_ = kStepsOfNothing + kStepsOfByte * database.number("PRAGMA page_count") *
                                     database.number("PRAGMA page_size");
  sqlite3_progress_handler(
      database.connection_, kStepsAtOnce,
      [](void* stepsLeft) {
        auto& left = *static_cast<std::int64_t*>(stepsLeft);
        left -= kStepsAtOnce;
        return left < 0 ? 1 : 0;
      },
      &stepsLeft_);
}

WorkLimit::~WorkLimit() { sqlite3_progress_handler(database_.connection_, 0, nullptr, nullptr); }

Transaction::Transaction(Database& database, Kind kind) : database_(database) {
  database_.run(kind == Kind::writing ? "BEGIN IMMEDIATE" : "BEGIN");
}

Transaction::~Transaction() {
  if (!isOpen_) return;
  try {
    database_.run("ROLLBACK");
  } catch (const DatabaseError&) {
    // After an error such as a full disk the engine has rolled back by itself.
  }
}

void Transaction::commit() {
  database_.run("COMMIT");
  isOpen_ = false;
}

}  // namespace nidus
