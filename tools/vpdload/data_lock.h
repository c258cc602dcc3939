// The advisory lock that keeps two producers from writing one data directory at once.
#ifndef TOOLS_VPDLOAD_DATA_LOCK_H_
#define TOOLS_VPDLOAD_DATA_LOCK_H_

#include <string>

#include "status.h"

namespace vpdload {

// A flock on the data directory's lock file, released when the object goes away (or when
// the process dies, however it dies).
class DataLock {
 public:
  DataLock() = default;
  ~DataLock();
  DataLock(const DataLock&) = delete;
  DataLock& operator=(const DataLock&) = delete;

  // Exclusive lock for an import; creates the lock file when missing. Waits at most
  // `wait_seconds` for another holder; kLocked when it is still held then, kCannotWrite
  // when the lock file cannot be created or locked.
  Status lockForImport(const std::string& data_dir, double wait_seconds);

  // Shared lock for an export, so that it reads the three tables of one generation. Does
  // nothing (and succeeds) when the lock file is missing or unreadable: no import can be
  // running then that this reader could coordinate with. kLocked after the wait.
  Status lockForExport(const std::string& data_dir, double wait_seconds);

 private:
  Status waitFor(int operation, const std::string& path, double wait_seconds);

  int fd_ = -1;
};

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_DATA_LOCK_H_
