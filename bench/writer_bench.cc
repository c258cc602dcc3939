// The stanza writers of a network VPD request, writing to /dev/null: one switch chassis
// with its cable lines (each a far-end lookup in the request's database), and one BPA frame.
#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstdlib>
#include <vector>

#include "bench_installation.h"
#include "bpa_netvpd.h"
#include "console_discovery.h"
#include "installation_records.h"
#include "output_stream.h"
#include "switch_netvpd.h"
#include "vpdDB.h"

namespace benchgen {
namespace {

const int kScales[] = {1, 4, 16, 64};

// Points the writers at /dev/null and fills the console list from the installation's
// hwserver.json, as a netvpd request does before its first stanza.
class WriterSetup {
 public:
  WriterSetup(benchmark::State& state, unsigned int scale) {
    setenv("OLV_ROOT", rootAt(scale).c_str(), 1);
    dorvex::zev.clear();
    try {
      dorvex::getzevmtms();
    } catch (int) {
      state.SkipWithError("console discovery failed");
    }
    sink_ = std::fopen("/dev/null", "w");
    dorvex::setOutStream(sink_);
  }
  ~WriterSetup() {
    dorvex::setOutStream(nullptr);
    if (sink_ != nullptr) std::fclose(sink_);
    dorvex::zev.clear();
  }

 private:
  FILE* sink_ = nullptr;
};

void BM_OutputNetvpdSW(benchmark::State& state) {
  unsigned int scale = static_cast<unsigned int>(state.range(0));
  const gen::Layout& layout = layoutAt(scale);
  WriterSetup setup(state, scale);
  vpdDB db(dataDirAt(scale), 1);
  std::vector<chassisVPD> chassis;
  std::vector<bpaVPD> bpas;
  for (unsigned int s = 0; s < layout.switchCount(); ++s) {
    chassisVPD r;
    gen::Position at = layout.switchAt(s);
    if (db.getSwitchvpd(at.frame, at.cage, r) != 0) return state.SkipWithError("no chassis");
    bpaVPD b;
    if (db.getBPAvpd(at.frame, gen::kBpaCage, b) != 0) return state.SkipWithError("no BPA");
    chassis.push_back(r);
    bpas.push_back(b);
  }
  std::size_t i = 0;
  for (auto _ : state) {
    dorvex::outputnetvpdSW(db, chassis[i], bpas[i]);
    if (++i == chassis.size()) i = 0;
  }
  state.SetItemsProcessed(static_cast<int64_t>(state.iterations()));
}
BENCHMARK(BM_OutputNetvpdSW)->ArgsProduct({{kScales[0], kScales[1], kScales[2], kScales[3]}});

void BM_OutputNetvpdBPA(benchmark::State& state) {
  unsigned int scale = static_cast<unsigned int>(state.range(0));
  const gen::Layout& layout = layoutAt(scale);
  WriterSetup setup(state, scale);
  std::vector<bpaVPD> bpas;
  for (unsigned int f = 1; f <= layout.params().frames; ++f)
    bpas.push_back(gen::bpaRecord(layout, f));
  std::size_t i = 0;
  for (auto _ : state) {
    dorvex::outputnetvpdBPA(bpas[i]);
    if (++i == bpas.size()) i = 0;
  }
  state.SetItemsProcessed(static_cast<int64_t>(state.iterations()));
}
BENCHMARK(BM_OutputNetvpdBPA)->Arg(1)->Arg(64);

// All switch stanzas of the network of the large installation, in table order: the
// writers' share of `dorvex -y netvpd -n 1`, without the process, the tables' first read
// and the chip list.
void BM_NetworkStanzas(benchmark::State& state) {
  unsigned int scale = static_cast<unsigned int>(state.range(0));
  const gen::Layout& layout = layoutAt(scale);
  WriterSetup setup(state, scale);
  vpdDB db(dataDirAt(scale), 1);
  for (auto _ : state) {
    for (unsigned int s = 0; s < layout.switchCount(); ++s) {
      chassisVPD r;
      bpaVPD b;
      gen::Position at = layout.switchAt(s);
      db.getSwitchvpd(at.frame, at.cage, r);
      db.getBPAvpd(at.frame, gen::kBpaCage, b);
      dorvex::outputnetvpdSW(db, r, b);
    }
    for (unsigned int f = 1; f <= layout.params().frames; ++f) {
      bpaVPD b;
      db.getBPAvpd(f, gen::kBpaCage, b);
      dorvex::outputnetvpdBPA(b);
    }
  }
  state.SetItemsProcessed(static_cast<int64_t>(state.iterations() * layout.switchCount()));
  state.SetComplexityN(static_cast<int64_t>(layout.switchCount()));
}
BENCHMARK(BM_NetworkStanzas)
    ->ArgsProduct({{kScales[0], kScales[1], kScales[2], kScales[3]}})
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

}  // namespace
}  // namespace benchgen
