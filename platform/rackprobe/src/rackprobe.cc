// Stand-in for the console's rackprobe: "rackprobe dump -d" prints the installation's
// device lines, kept as plain text in $OLV_ROOT/etc/rackprobe.dump (format in README.md).
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <string>
#include <system_error>

#include "olv_root.h"

namespace {

constexpr const char kDumpFile[] = "etc/rackprobe.dump";

enum ExitStatus { kDone = 0, kFailed = 1, kUsage = 2 };

int complain(const std::string& what, int err) {
  std::fprintf(stderr, "rackprobe: %s: %s\n", what.c_str(),
               std::generic_category().message(err).c_str());
  return kFailed;
}

bool writeAll(int fd, const char* data, size_t size) {
  while (size > 0) {
    ssize_t n = ::write(fd, data, size);
    if (n < 0) {
      if (errno == EINTR) continue;
      return false;
    }
    data += n;
    size -= static_cast<size_t>(n);
  }
  return true;
}

// Copies the dump file to standard output unchanged; a missing file is an installation
// without devices.
int dump() {
  std::string path = olv::underRoot(kDumpFile);
  // O_NONBLOCK so that a FIFO in the file's place cannot stall the caller; it is refused.
  int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
  if (fd < 0) return errno == ENOENT ? kDone : complain(path, errno);
  struct stat st;
  if (::fstat(fd, &st) != 0) {
    int err = errno;
    ::close(fd);
    return complain(path, err);
  }
  if (!S_ISREG(st.st_mode)) {
    ::close(fd);
    std::fprintf(stderr, "rackprobe: %s: not a regular file\n", path.c_str());
    return kFailed;
  }
  char buf[65536];
  for (;;) {
    ssize_t got = ::read(fd, buf, sizeof buf);
    if (got == 0) break;
    if (got < 0) {
      if (errno == EINTR) continue;
      int err = errno;
      ::close(fd);
      return complain(path, err);
    }
    if (!writeAll(STDOUT_FILENO, buf, static_cast<size_t>(got))) {
      int err = errno;
      ::close(fd);
      return complain("standard output", err);
    }
  }
  ::close(fd);
  return kDone;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc == 3 && std::strcmp(argv[1], "dump") == 0 && std::strcmp(argv[2], "-d") == 0) {
    return dump();
  }
  std::fputs(
      "usage: rackprobe dump -d\n"
      "  prints the device lines of the installation from $OLV_ROOT/etc/rackprobe.dump\n",
      stderr);
  return kUsage;
}
