#include <sqlite3.h>

// The floor of starting up: opens a home database and reads one row. Tools/measure-process runs it
// beside the program.
int main(int argc, char** argv) {
  if (argc != 2) return 2;
  sqlite3* database = nullptr;
  sqlite3_stmt* names = nullptr;
  int code = sqlite3_open(argv[1], &database);
  if (code == SQLITE_OK) {
    code = sqlite3_prepare_v2(database, "SELECT name FROM home", -1, &names, nullptr);
  }
  if (code == SQLITE_OK) code = sqlite3_step(names);
  sqlite3_finalize(names);
  sqlite3_close(database);
  return code == SQLITE_ROW ? 0 : 1;
}
