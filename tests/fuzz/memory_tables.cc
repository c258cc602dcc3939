#include "memory_tables.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <set>

#include "table_io.h"
#include "zrv_const.h"

namespace fuzzsupport {
namespace {

// Far above any descriptor the process really holds, so that a stray real close or read
// on one of them fails instead of hitting a real file.
constexpr int kFirstFd = 1 << 20;

struct MemoryFile {
  std::string path;
  const std::string* bytes = nullptr;  // null: missing
};

MemoryFile files[3];
time_t file_mtime = 0;
// Open descriptors; a descriptor's file is its offset from kFirstFd modulo 3. Readers such
// as the cable-line writer open the tables again while the request's own vpdDB holds them.
std::set<int> open_fds;
int next_fd = kFirstFd;

MemoryFile* byPath(const char* path) {
  for (MemoryFile& f : files) {
    if (f.path == path) return &f;
  }
  return nullptr;
}

MemoryFile* byFd(int fd) { return open_fds.count(fd) != 0 ? &files[(fd - kFirstFd) % 3] : nullptr; }

int memOpen(const char* path, int flags, mode_t) {
  MemoryFile* f = byPath(path);
  if (f == nullptr || f->bytes == nullptr) {
    errno = ENOENT;
    return -1;
  }
  if ((flags & O_ACCMODE) != O_RDONLY) {
    errno = EROFS;
    return -1;
  }
  int index = static_cast<int>(f - files);
  int fd = next_fd + (index - (next_fd - kFirstFd) % 3 + 3) % 3;
  next_fd = fd + 1;
  open_fds.insert(fd);
  return fd;
}

ssize_t memPread(int fd, void* buf, size_t count, off_t offset) {
  MemoryFile* f = byFd(fd);
  if (f == nullptr || offset < 0) {
    errno = EBADF;
    return -1;
  }
  const std::string& b = *f->bytes;
  if (static_cast<size_t>(offset) >= b.size()) return 0;
  size_t n = b.size() - static_cast<size_t>(offset);
  if (n > count) n = count;
  std::memcpy(buf, b.data() + offset, n);
  return static_cast<ssize_t>(n);
}

ssize_t memPwrite(int, const void*, size_t, off_t) {
  errno = EBADF;
  return -1;
}

void fill(const MemoryFile& f, struct stat* st) {
  std::memset(st, 0, sizeof *st);
  st->st_mode = S_IFREG | 0644;
  st->st_size = static_cast<off_t>(f.bytes->size());
  st->st_mtime = file_mtime;
}

int memFstat(int fd, struct stat* st) {
  MemoryFile* f = byFd(fd);
  if (f == nullptr) {
    errno = EBADF;
    return -1;
  }
  fill(*f, st);
  return 0;
}

int memStat(const char* path, struct stat* st) {
  MemoryFile* f = byPath(path);
  if (f == nullptr || f->bytes == nullptr) {
    errno = ENOENT;
    return -1;
  }
  fill(*f, st);
  return 0;
}

int memRename(const char*, const char*) {
  errno = EROFS;
  return -1;
}

int memClose(int fd) {
  if (byFd(fd) == nullptr) {
    errno = EBADF;
    return -1;
  }
  open_fds.erase(fd);
  return 0;
}

}  // namespace

MemoryTables::MemoryTables(const TableBytes& tables, const std::string& data_dir) {
  files[0] = {data_dir + "/" ZRV_CHASSIS_TABLE, tables.chassis_missing ? nullptr : &tables.chassis};
  files[1] = {data_dir + "/" ZRV_BPA_TABLE, tables.bpa_missing ? nullptr : &tables.bpa};
  files[2] = {data_dir + "/" ZRV_SMA_TABLE, tables.sma_missing ? nullptr : &tables.sma};
  file_mtime = tables.mtime;
  vpd::FileOps& ops = vpd::fileOps();
  ops.open = memOpen;
  ops.pread = memPread;
  ops.pwrite = memPwrite;
  ops.fstat = memFstat;
  ops.stat = memStat;
  ops.rename = memRename;
  ops.close = memClose;
}

MemoryTables::~MemoryTables() {
  vpd::fileOps() = vpd::posixFileOps();
  for (MemoryFile& f : files) f = MemoryFile();
  next_fd = kFirstFd;
}

int MemoryTables::openCount() { return static_cast<int>(open_fds.size()); }

}  // namespace fuzzsupport
