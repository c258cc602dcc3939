// dorvex_bench: Google Benchmark over the lookups, the store and the stanza writers, on
// generated installations of growing size.
#include <benchmark/benchmark.h>

#include <cstdlib>

#include "bench_installation.h"

namespace benchgen {
void registerLookupBenchmarks();
}

int main(int argc, char** argv) {
  // A lookup that finds nothing traces; the benchmark measures the lookup, not syslog.
  setenv("CHRONICLE_LOG", "/dev/null", 1);
  benchgen::registerLookupBenchmarks();
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  benchgen::removeAll();
  return 0;
}
