// The lookups of vpdDB, cold and warm, on installations of growing size.
//
// Cold: a fresh read-only vpdDB and its first lookup, so the table is read into its snapshot
// and the lookup's index is built; the key is the last record, the worst place for a scan.
// Warm: the same vpdDB asked again and again, cycling through every key of the table.
// ReadTable is the floor: reading the same table file once into memory.
#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <list>
#include <vector>

#include "bench_installation.h"
#include "vpdDB.h"
#include "zrv_const.h"

namespace benchgen {
namespace {

const int kScales[] = {1, 4, 16, 64};

struct LookupForm {
  const char* name;
  const char* table;  // the file it reads
  unsigned int (*keys)(const gen::Layout&);
  int (*run)(vpdDB&, const gen::Layout&, unsigned int key);
};

unsigned int switches(const gen::Layout& l) { return l.switchCount(); }
unsigned int frames(const gen::Layout& l) { return l.params().frames; }
unsigned int cecs(const gen::Layout& l) { return l.params().cecs; }
unsigned int networks(const gen::Layout& l) { return l.params().networks; }

const LookupForm kForms[] = {
    {"getSwitchvpd/frame_cage", ZRV_CHASSIS_TABLE, switches,
     [](vpdDB& db, const gen::Layout& l, unsigned int k) {
       chassisVPD r;
       gen::Position at = l.switchAt(k);
       return db.getSwitchvpd(at.frame, at.cage, r);
     }},
    {"getSwitchvpd/frame_list", ZRV_CHASSIS_TABLE, frames,
     [](vpdDB& db, const gen::Layout&, unsigned int k) {
       std::list<chassisVPD> out;
       return db.getSwitchvpd(k + 1, out);
     }},
    {"getSwitchvpd/mtms", ZRV_CHASSIS_TABLE, switches,
     [](vpdDB& db, const gen::Layout& l, unsigned int k) {
       chassisVPD r;
       return db.getSwitchvpd(l.switchMtms(k), r);
     }},
    {"getSwitchvpdNW", ZRV_CHASSIS_TABLE, networks,
     [](vpdDB& db, const gen::Layout&, unsigned int k) {
       std::list<chassisVPD> out;
       return db.getSwitchvpdNW(k + 1, out);
     }},
    {"getSwitchmtms", ZRV_CHASSIS_TABLE, frames,
     [](vpdDB& db, const gen::Layout&, unsigned int k) {
       std::list<mtms> out;
       return db.getSwitchmtms(k + 1, out);
     }},
    {"getBPAvpd/frame_cage", ZRV_BPA_TABLE, frames,
     [](vpdDB& db, const gen::Layout& l, unsigned int k) {
       bpaVPD r;
       gen::Position at = l.bpaAt(k + 1);
       return db.getBPAvpd(at.frame, at.cage, r);
     }},
    {"getBPAvpd/mtms", ZRV_BPA_TABLE, frames,
     [](vpdDB& db, const gen::Layout& l, unsigned int k) {
       bpaVPD r;
       return db.getBPAvpd(l.bpaMtms(k + 1), r);
     }},
    {"getBPAvpdNW", ZRV_BPA_TABLE, networks,
     [](vpdDB& db, const gen::Layout&, unsigned int k) {
       std::list<bpaVPD> out;
       return db.getBPAvpdNW(k + 1, out);
     }},
    {"getSMAvpd", ZRV_SMA_TABLE, cecs,
     [](vpdDB& db, const gen::Layout& l, unsigned int k) {
       std::list<smaVPD> out;
       gen::Position at = l.cecAt(k);
       return db.getSMAvpd(at.frame, at.cage, 1, out);
     }},
    {"getCECmtms", ZRV_SMA_TABLE, [](const gen::Layout&) { return 1u; },
     [](vpdDB& db, const gen::Layout&, unsigned int) {
       std::list<loc_id_t> ids;
       std::list<mtms> mtmses;
       return db.getCECmtms(ids, mtmses);
     }},
};

void failUnlessFound(benchmark::State& state, int rc) {
  if (rc != 0)
    state.SkipWithError("the lookup found nothing: the installation is not as generated");
}

void coldLookup(benchmark::State& state, const LookupForm& form) {
  unsigned int scale = static_cast<unsigned int>(state.range(0));
  const std::string data = dataDirAt(scale);
  const gen::Layout& layout = layoutAt(scale);
  const unsigned int last = form.keys(layout) - 1;
  for (auto _ : state) {
    vpdDB db(data, 1);
    int rc = form.run(db, layout, last);
    benchmark::DoNotOptimize(rc);
    if (rc != 0) return failUnlessFound(state, rc);
  }
  uint64_t bytes = tableBytesAt(scale, form.table);
  state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * bytes));
  state.SetComplexityN(static_cast<int64_t>(bytes));
}

void warmLookup(benchmark::State& state, const LookupForm& form) {
  unsigned int scale = static_cast<unsigned int>(state.range(0));
  const gen::Layout& layout = layoutAt(scale);
  vpdDB db(dataDirAt(scale), 1);
  const unsigned int keys = form.keys(layout);
  failUnlessFound(state, form.run(db, layout, 0));
  unsigned int k = 0;
  for (auto _ : state) {
    int rc = form.run(db, layout, k);
    benchmark::DoNotOptimize(rc);
    if (++k == keys) k = 0;
  }
  state.SetItemsProcessed(static_cast<int64_t>(state.iterations()));
}

// The floor of a cold lookup: one open and read of the whole table file.
void readTable(benchmark::State& state, const char* table) {
  unsigned int scale = static_cast<unsigned int>(state.range(0));
  const std::string path = dataDirAt(scale) + "/" + table;
  uint64_t bytes = tableBytesAt(scale, table);
  std::vector<char> buffer(bytes + 1);
  for (auto _ : state) {
    int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    std::size_t have = 0;
    ssize_t n;
    while ((n = ::read(fd, buffer.data() + have, buffer.size() - have)) > 0)
      have += static_cast<std::size_t>(n);
    ::close(fd);
    benchmark::DoNotOptimize(buffer.data());
    if (have != bytes) return state.SkipWithError("short read of a table");
  }
  state.SetBytesProcessed(static_cast<int64_t>(state.iterations() * bytes));
  state.SetComplexityN(static_cast<int64_t>(bytes));
}

}  // namespace

void registerLookupBenchmarks() {
  for (const char* table : {ZRV_CHASSIS_TABLE, ZRV_BPA_TABLE, ZRV_SMA_TABLE}) {
    auto* b =
        benchmark::RegisterBenchmark((std::string("ReadTable/") + table).c_str(), readTable, table);
    for (int s : kScales) b->Arg(s);
    b->Unit(benchmark::kMicrosecond)->Complexity(benchmark::oN);
  }
  for (const LookupForm& form : kForms) {
    auto* cold =
        benchmark::RegisterBenchmark((std::string("Cold/") + form.name).c_str(), coldLookup, form);
    auto* warm =
        benchmark::RegisterBenchmark((std::string("Warm/") + form.name).c_str(), warmLookup, form);
    for (int s : kScales) {
      cold->Arg(s);
      warm->Arg(s);
    }
    cold->Unit(benchmark::kMicrosecond)->Complexity(benchmark::oN);
    warm->Unit(benchmark::kNanosecond);
  }
}

}  // namespace benchgen
