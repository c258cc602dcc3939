// putVPD: a producer storing n records into a fresh generation, and storing them again
// (every call then replaces a record in place). Both should grow linearly with n.
#include <benchmark/benchmark.h>

#include <vector>

#include "bench_installation.h"
#include "installation_records.h"
#include "vpdDB.h"

namespace benchgen {
namespace {

// n SMA records of a layout with CECs enough for them.
std::vector<smaVPD> smaRecords(int64_t n) {
  static gen::Layout layout(gen::Params::scaled(128));
  std::vector<smaVPD> records;
  records.reserve(static_cast<std::size_t>(n));
  for (int64_t i = 0; i < n; ++i) {
    unsigned int c = static_cast<unsigned int>(i / 8), chip = static_cast<unsigned int>(i % 8);
    records.push_back(gen::smaRecord(layout, c, chip));
  }
  return records;
}

void storeAll(benchmark::State& state, vpdDB& db, std::vector<smaVPD>& records) {
  for (smaVPD& r : records) {
    if (db.putVPD(r.loc_id, &r) != 0) return state.SkipWithError("putVPD failed");
  }
}

void BM_PutVPD_New(benchmark::State& state) {
  std::vector<smaVPD> records = smaRecords(state.range(0));
  const std::string dir = scratchDir();
  for (auto _ : state) {
    vpdDB db(dir);  // a new, empty generation each time
    storeAll(state, db, records);
  }
  state.SetItemsProcessed(static_cast<int64_t>(state.iterations() * records.size()));
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_PutVPD_New)
    ->RangeMultiplier(4)
    ->Range(1 << 10, 1 << 16)
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

// The first pass fills the table (not timed); the timed pass replaces every record, last
// key first, so each call has to find its record rather than append.
void BM_PutVPD_Replace(benchmark::State& state) {
  std::vector<smaVPD> records = smaRecords(state.range(0));
  std::vector<smaVPD> reversed(records.rbegin(), records.rend());
  const std::string dir = scratchDir();
  for (auto _ : state) {
    state.PauseTiming();
    vpdDB db(dir);
    storeAll(state, db, records);
    state.ResumeTiming();
    storeAll(state, db, reversed);
  }
  state.SetItemsProcessed(static_cast<int64_t>(state.iterations() * records.size()));
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_PutVPD_Replace)
    ->RangeMultiplier(4)
    ->Range(1 << 10, 1 << 16)
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

}  // namespace
}  // namespace benchgen
