#include "table_export.h"

#include <cerrno>
#include <cstring>
#include <fstream>

#include "data_lock.h"
#include "table_files.h"

namespace vpdload {

namespace {

template <typename Record>
Status readTable(const std::string& data_dir, const TableFile& table, std::vector<Record>* out,
                 std::vector<std::string>* warnings) {
  static_assert(sizeof(Record) == Record::kRecordSize, "records are read as they lie on disk");
  std::string path = joinPath(data_dir, table.file);
  std::ifstream in(path, std::ios::binary);
  if (!in) {
    const int err = errno;
    return Status::Fail(Outcome::kCannotRead, "cannot read " + path + ": " + errnoText(err));
  }
  char buf[Record::kRecordSize];
  for (;;) {
    in.read(buf, sizeof buf);
    std::streamsize got = in.gcount();
    if (got == static_cast<std::streamsize>(sizeof buf)) {
      out->emplace_back();
      std::memcpy(static_cast<void*>(&out->back()), buf, sizeof buf);
      continue;
    }
    if (in.bad()) {
      const int err = errno;
      return Status::Fail(Outcome::kCannotRead, "cannot read " + path + ": " + errnoText(err));
    }
    if (got > 0) {
      warnings->push_back(path + " ends with " + std::to_string(got) +
                          " bytes that are not a whole record; they are left out");
    }
    return Status::Ok();
  }
}

}  // namespace

Status exportTables(const std::string& data_dir, double wait_seconds, Inventory* inv,
                    std::vector<std::string>* warnings) {
  DataLock lock;
  Status s = lock.lockForExport(data_dir, wait_seconds);
  if (s.ok()) s = readTable(data_dir, kSmaTable, &inv->sma, warnings);
  if (s.ok()) s = readTable(data_dir, kChassisTable, &inv->chassis, warnings);
  if (s.ok()) s = readTable(data_dir, kBpaTable, &inv->bpa, warnings);
  return s;
}

}  // namespace vpdload
