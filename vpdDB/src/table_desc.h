// What distinguishes the three tables: file, record size, storage key and messages.
#ifndef VPDDB_SRC_TABLE_DESC_H_
#define VPDDB_SRC_TABLE_DESC_H_

#include <cstddef>
#include <cstdint>

#include "vpd_types.h"

namespace vpd {

struct TableDesc {
  table_t table;
  const char* file_name;      // below the data directory
  const char* member;         // the table's name in messages ("chassisTbl")
  std::size_t record_size;    // bytes per record
  uint32_t key_mask;          // bits of loc_id that form the storage key
  std::size_t mtms_offset;    // byte offset of the record's own MTMS
  const char* open_failure;   // traced at level 64 by the constructors
  const char* read_failure;   // traced at level 64 by putVPD
  const char* write_failure;  // traced at level 64 by putVPD
  const char* dump_heading;   // first line of showVPD
  const char* dump_empty;     // traced at level 1 by showVPD on an empty table
};

extern const TableDesc kChassisTable;
extern const TableDesc kBpaTable;
extern const TableDesc kSmaTable;

// The table that stores records of a device type, or null for a type without a table.
const TableDesc* tableForDeviceType(unsigned int type);

}  // namespace vpd

#endif  // VPDDB_SRC_TABLE_DESC_H_
