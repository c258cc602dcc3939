// The open tables of one vpdDB: a file, a snapshot read on first use, and its indexes.
#ifndef VPDDB_SRC_TABLES_H_
#define VPDDB_SRC_TABLES_H_

#include <cstdint>
#include <memory>
#include <set>
#include <string>
#include <unordered_map>
#include <vector>

#include "table_desc.h"
#include "table_index.h"
#include "table_io.h"
#include "table_snapshot.h"

namespace vpd {

// What putVPD knows of a table so that it need not rescan it for every record: the storage
// key of every record and, per key, the records that hold it. Trusted only while the file
// has the length it had when the index was last brought up to date.
struct StoreIndex {
  bool valid = false;
  uint64_t file_size = 0;
  std::vector<uint32_t> key_of;  // storage key of record n
  std::unordered_map<uint32_t, std::set<uint32_t>> records_with_key;

  void clear() {
    valid = false;
    file_size = 0;
    key_of.clear();
    records_with_key.clear();
  }
};

struct Table {
  explicit Table(const TableDesc& d) : desc(d) {}

  const TableDesc& desc;
  std::string path;
  bool kept_previous = true;  // false: the previous generation could not be moved aside
  FileHandle file;
  StoreIndex store;

  // The snapshot, read on first use; the same generation the file was opened on.
  const TableSnapshot& snapshot() {
    if (!snapshot_) snapshot_ = std::make_unique<TableSnapshot>(file.get(), desc);
    return *snapshot_;
  }
  TableIndex& index() {
    if (!index_) index_ = std::make_unique<TableIndex>(snapshot(), desc);
    return *index_;
  }
  // After a write, the next lookup reads the table again.
  void forgetSnapshot() {
    index_.reset();
    snapshot_.reset();
  }

 private:
  std::unique_ptr<TableSnapshot> snapshot_;
  std::unique_ptr<TableIndex> index_;
};

struct Tables {
  std::string data_dir;
  Table chassisTbl{kChassisTable};
  Table bpaTbl{kBpaTable};
  Table smaTbl{kSmaTable};

  Table& of(const TableDesc& d) {
    return &d == &kChassisTable ? chassisTbl : &d == &kBpaTable ? bpaTbl : smaTbl;
  }
};

}  // namespace vpd

#endif  // VPDDB_SRC_TABLES_H_
