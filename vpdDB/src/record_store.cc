// Storing records: the first record with the same storage key is replaced in place, a new
// key is appended. The keys of a table are read once and then kept up to date, so that a
// producer storing n records reads each table once instead of n times.
#include <sys/stat.h>

#include <cstring>

#include "tables.h"
#include "vpdDB.h"
#include "vpd_trace.h"

namespace {

const char kOperation[] = "putVPD";
constexpr std::size_t kScanChunkRecords = 512;  // records read per request while indexing

uint32_t innerLocation(const void* record) {
  uint32_t word;
  std::memcpy(&word, record, sizeof word);
  return word;
}

// Brings the store index up to date with the file. Returns false after an I/O error (traced
// by the caller); a trailing partial record is not indexed.
bool refreshStoreIndex(vpd::Table& t, uint64_t file_size) {
  vpd::StoreIndex& s = t.store;
  if (s.valid && s.file_size == file_size) return true;
  s.clear();
  const std::size_t rs = t.desc.record_size;
  std::vector<unsigned char> chunk(rs * kScanChunkRecords);
  uint64_t whole = file_size / rs;
  for (uint64_t n = 0; n < whole;) {
    std::size_t want = static_cast<std::size_t>(std::min<uint64_t>(kScanChunkRecords, whole - n));
    std::size_t got = 0;
    vpd::ReadOutcome r =
        vpd::readAt(t.file.get(), chunk.data(), want * rs, static_cast<off_t>(n * rs), &got);
    if (r == vpd::ReadOutcome::kError) return false;
    std::size_t records = got / rs;
    for (std::size_t i = 0; i < records; ++i, ++n) {
      uint32_t key = innerLocation(chunk.data() + i * rs) & t.desc.key_mask;
      s.key_of.push_back(key);
      s.records_with_key[key].insert(static_cast<uint32_t>(n));
    }
    if (r == vpd::ReadOutcome::kShort) {
      // The file shrank under us: index what is there.
      file_size = n * rs;
      break;
    }
  }
  s.file_size = file_size;
  s.valid = true;
  return true;
}

}  // namespace

int vpdDB::putVPD(loc_id_t loc_id, void* vpd_data) {
  const vpd::TableDesc* desc = vpd::tableForDeviceType(loc_id.getType());
  if (desc == nullptr) {
    VPD_TRACE(ZRV_TRACE_INFO, kOperation, loc_id, "unknow type, %d\n",
              static_cast<int>(loc_id.getType()));
    return 0;
  }
  if (vpd_data == nullptr) {
    VPD_TRACE(ZRV_TRACE_ERROR, kOperation, loc_id, "%s", desc->write_failure);
    return VPD_FAILED;
  }
  vpd::Table& t = tables_->of(*desc);
  const std::size_t rs = desc->record_size;

  struct stat st;
  if (vpd::fileOps().fstat(t.file.get(), &st) != 0 ||
      !refreshStoreIndex(t, static_cast<uint64_t>(st.st_size))) {
    // The table cannot be read: whether the key is stored is unknown, so nothing is written.
    VPD_TRACE(ZRV_TRACE_ERROR, kOperation, loc_id, "%s", desc->read_failure);
    t.store.clear();
    return VPD_FAILED;
  }
  vpd::StoreIndex& s = t.store;
  const uint32_t key = loc_id.toInt() & desc->key_mask;
  const uint32_t new_key = innerLocation(vpd_data) & desc->key_mask;

  uint64_t record_no;
  auto hit = s.records_with_key.find(key);
  bool replace = hit != s.records_with_key.end() && !hit->second.empty();
  if (replace) {
    record_no = *hit->second.begin();
  } else {
    record_no = s.file_size / rs;
    // Incomplete bytes at the end were never readable as a record: the new record takes
    // their place, so that the table is whole again.
    if (s.file_size % rs != 0)
      VPD_TRACE(ZRV_TRACE_ERROR, kOperation, loc_id, "%s", desc->read_failure);
  }

  t.forgetSnapshot();
  if (!vpd::writeAt(t.file.get(), vpd_data, rs, static_cast<off_t>(record_no * rs))) {
    VPD_TRACE(ZRV_TRACE_ERROR, kOperation, loc_id, "%s", desc->write_failure);
    s.clear();  // the file may hold part of the record now: read it again next time
    return VPD_FAILED;
  }

  if (replace) {
    uint32_t old_key = s.key_of[record_no];
    s.records_with_key[old_key].erase(static_cast<uint32_t>(record_no));
    s.key_of[record_no] = new_key;
  } else {
    s.key_of.push_back(new_key);
    s.file_size = (record_no + 1) * rs;
  }
  s.records_with_key[new_key].insert(static_cast<uint32_t>(record_no));
  return 0;
}
