// Opening and closing the tables, the ".old" generation, and the SMA table's time.
#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <string>

#include "olv_root.h"
#include "tables.h"
#include "vpdDB.h"
#include "vpd_trace.h"

namespace {

constexpr mode_t kTableMode = 0664;  // less the process umask
const char kOperation[] = "vpdDB";

}  // namespace

std::string vpdDB::defaultDataDir() { return olv::underRoot(ZRV_DATA_DIR); }

vpdDB::vpdDB() : vpdDB(defaultDataDir()) {}

vpdDB::vpdDB(int read) : vpdDB(defaultDataDir(), read) {}

vpdDB::vpdDB(const std::string& data_dir) : tables_(std::make_unique<vpd::Tables>()) {
  tables_->data_dir = data_dir;
  vpd::loadHostname();
  for (vpd::Table* t : {&tables_->chassisTbl, &tables_->bpaTbl, &tables_->smaTbl}) {
    t->path = data_dir + "/" + t->desc.file_name;
    t->kept_previous = renameFiles(t->path.c_str()) == 0;
  }
  openTables(true);
}

vpdDB::vpdDB(const std::string& data_dir, int /*read*/) : tables_(std::make_unique<vpd::Tables>()) {
  tables_->data_dir = data_dir;
  vpd::loadHostname();
  for (vpd::Table* t : {&tables_->chassisTbl, &tables_->bpaTbl, &tables_->smaTbl}) {
    t->path = data_dir + "/" + t->desc.file_name;
  }
  openTables(false);
}

// Opens the chassis, BPA and SMA tables in that order. The first that fails is traced and
// ends the construction; the ones opened before it are closed as the tables are destroyed.
void vpdDB::openTables(bool read_write) {
  int flags = read_write ? (O_RDWR | O_CREAT | O_TRUNC) : O_RDONLY;
  for (vpd::Table* t : {&tables_->chassisTbl, &tables_->bpaTbl, &tables_->smaTbl}) {
    // A previous generation that could not be moved aside is never truncated: it would be
    // lost, and readers that have it open would see it shrink.
    if (t->kept_previous) {
      t->file = vpd::FileHandle(vpd::openTable(t->path.c_str(), flags, kTableMode));
    }
    if (!t->file.valid()) {
      VPD_TRACE(ZRV_TRACE_ERROR, kOperation, loc_id_t(0), "%s", t->desc.open_failure);
      tables_.reset();
      throw VPD_OPEN_FAILED;
    }
    // A fresh generation is known to be empty: putVPD need not read it.
    if (read_write) {
      t->store.clear();
      t->store.valid = true;
    }
  }
}

vpdDB::~vpdDB() {
  if (tables_) {
    tables_->chassisTbl.file.reset();
    tables_->bpaTbl.file.reset();
    tables_->smaTbl.file.reset();
  }
}

const std::string& vpdDB::dataDir() const { return tables_->data_dir; }

// Returns 0 when there was no table or it was moved, -1 when a table is there and stays.
// A table that exists but cannot be read is moved as well: it is still the previous
// generation.
int vpdDB::renameFiles(const char* table_name) {
  vpd::FileHandle probe(vpd::openTable(table_name, O_RDONLY, kTableMode));
  if (!probe.valid() && errno == ENOENT) return 0;
  std::string old_name = std::string(table_name) + ZRV_OLD_SUFFIX;
  return vpd::fileOps().rename(table_name, old_name.c_str()) == 0 ? 0 : -1;
}

int vpdDB::getCECtimestamp(long& ts) {
  struct stat st;
  if (vpd::fileOps().stat(tables_->smaTbl.path.c_str(), &st) != 0) {
    VPD_TRACE(ZRV_TRACE_INFO, "getCECtimestamp", loc_id_t(0), "the file status is not available");
    return VPD_FAILED;
  }
  ts = static_cast<long>(st.st_mtime);
  return 0;
}
