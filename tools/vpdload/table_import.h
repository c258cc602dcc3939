// Storing an inventory as the new generation of the three tables.
#ifndef TOOLS_VPDLOAD_TABLE_IMPORT_H_
#define TOOLS_VPDLOAD_TABLE_IMPORT_H_

#include <string>

#include "inventory.h"
#include "status.h"

namespace vpdload {

// Makes `inv` the content of the tables in `data_dir` (created when missing), with the
// previous generation of each table in its ".old" file, as the read-write vpdDB
// constructor leaves it.
//
// The new tables are written through vpdDB and putVPD into a private staging folder in the
// data directory, synced, and then renamed over the live names one by one, each after its
// live file was linked to the ".old" name. A reader therefore finds every table at any
// moment, whole, either of the old or of the new generation. Any failure before the renames
// (a full disk, a file size limit, an unwritable directory) leaves the live tables and their
// ".old" files as they were. The whole import holds the data directory's lock (waiting at
// most `wait_seconds` for another producer) and removes staging folders that a killed import
// left behind.
Status importTables(const Inventory& inv, const std::string& data_dir, double wait_seconds);

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_TABLE_IMPORT_H_
