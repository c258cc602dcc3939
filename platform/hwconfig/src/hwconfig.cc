#include "hwconfig.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <system_error>

#include "olv_root.h"
#include "zrv_const.h"

namespace hwserver {
namespace {

LoadResult failure(const std::string& message) {
  LoadResult result;
  result.error = message;
  return result;
}

std::string systemError(int err) { return std::generic_category().message(err); }

}  // namespace

LoadResult load() { return loadFile(olv::underRoot(ZRV_HWSERVER_CONFIG)); }

LoadResult loadFile(const std::string& path) {
  // O_NONBLOCK keeps a FIFO put in the file's place from stalling the caller; it is
  // refused below anyway.
  int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
  if (fd < 0) {
    if (errno == ENOENT) {
      LoadResult empty;
      empty.ok = true;
      return empty;
    }
    return failure(path + ": cannot open: " + systemError(errno));
  }
  struct stat st;
  if (::fstat(fd, &st) != 0) {
    int err = errno;
    ::close(fd);
    return failure(path + ": cannot read: " + systemError(err));
  }
  if (!S_ISREG(st.st_mode)) {
    ::close(fd);
    return failure(path + ": not a regular file");
  }
  std::string text;
  char buf[8192];
  for (;;) {
    ssize_t got = ::read(fd, buf, sizeof buf);
    if (got > 0) {
      text.append(buf, static_cast<size_t>(got));
    } else if (got == 0) {
      break;
    } else if (errno != EINTR) {
      int err = errno;
      ::close(fd);
      return failure(path + ": cannot read: " + systemError(err));
    }
  }
  ::close(fd);
  return parse(text, path);
}

std::string mtmsImage(const std::string& tm, const std::string& se) {
  std::string image(kMtmsImageSize, '\0');
  image.replace(0, std::min(tm.size(), kTypeModelMax), tm, 0, kTypeModelMax);
  image[kTypeModelMax] = '*';
  image.replace(kTypeModelMax + 1, std::min(se.size(), kSerialMax), se, 0, kSerialMax);
  return image;
}

const Console* findConsole(const Config& config, const unsigned char ip[4]) {
  for (const Console& console : config.consoles) {
    if (std::memcmp(console.ip.data(), ip, console.ip.size()) == 0) return &console;
  }
  return nullptr;
}

const Bpa* findBpa(const Config& config, unsigned long vport) {
  for (const Bpa& bpa : config.bpas) {
    if (bpa.vport == vport) return &bpa;
  }
  return nullptr;
}

}  // namespace hwserver
