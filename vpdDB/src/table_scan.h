// The one table scan behind every lookup. A lookup names its table, the records worth
// looking at (from an index, in table order), a selection rule and what to do with a
// selected record; the scan reports whether the table was empty, nothing was selected, or
// something was. Lookups differ only in those pieces and in their messages.
#ifndef VPDDB_SRC_TABLE_SCAN_H_
#define VPDDB_SRC_TABLE_SCAN_H_

#include "return_codes.h"
#include "tables.h"
#include "vpd_trace.h"

namespace vpd {

enum class ScanOutcome { kEmptyTable, kNoneSelected, kSelected };

// How many records a scan takes.
enum class Take { kFirst, kAll };

// Visits `candidates` (records in table order) of table `t`, copying each into a
// fresh scan record; `select` decides, `accept` receives each selected record. Only whole
// records are ever examined.
template <class Record, class Select, class Accept>
ScanOutcome scanTable(Table& t, RecordRange candidates, Take take, Select select, Accept accept) {
  const TableSnapshot& snapshot = t.snapshot();
  if (snapshot.count() == 0) return ScanOutcome::kEmptyTable;
  bool selected = false;
  Record scan_record;
  for (const Run& run : candidates) {
    for (uint32_t i = run.first; i != run.first + run.count; ++i) {
      snapshot.copyInto(i, scan_record);
      if (!select(scan_record)) continue;
      accept(scan_record);
      if (take == Take::kFirst) return ScanOutcome::kSelected;
      selected = true;
    }
  }
  return selected ? ScanOutcome::kSelected : ScanOutcome::kNoneSelected;
}

// Traces the outcome of a lookup at level 1 the way every lookup does, and gives its result.
// `not_found` traces the lookup's own not-found message.
template <class NotFound>
int lookupResult(ScanOutcome outcome, const char* operation, const char* empty_text,
                 NotFound not_found) {
  switch (outcome) {
    case ScanOutcome::kSelected:
      return VPD_FOUND;
    case ScanOutcome::kEmptyTable:
      VPD_TRACE(ZRV_TRACE_INFO, operation, loc_id_t(0), "%s", empty_text);
      return VPD_NOT_FOUND;
    case ScanOutcome::kNoneSelected:
      break;
  }
  not_found();
  return VPD_NOT_FOUND;
}

// Formats %d of an unsigned argument as the signed number it reads as.
inline int asSigned(unsigned int v) { return static_cast<int>(v); }

}  // namespace vpd

#endif  // VPDDB_SRC_TABLE_SCAN_H_
