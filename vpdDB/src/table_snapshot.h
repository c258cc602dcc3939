// A table read once into memory: the whole records it held when it was first needed.
#ifndef VPDDB_SRC_TABLE_SNAPSHOT_H_
#define VPDDB_SRC_TABLE_SNAPSHOT_H_

#include <cstdint>
#include <cstring>
#include <memory>

#include "locid.h"
#include "table_buffer.h"
#include "table_desc.h"

namespace vpd {

// How a table gets into memory. A table of at least copy_from_bytes is read into a buffer of
// huge pages where the kernel offers them; a smaller one is mapped. Tests change it to take
// each path.
struct SnapshotPolicy {
  std::size_t copy_from_bytes = std::size_t{1} << 20;
  bool (*huge_pages_offered)() = hugePagesOffered;
};
SnapshotPolicy& snapshotPolicy();

class TableSnapshot {
 public:
  // Reads the open file's whole records from offset 0, as long as the file was when the
  // snapshot was taken. A trailing partial record, and anything after an I/O error, is left
  // out: only whole records are ever examined.
  TableSnapshot(int fd, const TableDesc& desc);
  ~TableSnapshot();
  TableSnapshot(const TableSnapshot&) = delete;
  TableSnapshot& operator=(const TableSnapshot&) = delete;

  std::size_t count() const { return count_; }
  std::size_t recordSize() const { return record_size_; }
  const unsigned char* record(std::size_t i) const { return data_ + i * record_size_; }

  // A byte-for-byte copy of record i into a record object.
  template <class Record>
  void copyInto(std::size_t i, Record& out) const {
    static_assert(sizeof(Record) >= 4, "records begin with their location");
    std::memcpy(static_cast<void*>(&out), record(i), sizeof(Record));
  }

  loc_id_t location(std::size_t i) const {
    uint32_t word;
    std::memcpy(&word, record(i), sizeof word);
    return loc_id_t(word);
  }

 private:
  const unsigned char* data_ = nullptr;
  void* mapping_ = nullptr;  // the file's own pages, when mapped
  std::size_t mapped_bytes_ = 0;
  std::unique_ptr<TableBuffer> copy_;  // a copy of the records, when not mapped
  std::size_t record_size_;
  std::size_t count_ = 0;
};

}  // namespace vpd

#endif  // VPDDB_SRC_TABLE_SNAPSHOT_H_
