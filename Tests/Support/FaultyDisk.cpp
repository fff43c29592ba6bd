#include "Support/FaultyDisk.h"

#include <sqlite3.h>

#include <cstddef>
#include <new>
#include <string>

namespace nidus {
namespace {

constexpr const char* kName = "faulty";

/// What the calls of the file system have in common; plain data because the engine calls functions.
struct DiskState {
  FaultyDisk::Fault fault;
  bool isArmed = false;
  std::int64_t calls = 0;
  bool hasFailed = false;
};

DiskState& state() {
  static DiskState theState;
  return theState;
}

/// Counts a call and says whether it is to fail.
bool isToFail(bool writes) {
  DiskState& now = state();
  if (!now.isArmed) return false;
  if (now.fault.kind == FaultyDisk::Kind::full && !writes) return false;
  ++now.calls;
  const bool fails =
      now.fault.lasts ? now.calls >= now.fault.firstCall : now.calls == now.fault.firstCall;
  now.hasFailed = now.hasFailed || fails;
  return fails;
}

/// What a failing call reports: that the disk is full, or `error`.
int codeOf(int error) { return state().fault.kind == FaultyDisk::Kind::full ? SQLITE_FULL : error; }

bool isShortStep() { return state().fault.kind == FaultyDisk::Kind::shortStep; }

sqlite3_vfs* realDisk = nullptr;

/// A file of ours with that of the real file system right behind it.
struct File {
  sqlite3_file base;

  sqlite3_file* real() { return reinterpret_cast<sqlite3_file*>(this + 1); }
};

File* fileOf(sqlite3_file* file) { return reinterpret_cast<File*>(file); }
sqlite3_file* realOf(sqlite3_file* file) { return fileOf(file)->real(); }
const sqlite3_io_methods* methodsOf(sqlite3_file* file) { return realOf(file)->pMethods; }

int closeFile(sqlite3_file* file) { return methodsOf(file)->xClose(realOf(file)); }

int readFile(sqlite3_file* file, void* buffer, int amount, sqlite3_int64 offset) {
  if (!isToFail(false)) return methodsOf(file)->xRead(realOf(file), buffer, amount, offset);
  if (isShortStep()) {
    static_cast<void>(methodsOf(file)->xRead(realOf(file), buffer, amount / 2, offset));
  }
  return SQLITE_IOERR_READ;
}

int writeFile(sqlite3_file* file, const void* buffer, int amount, sqlite3_int64 offset) {
  if (!isToFail(true)) return methodsOf(file)->xWrite(realOf(file), buffer, amount, offset);
  if (isShortStep()) {
    static_cast<void>(methodsOf(file)->xWrite(realOf(file), buffer, amount / 2, offset));
  }
  return codeOf(SQLITE_IOERR_WRITE);
}

int truncateFile(sqlite3_file* file, sqlite3_int64 size) {
  if (isToFail(true)) return codeOf(SQLITE_IOERR_TRUNCATE);
  return methodsOf(file)->xTruncate(realOf(file), size);
}

/// Nothing is lost without a sync, as the machine goes on; and the tests are many times faster.
int syncFile(sqlite3_file* /*file*/, int /*flags*/) {
  return isToFail(true) ? codeOf(SQLITE_IOERR_FSYNC) : SQLITE_OK;
}

int sizeOfFile(sqlite3_file* file, sqlite3_int64* size) {
  if (isToFail(false)) return SQLITE_IOERR_FSTAT;
  return methodsOf(file)->xFileSize(realOf(file), size);
}

int lockFile(sqlite3_file* file, int lock) { return methodsOf(file)->xLock(realOf(file), lock); }
int unlockFile(sqlite3_file* file, int lock) {
  return methodsOf(file)->xUnlock(realOf(file), lock);
}
int checkReservedLock(sqlite3_file* file, int* result) {
  return methodsOf(file)->xCheckReservedLock(realOf(file), result);
}
int controlFile(sqlite3_file* file, int operation, void* argument) {
  return methodsOf(file)->xFileControl(realOf(file), operation, argument);
}
int sectorSize(sqlite3_file* file) { return methodsOf(file)->xSectorSize(realOf(file)); }
int characteristics(sqlite3_file* file) {
  return methodsOf(file)->xDeviceCharacteristics(realOf(file));
}

int mapShared(sqlite3_file* file, int region, int size, int extend, void volatile** memory) {
  if (isToFail(extend != 0)) return codeOf(SQLITE_IOERR_SHMMAP);
  return methodsOf(file)->xShmMap(realOf(file), region, size, extend, memory);
}
int lockShared(sqlite3_file* file, int offset, int count, int flags) {
  return methodsOf(file)->xShmLock(realOf(file), offset, count, flags);
}
void barrierShared(sqlite3_file* file) { methodsOf(file)->xShmBarrier(realOf(file)); }
int unmapShared(sqlite3_file* file, int deletes) {
  return methodsOf(file)->xShmUnmap(realOf(file), deletes);
}

constexpr int kMethodsVersion = 2;  // with shared memory, without mapped pages
const sqlite3_io_methods kMethods = {kMethodsVersion, closeFile,         readFile,    writeFile,
                                     truncateFile,    syncFile,          sizeOfFile,  lockFile,
                                     unlockFile,      checkReservedLock, controlFile, sectorSize,
                                     characteristics, mapShared,         lockShared,  barrierShared,
                                     unmapShared,     nullptr,           nullptr};

int openFile(sqlite3_vfs* /*disk*/, const char* name, sqlite3_file* file, int flags, int* result) {
  file->pMethods = nullptr;
  if (isToFail((flags & SQLITE_OPEN_CREATE) != 0)) return codeOf(SQLITE_CANTOPEN);
  const int code = realDisk->xOpen(realDisk, name, realOf(file), flags, result);
  if (realOf(file)->pMethods) file->pMethods = &kMethods;
  return code;
}

int deleteFile(sqlite3_vfs* /*disk*/, const char* name, int syncs) {
  if (isToFail(true)) return codeOf(SQLITE_IOERR_DELETE);
  return realDisk->xDelete(realDisk, name, syncs);
}

int accessFile(sqlite3_vfs* /*disk*/, const char* name, int flags, int* result) {
  if (isToFail(false)) return SQLITE_IOERR_ACCESS;
  return realDisk->xAccess(realDisk, name, flags, result);
}

sqlite3_vfs makeDisk() {
  sqlite3_vfs disk = *realDisk;
  disk.szOsFile += static_cast<int>(sizeof(File));
  disk.zName = kName;
  disk.pNext = nullptr;
  disk.xOpen = openFile;
  disk.xDelete = deleteFile;
  disk.xAccess = accessFile;
  return disk;
}

/// Kept for ever, as the engine may look at it when the process ends.
sqlite3_vfs& theDisk() {
  static sqlite3_vfs disk = makeDisk();
  return disk;
}

}  // namespace

FaultyDisk::FaultyDisk() {
  if (!realDisk) realDisk = sqlite3_vfs_find(nullptr);
  state() = DiskState{};
  constexpr int kDefault = 1;
  sqlite3_vfs_register(&theDisk(), kDefault);
}

FaultyDisk::~FaultyDisk() {
  state() = DiskState{};
  sqlite3_vfs_unregister(&theDisk());
}

void FaultyDisk::arm(const Fault& fault) { state() = DiskState{fault, true, 0, false}; }

bool FaultyDisk::disarm() {
  state().isArmed = false;
  return state().hasFailed;
}

}  // namespace nidus
