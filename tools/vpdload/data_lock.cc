#include "data_lock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <thread>

#include "table_files.h"

namespace vpdload {

std::string errnoText(int err) { return std::strerror(err); }

DataLock::~DataLock() {
  if (fd_ >= 0) ::close(fd_);
}

Status DataLock::lockForImport(const std::string& data_dir, double wait_seconds) {
  std::string path = joinPath(data_dir, kLockFile);
  fd_ = ::open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0664);
  if (fd_ < 0) {
    const int err = errno;
    return Status::Fail(Outcome::kCannotWrite,
                        "cannot create the lock file " + path + ": " + errnoText(err));
  }
  return waitFor(LOCK_EX, path, wait_seconds);
}

Status DataLock::lockForExport(const std::string& data_dir, double wait_seconds) {
  std::string path = joinPath(data_dir, kLockFile);
  fd_ = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
  if (fd_ < 0) return Status::Ok();
  return waitFor(LOCK_SH, path, wait_seconds);
}

Status DataLock::waitFor(int operation, const std::string& path, double wait_seconds) {
  using Clock = std::chrono::steady_clock;
  const auto deadline = Clock::now() + std::chrono::duration_cast<Clock::duration>(
                                           std::chrono::duration<double>(wait_seconds));
  const auto kPoll = std::chrono::milliseconds(20);
  for (;;) {
    if (::flock(fd_, operation | LOCK_NB) == 0) return Status::Ok();
    if (errno == EINTR) continue;
    if (errno != EWOULDBLOCK) {
      const int err = errno;
      return Status::Fail(Outcome::kCannotWrite, "cannot lock " + path + ": " + errnoText(err));
    }
    auto now = Clock::now();
    if (now >= deadline) break;
    std::this_thread::sleep_for(std::min<Clock::duration>(kPoll, deadline - now));
  }
  char waited[32];
  std::snprintf(waited, sizeof waited, "%g", wait_seconds);
  return Status::Fail(Outcome::kLocked, "another import holds the lock " + path +
                                            "; gave up after waiting " + waited +
                                            " seconds (see --wait)");
}

}  // namespace vpdload
