#include "table_snapshot.h"

#include <sys/stat.h>

#include "table_io.h"

namespace vpd {

SnapshotPolicy& snapshotPolicy() {
  static SnapshotPolicy policy;
  return policy;
}

// A short-lived reader must not take a fault per page, which on a virtual machine costs more
// than reading the table. A large table is therefore read into a few huge pages, where its
// records are then also cheap to walk; a small one (or any, where huge pages are not offered)
// is mapped read-only with every page present, which copies nothing. Producers never
// truncate a table in place (a new generation is a new file), so a mapping stays valid for
// the life of the reader. Where the file cannot be mapped, it is read into ordinary memory.
TableSnapshot::TableSnapshot(int fd, const TableDesc& desc) : record_size_(desc.record_size) {
  struct stat st;
  if (fileOps().fstat(fd, &st) != 0 || st.st_size <= 0) return;
  std::size_t whole = static_cast<std::size_t>(st.st_size) / record_size_ * record_size_;
  if (whole == 0) return;
  const SnapshotPolicy& policy = snapshotPolicy();
  const bool huge = whole >= policy.copy_from_bytes && policy.huge_pages_offered();
  if (!huge) {
    if (void* mapped = fileOps().map(fd, whole)) {
      mapping_ = mapped;
      mapped_bytes_ = whole;
      data_ = static_cast<const unsigned char*>(mapped);
      count_ = whole / record_size_;
      return;
    }
  }
  copy_ = std::make_unique<TableBuffer>(whole, huge);
  if (copy_->data() == nullptr) return;  // no memory: the table reads as empty
  std::size_t got = 0;
  readAt(fd, copy_->data(), whole, 0, &got);
  data_ = copy_->data();
  count_ = got / record_size_;
}

TableSnapshot::~TableSnapshot() {
  if (mapping_ != nullptr) fileOps().unmap(mapping_, mapped_bytes_);
}

}  // namespace vpd
