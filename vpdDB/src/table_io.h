// File access of the tables, behind one narrow seam so that tests can fail an open, a
// read, a write or a status query.
#ifndef VPDDB_SRC_TABLE_IO_H_
#define VPDDB_SRC_TABLE_IO_H_

#include <sys/stat.h>
#include <sys/types.h>

#include <cstddef>

namespace vpd {

struct FileOps {
  int (*open)(const char* path, int flags, mode_t mode);
  ssize_t (*pread)(int fd, void* buf, size_t count, off_t offset);
  ssize_t (*pwrite)(int fd, const void* buf, size_t count, off_t offset);
  int (*fstat)(int fd, struct stat* st);
  int (*stat)(const char* path, struct stat* st);
  int (*rename)(const char* from, const char* to);
  int (*close)(int fd);
  // Maps length bytes of the file read-only, all pages present; null when it cannot.
  void* (*map)(int fd, size_t length);
  int (*unmap)(void* address, size_t length);
};

// The operations in use; tests may replace entries and must restore them.
FileOps& fileOps();
// The plain POSIX operations.
const FileOps& posixFileOps();

// How many table files this process has opened (for tests and benchmarks).
unsigned long tableOpenCount();

// Opens a file through the seam and counts it; EINTR is retried.
int openTable(const char* path, int flags, mode_t mode);

// Outcome of reading a range of a file.
enum class ReadOutcome { kWhole, kShort, kError };

// Reads up to count bytes at offset, retrying short reads and EINTR. kShort: the end of
// the file came first (*got tells how much arrived); kError: an I/O error.
ReadOutcome readAt(int fd, void* buf, size_t count, off_t offset, size_t* got);

// Writes all bytes at offset, retrying short writes and EINTR. False on any failure.
bool writeAt(int fd, const void* buf, size_t count, off_t offset);

// Owns one open file descriptor.
class FileHandle {
 public:
  FileHandle() = default;
  explicit FileHandle(int fd) : fd_(fd) {}
  ~FileHandle() { reset(); }
  FileHandle(FileHandle&& o) noexcept : fd_(o.fd_) { o.fd_ = -1; }
  FileHandle& operator=(FileHandle&& o) noexcept;
  FileHandle(const FileHandle&) = delete;
  FileHandle& operator=(const FileHandle&) = delete;
  int get() const { return fd_; }
  bool valid() const { return fd_ >= 0; }
  void reset();

 private:
  int fd_ = -1;
};

}  // namespace vpd

#endif  // VPDDB_SRC_TABLE_IO_H_
