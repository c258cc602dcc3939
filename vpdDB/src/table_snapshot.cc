#include "table_snapshot.h"

#include <sys/stat.h>

#include "table_io.h"

namespace vpd {
namespace {

constexpr std::size_t kReadChunk = 1 << 20;  // bytes asked for per read beyond the known size

}  // namespace

TableSnapshot::TableSnapshot(int fd, const TableDesc& desc) : record_size_(desc.record_size) {
  struct stat st;
  std::size_t expected = 0;
  if (fileOps().fstat(fd, &st) == 0 && st.st_size > 0) {
    expected = static_cast<std::size_t>(st.st_size);
  }
  // Read to the real end of the file, which may have grown since the status was taken.
  std::size_t have = 0;
  bytes_.resize(expected + record_size_);
  for (;;) {
    if (bytes_.size() - have < record_size_) bytes_.resize(bytes_.size() + kReadChunk);
    std::size_t got = 0;
    ReadOutcome outcome =
        readAt(fd, bytes_.data() + have, bytes_.size() - have, static_cast<off_t>(have), &got);
    have += got;
    if (outcome != ReadOutcome::kWhole) break;
  }
  count_ = have / record_size_;
  bytes_.resize(count_ * record_size_);
  bytes_.shrink_to_fit();
}

}  // namespace vpd
