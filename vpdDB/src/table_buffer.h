// Anonymous memory that holds a copy of a table.
#ifndef VPDDB_SRC_TABLE_BUFFER_H_
#define VPDDB_SRC_TABLE_BUFFER_H_

#include <cstddef>

namespace vpd {

// Whether the kernel hands out transparent huge pages to a process that asks for them
// ("always" or "madvise"); read once per process.
bool hugePagesOffered();

// Zero-filled memory of at least `bytes`, every page present. With huge set, the memory is
// aligned to and advised for 2 MiB pages. Null when there is no memory.
class TableBuffer {
 public:
  TableBuffer(std::size_t bytes, bool huge);
  ~TableBuffer();
  TableBuffer(const TableBuffer&) = delete;
  TableBuffer& operator=(const TableBuffer&) = delete;

  unsigned char* data() const { return data_; }

 private:
  unsigned char* data_ = nullptr;
  std::size_t size_ = 0;
};

}  // namespace vpd

#endif  // VPDDB_SRC_TABLE_BUFFER_H_
