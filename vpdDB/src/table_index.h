// Which records a lookup needs to look at, in table order.
//
// Each way of grouping the records (by frame and cage, by frame, by network, by MTMS) is
// built the second time a lookup needs it; the first time is answered by one plain pass over
// the record locations. A request that asks one question therefore builds nothing, and one
// that asks many pays for each grouping once.
#ifndef VPDDB_SRC_TABLE_INDEX_H_
#define VPDDB_SRC_TABLE_INDEX_H_

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "mtms.h"
#include "table_snapshot.h"

namespace vpd {

// Records first .. first + count - 1, which share a key. Producers store a device's records
// together, so a table is mostly long runs: grouping runs instead of records makes the
// groupings several times smaller than the tables' record counts.
struct Run {
  uint32_t key;
  uint32_t first;
  uint32_t count;
};

// Runs of records, in table order.
struct RecordRange {
  const Run* first = nullptr;
  const Run* last = nullptr;
  const Run* begin() const { return first; }
  const Run* end() const { return last; }
  bool empty() const { return first == last; }
};

class TableIndex {
 public:
  TableIndex(const TableSnapshot& snapshot, const TableDesc& desc)
      : snapshot_(snapshot), desc_(desc) {}

  // Records whose location has this frame and cage. Arguments beyond the fields' ranges
  // match nothing.
  RecordRange byFrameCage(unsigned int frame, unsigned int cage);
  RecordRange byFrame(unsigned int frame);
  RecordRange byNetwork(unsigned int network);
  // The first record whose own MTMS equals the argument (empty range when none).
  RecordRange firstByMtms(const mtms& key);
  // The first record of each distinct (frame, cage), in order of first occurrence.
  RecordRange firstOfEachFrameCage();

 private:
  struct Grouping {
    int uses = 0;
    std::vector<Run> sorted;  // by key, then table order
  };
  template <class KeyOf>
  RecordRange lookup(Grouping& g, uint32_t key, KeyOf key_of);
  static std::string mtmsKey(const mtms& m);
  mtms recordMtms(std::size_t i) const;

  const TableSnapshot& snapshot_;
  const TableDesc& desc_;
  std::vector<Run> scratch_;  // answer of the latest plain pass

  Grouping frame_cage_, frame_, network_;
  int mtms_uses_ = 0;
  std::unordered_map<std::string, uint32_t> first_by_mtms_;
};

}  // namespace vpd

#endif  // VPDDB_SRC_TABLE_INDEX_H_
