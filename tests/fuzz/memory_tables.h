// Serves the three table files from memory through the database's file seam, so a fuzz
// target can open a vpdDB on any bytes without touching the disk. Read-only: opening a table
// for writing fails with EROFS, as does a rename.
#ifndef TESTS_FUZZ_MEMORY_TABLES_H_
#define TESTS_FUZZ_MEMORY_TABLES_H_

#include <ctime>
#include <string>

namespace fuzzsupport {

// A data directory that exists nowhere on disk.
constexpr const char kMemoryDataDir[] = "/fuzz-memory/data";

struct TableBytes {
  std::string chassis, bpa, sma;
  // A missing table cannot be opened (ENOENT).
  bool chassis_missing = false, bpa_missing = false, sma_missing = false;
  // Modification time reported for every table.
  time_t mtime = 0;
};

// Installs the seam for its lifetime and puts the plain file operations back on destruction.
// One at a time per process.
class MemoryTables {
 public:
  // The seam answers the three table names inside data_dir; any other path is missing.
  MemoryTables(const TableBytes& tables, const std::string& data_dir = kMemoryDataDir);
  ~MemoryTables();
  MemoryTables(const MemoryTables&) = delete;
  MemoryTables& operator=(const MemoryTables&) = delete;

  // Descriptors handed out and not yet closed (a leak check for the targets).
  static int openCount();
};

}  // namespace fuzzsupport

#endif  // TESTS_FUZZ_MEMORY_TABLES_H_
