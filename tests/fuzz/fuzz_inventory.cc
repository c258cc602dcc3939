// The inventory JSON of an import through its validation (nothing is written). An accepted
// inventory must survive export and re-import unchanged, byte for byte in every record; a
// refused one must say what is wrong.
#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "fuzz_check.h"
#include "inventory_schema.h"

namespace {

template <class Record>
bool sameRecords(const std::vector<Record>& a, const std::vector<Record>& b) {
  if (a.size() != b.size()) return false;
  return a.empty() ||
         std::memcmp(static_cast<const void*>(a.data()), static_cast<const void*>(b.data()),
                     a.size() * sizeof(Record)) == 0;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::string text(reinterpret_cast<const char*>(data), size);
  vpdload::Inventory inv;
  vpdload::Problems problems = vpdload::parseInventory(text, &inv);
  if (!problems.empty()) {
    FUZZ_CHECK(!problems.list.empty() && problems.list.size() <= vpdload::Problems::kMaxKept);
    FUZZ_CHECK(problems.total >= problems.list.size());
    for (const std::string& p : problems.list) FUZZ_CHECK(!p.empty());
    return 0;
  }
  FUZZ_CHECK(problems.list.empty());

  std::string exported = vpdload::formatJson(vpdload::inventoryToJson(inv));
  vpdload::Inventory again;
  vpdload::Problems reread = vpdload::parseInventory(exported, &again);
  FUZZ_CHECK(reread.empty());
  FUZZ_CHECK(sameRecords(inv.sma, again.sma));
  FUZZ_CHECK(sameRecords(inv.chassis, again.chassis));
  FUZZ_CHECK(sameRecords(inv.bpa, again.bpa));
  FUZZ_CHECK(vpdload::formatJson(vpdload::inventoryToJson(again)) == exported);
  return 0;
}
