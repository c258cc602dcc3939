// The VPD database: three table files of fixed-size records under the data directory
// ($OLV_ROOT/data, by default /opt/olv/data).
//
// Start here. A reader opens the tables with vpdDB(1) and asks the lookups; a producer
// starts a new generation with vpdDB() and stores records with putVPD. Record types are
// in vpd_records.h, their byte layouts in docs/table_format.md.
//
// Diagnostics go to the trace service (libchronicle), never to stdout or stderr.
// Lookups return VPD_FOUND (0) or VPD_NOT_FOUND (4); they append to or assign into
// objects the caller owns and keep no reference to them.
#ifndef VPDDB_INCLUDE_VPDDB_H_
#define VPDDB_INCLUDE_VPDDB_H_

#include <list>
#include <memory>
#include <string>

#include "fru_stanza.h"
#include "locid.h"
#include "mtms.h"
#include "return_codes.h"
#include "vpd_records.h"
#include "vpd_types.h"

namespace vpd {
struct Tables;
}

class vpdDB {
 public:
  // Read-write constructor for the producer: moves each existing table file to the same
  // path with ".old" appended and starts the table empty (created 0664 less umask).
  // Throws the int 1 (after a level-64 trace) when a table cannot be opened, or when an
  // existing table could not be moved aside (it is left as it was).
  vpdDB();
  // Read-only constructor: opens the three existing tables for reading; the argument has
  // no effect. Throws the int 1 (after a level-64 trace) when a table cannot be opened;
  // nothing is created, moved or truncated.
  explicit vpdDB(int read);
  // The same two constructors on another data directory (for producers and tests).
  explicit vpdDB(const std::string& data_dir);
  vpdDB(const std::string& data_dir, int read);
  // Closes the chassis, BPA and SMA tables, in that order.
  ~vpdDB();

  vpdDB(const vpdDB&) = delete;
  vpdDB& operator=(const vpdDB&) = delete;

  // Stores one record (an smaVPD, bpaVPD or chassisVPD, as loc_id's type says). The first
  // stored record whose key (SMA: frame, cage, chip; others: frame, cage) equals loc_id's is
  // replaced in place; a new key is appended. Returns 0 when stored or when the type has no
  // table (traced at level 1); -1 when a read or write failed (traced at level 64).
  int putVPD(loc_id_t loc_id, void* vpd_data);

  // One location and one CEC MTMS per distinct (frame, cage) of the SMA table, in the order
  // of first occurrence. 0, or 4 for an empty SMA table.
  int getCECmtms(std::list<loc_id_t>& id_list, std::list<mtms>& mtms_list);
  // SMA records of frame and cage whose chip belongs to the adapter (1: chips 0,1,4,5;
  // 2: chips 2,3,6,7), appended in table order. 0 if any, else 4.
  int getSMAvpd(unsigned int frame, unsigned int cage, unsigned int adapter,
                std::list<smaVPD>& vpd_list);
  // BPA records of one network, appended in table order. 0 if any, else 4.
  int getBPAvpdNW(unsigned int network, std::list<bpaVPD>& bpa_list);
  // First BPA record at frame and cage, assigned to bpa_vpd. 0, or 4 with bpa_vpd untouched.
  int getBPAvpd(unsigned int frame, unsigned int cage, bpaVPD& bpa_vpd);
  // First BPA record whose frame_mtms equals the argument. 0, or 4 with bpa_vpd untouched.
  int getBPAvpd(mtms frame_mtms, bpaVPD& bpa_vpd);
  // First chassis record at frame and cage. 0, or 4 with switch_vpd untouched.
  int getSwitchvpd(unsigned int frame, unsigned int cage, chassisVPD& switch_vpd);
  // All chassis records of a frame, appended in table order. 0 if any, else 4.
  int getSwitchvpd(unsigned int frame, std::list<chassisVPD>& vpd_list);
  // First chassis record whose sw_mtms equals the argument. 0, or 4 with switch_vpd untouched.
  int getSwitchvpd(mtms sw_mtms, chassisVPD& switch_vpd);
  // Chassis records of one network, appended in table order. 0 if any, else 4.
  int getSwitchvpdNW(unsigned int network, std::list<chassisVPD>& vpd_list);
  // The sw_mtms of every chassis record of a frame, appended in table order. 0 if any, else 4.
  int getSwitchmtms(unsigned int frame, std::list<mtms>& switch_mtms);
  // Modification time of the SMA table file in seconds since the epoch: 0, or -1 (level-1
  // trace, ts unchanged) when the file's status cannot be read.
  int getCECtimestamp(long& ts);
  // Writes every record of one table to standard output in readable form. Returns 0.
  int showVPD(table_t table_name);

  // The data directory this object works on.
  const std::string& dataDir() const;
  // The default data directory: $OLV_ROOT/data, or /opt/olv/data.
  static std::string defaultDataDir();

 private:
  // Moves table_name, if it exists, to table_name + ".old". Returns 0, or -1 when the table
  // exists and could not be moved (the constructor then refuses to start it empty).
  int renameFiles(const char* table_name);
  void openTables(bool read_write);

  std::unique_ptr<vpd::Tables> tables_;
};

#endif  // VPDDB_INCLUDE_VPDDB_H_
