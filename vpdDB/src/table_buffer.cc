#include "table_buffer.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include <cstdint>
#include <cstring>

namespace vpd {
namespace {

constexpr std::size_t kHugePage = std::size_t{2} << 20;
#ifndef MADV_POPULATE_WRITE
constexpr int MADV_POPULATE_WRITE = 23;  // Linux 5.14; older kernels refuse it harmlessly
#endif

bool readHugePageMode() {
  int fd = ::open("/sys/kernel/mm/transparent_hugepage/enabled", O_RDONLY | O_CLOEXEC);
  if (fd < 0) return false;
  char text[128] = {};
  ssize_t got = ::read(fd, text, sizeof text - 1);
  ::close(fd);
  if (got <= 0) return false;
  return std::strstr(text, "[always]") != nullptr || std::strstr(text, "[madvise]") != nullptr;
}

std::size_t roundUp(std::size_t n, std::size_t unit) { return (n + unit - 1) / unit * unit; }

}  // namespace

bool hugePagesOffered() {
  static const bool offered = readHugePageMode();
  return offered;
}

TableBuffer::TableBuffer(std::size_t bytes, bool huge) {
  if (bytes == 0) return;
  if (!huge) {
    void* p = ::mmap(nullptr, bytes, PROT_READ | PROT_WRITE,
                     MAP_PRIVATE | MAP_ANONYMOUS | MAP_POPULATE, -1, 0);
    if (p == MAP_FAILED) return;
    data_ = static_cast<unsigned char*>(p);
    size_ = bytes;
    return;
  }
  // Reserve one huge page more than needed, keep the aligned part and give the rest back.
  const std::size_t size = roundUp(bytes, kHugePage);
  if (size < bytes || size + kHugePage < size) return;
  void* p =
      ::mmap(nullptr, size + kHugePage, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
  if (p == MAP_FAILED) return;
  auto* raw = static_cast<unsigned char*>(p);
  auto* aligned =
      reinterpret_cast<unsigned char*>(roundUp(reinterpret_cast<std::uintptr_t>(raw), kHugePage));
  const std::size_t head = static_cast<std::size_t>(aligned - raw);
  if (head > 0) ::munmap(raw, head);
  if (kHugePage - head > 0) ::munmap(aligned + size, kHugePage - head);
  // Each page touched for the first time costs a fault, and a fault is dear on a virtual
  // machine: a few huge pages instead of a thousand small ones, all present in one call.
  // Both calls are advice; without them the memory still works.
  ::madvise(aligned, size, MADV_HUGEPAGE);
  ::madvise(aligned, size, MADV_POPULATE_WRITE);
  data_ = aligned;
  size_ = size;
}

TableBuffer::~TableBuffer() {
  if (data_ != nullptr) ::munmap(data_, size_);
}

}  // namespace vpd
