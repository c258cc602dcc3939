// Reading the three tables back into an inventory.
#ifndef TOOLS_VPDLOAD_TABLE_EXPORT_H_
#define TOOLS_VPDLOAD_TABLE_EXPORT_H_

#include <string>
#include <vector>

#include "inventory.h"
#include "status.h"

namespace vpdload {

// Reads every whole record of the three tables of `data_dir`, in file order. Bytes after
// the last whole record of a table (which no import writes) are left out, and a warning
// saying so is added to `warnings`. kCannotRead when a table is missing or unreadable.
// Holds a shared lock meanwhile (waiting at most `wait_seconds` for an import to end), so
// that the three tables are of one generation.
Status exportTables(const std::string& data_dir, double wait_seconds, Inventory* inv,
                    std::vector<std::string>* warnings);

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_TABLE_EXPORT_H_
