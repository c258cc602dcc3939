// Indexes over a table snapshot, each built the first time a lookup needs it. Every list of
// record numbers is in table order, so the first entry is the first match of a scan.
#ifndef VPDDB_SRC_TABLE_INDEX_H_
#define VPDDB_SRC_TABLE_INDEX_H_

#include <cstdint>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "mtms.h"
#include "table_snapshot.h"

namespace vpd {

using RecordList = std::vector<uint32_t>;

class TableIndex {
 public:
  TableIndex(const TableSnapshot& snapshot, const TableDesc& desc)
      : snapshot_(snapshot), desc_(desc) {}

  // Records whose location has this frame and cage. Arguments beyond the fields' ranges
  // match nothing.
  const RecordList& byFrameCage(unsigned int frame, unsigned int cage);
  // The distinct (frame, cage) pairs, each as its first record, in order of first occurrence.
  const RecordList& firstOfEachFrameCage();
  const RecordList& byFrame(unsigned int frame);
  const RecordList& byNetwork(unsigned int network);
  // The first record whose own MTMS equals the argument, or -1.
  long firstByMtms(const mtms& key);

 private:
  void buildFrameCage();
  static std::string mtmsKey(const mtms& m);

  const TableSnapshot& snapshot_;
  const TableDesc& desc_;
  const RecordList empty_;

  bool frame_cage_built_ = false;
  std::unordered_map<uint32_t, RecordList> frame_cage_;
  RecordList first_of_frame_cage_;

  bool frame_built_ = false;
  std::unordered_map<uint32_t, RecordList> frame_;

  bool network_built_ = false;
  std::vector<RecordList> network_;

  bool mtms_built_ = false;
  std::unordered_map<std::string, uint32_t> mtms_;
};

}  // namespace vpd

#endif  // VPDDB_SRC_TABLE_INDEX_H_
