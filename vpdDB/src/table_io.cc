#include "table_io.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>

namespace vpd {
namespace {

int posixOpen(const char* path, int flags, mode_t mode) { return ::open(path, flags, mode); }
int posixStat(const char* path, struct stat* st) { return ::stat(path, st); }
void* posixMap(int fd, size_t length) {
  void* p = ::mmap(nullptr, length, PROT_READ, MAP_PRIVATE | MAP_POPULATE, fd, 0);
  return p == MAP_FAILED ? nullptr : p;
}

unsigned long open_count = 0;

}  // namespace

const FileOps& posixFileOps() {
  static const FileOps ops = {posixOpen, ::pread, ::pwrite, ::fstat, posixStat,
                              ::rename,  ::close, posixMap, ::munmap};
  return ops;
}

FileOps& fileOps() {
  static FileOps ops = posixFileOps();
  return ops;
}

unsigned long tableOpenCount() { return open_count; }

int openTable(const char* path, int flags, mode_t mode) {
  int fd;
  do {
    fd = fileOps().open(path, flags | O_CLOEXEC, mode);
  } while (fd < 0 && errno == EINTR);
  if (fd >= 0) ++open_count;
  return fd;
}

ReadOutcome readAt(int fd, void* buf, size_t count, off_t offset, size_t* got) {
  size_t done = 0;
  char* p = static_cast<char*>(buf);
  while (done < count) {
    ssize_t n = fileOps().pread(fd, p + done, count - done, offset + static_cast<off_t>(done));
    if (n < 0 && errno == EINTR) continue;
    if (n < 0) {
      if (got != nullptr) *got = done;
      return ReadOutcome::kError;
    }
    if (n == 0) break;
    done += static_cast<size_t>(n);
  }
  if (got != nullptr) *got = done;
  return done == count ? ReadOutcome::kWhole : ReadOutcome::kShort;
}

bool writeAt(int fd, const void* buf, size_t count, off_t offset) {
  size_t done = 0;
  const char* p = static_cast<const char*>(buf);
  while (done < count) {
    ssize_t n = fileOps().pwrite(fd, p + done, count - done, offset + static_cast<off_t>(done));
    if (n < 0 && errno == EINTR) continue;
    if (n <= 0) return false;
    done += static_cast<size_t>(n);
  }
  return true;
}

FileHandle& FileHandle::operator=(FileHandle&& o) noexcept {
  if (this != &o) {
    reset();
    fd_ = o.fd_;
    o.fd_ = -1;
  }
  return *this;
}

void FileHandle::reset() {
  if (fd_ >= 0) fileOps().close(fd_);
  fd_ = -1;
}

}  // namespace vpd
