#pragma once

#include <filesystem>
#include <optional>

#include "HomePlatform/Store/HomeChanges.h"
#include "HomePlatform/Store/SqliteHomeStore.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// The store in a file, over two connections: while one waits for another process to finish its
/// change, the other one reads.
///
/// The turn to write is taken first, `AroundWrite` is called under it, and the lock of the reading
/// connection comes last.
class FileHomeStore final : public SqliteHomeStore {
 public:
  /// Opens the database in `file`; `prepare` has to follow. Throws `DatabaseError`.
  FileHomeStore(std::filesystem::path file, std::chrono::milliseconds lockTimeout);

  /// Makes the database ready for use: makes or migrates its tables.
  [[nodiscard]] Status prepare();

  Status writeValues(const std::vector<ValueChange>& changes, const AroundWrite& around) override;
  Result<std::uint64_t> version() override;
  Result<bool> waitForWriter() override;

 protected:
  Status change(Backup backup, const Change& change) override;
  Status read(const Read& read) override;

 private:
  /// A connection, and the number that differs after each commit of all others.
  struct Connection {
    Connection(const std::filesystem::path& file, std::chrono::milliseconds lockTimeout)
        : database(file.string(), lockTimeout) {}
    [[nodiscard]] std::int64_t commitsOfOthers();

    Database database;
    std::optional<Statement> dataVersion = std::nullopt;
    std::optional<ValueWriter> values = std::nullopt;
  };

  [[nodiscard]] Connection& writer() ND_REQUIRES(turn_);
  Status commitValues(Connection& writer, Transaction& transaction,
                      const std::vector<ValueChange>& changes);
  void noticeCommits() ND_REQUIRES(mutex_);

  const std::filesystem::path file_;
  const std::chrono::milliseconds lockTimeout_;
  NDMutex turn_;  ///< Held while this process waits for its turn to write, and writes.
  std::optional<Connection> writer_ ND_GUARDED_BY(turn_);  ///< Opened for the first change.
  NDMutex mutex_;
  Connection reader_ ND_GUARDED_BY(mutex_);
  std::int64_t seenCommits_ ND_GUARDED_BY(mutex_) = 0;  ///< What `version_` takes account of.
  std::uint64_t version_ ND_GUARDED_BY(mutex_) = 0;
};

}  // namespace nidus
