// The three table files as vpdload sees them: names, record sizes, and the private names
// it uses beside them in the data directory.
#ifndef TOOLS_VPDLOAD_TABLE_FILES_H_
#define TOOLS_VPDLOAD_TABLE_FILES_H_

#include <cstddef>
#include <string>

#include "vpd_records.h"
#include "zrv_const.h"

namespace vpdload {

struct TableFile {
  const char* file;         // name in the data directory
  const char* key;          // the inventory's array for it
  std::size_t record_size;  // bytes per record
};

// In the order in which a new generation is moved into place. The SMA table comes last:
// its modification time is what a change poll watches, so when it changes, the other two
// tables are already new.
constexpr TableFile kChassisTable{ZRV_CHASSIS_TABLE, "chassis", chassisVPD::kRecordSize};
constexpr TableFile kBpaTable{ZRV_BPA_TABLE, "bpa", bpaVPD::kRecordSize};
constexpr TableFile kSmaTable{ZRV_SMA_TABLE, "sma", smaVPD::kRecordSize};
constexpr const TableFile* kTables[] = {&kChassisTable, &kBpaTable, &kSmaTable};

// Lock file that serializes producers; readers never take it.
constexpr const char* kLockFile = ".vpdload.lock";
// Prefix of the private staging folder of an import (completed by mkdtemp).
constexpr const char* kStagingPrefix = ".vpdload.";

inline std::string joinPath(const std::string& dir, const std::string& name) {
  return (dir.empty() || dir.back() == '/') ? dir + name : dir + "/" + name;
}

// strerror of an errno value, for messages.
std::string errnoText(int err);

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_TABLE_FILES_H_
