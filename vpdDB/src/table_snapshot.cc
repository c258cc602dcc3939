#include "table_snapshot.h"

#include <sys/mman.h>
#include <sys/stat.h>

#include "table_io.h"

namespace vpd {

// The table's whole records are mapped read-only with every page present: a short-lived
// reader then neither copies the table nor takes a fault per page, which on a virtual machine
// costs more than reading the table. Producers never truncate a table in place (a new
// generation is a new file), so the mapping stays valid for the life of the reader.
// Where the file cannot be mapped, it is read into an anonymous buffer populated in one call.
TableSnapshot::TableSnapshot(int fd, const TableDesc& desc) : record_size_(desc.record_size) {
  struct stat st;
  if (fileOps().fstat(fd, &st) != 0 || st.st_size <= 0) return;
  std::size_t whole = static_cast<std::size_t>(st.st_size) / record_size_ * record_size_;
  if (whole == 0) return;
  if (void* mapped = fileOps().map(fd, whole)) {
    data_ = static_cast<unsigned char*>(mapped);
    capacity_ = whole;
    mapped_file_ = true;
    count_ = whole / record_size_;
    return;
  }
  void* buffer = mmap(nullptr, whole, PROT_READ | PROT_WRITE,
                      MAP_PRIVATE | MAP_ANONYMOUS | MAP_POPULATE, -1, 0);
  if (buffer == MAP_FAILED) return;  // no memory: the table reads as empty
  data_ = static_cast<unsigned char*>(buffer);
  capacity_ = whole;
  std::size_t got = 0;
  readAt(fd, data_, whole, 0, &got);
  count_ = got / record_size_;
}

TableSnapshot::~TableSnapshot() {
  if (data_ == nullptr) return;
  if (mapped_file_) {
    fileOps().unmap(data_, capacity_);
  } else {
    munmap(data_, capacity_);
  }
}

}  // namespace vpd
