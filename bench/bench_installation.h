// Installations for the benchmarks: generated once per scale into a temporary install
// root, shared by every benchmark of the run and removed when the run ends.
#ifndef BENCH_BENCH_INSTALLATION_H_
#define BENCH_BENCH_INSTALLATION_H_

#include <cstdint>
#include <string>

#include "installation_layout.h"

namespace benchgen {

// The install root of the installation of scale n (gen_installation --scale n). Generated
// on first use; the program ends with a message if it cannot be written.
const std::string& rootAt(unsigned int scale);
// Its data directory (rootAt(scale) + "/data").
std::string dataDirAt(unsigned int scale);
// The layout it was generated from.
const gen::Layout& layoutAt(unsigned int scale);
// Size in bytes of one of its table files ("chassis_vpd.db", ...), or of all three for "".
uint64_t tableBytesAt(unsigned int scale, const std::string& file = "");

// A fresh, empty temporary folder, removed with the installations at the end of the run.
std::string scratchDir();
// Removes everything this run created.
void removeAll();

}  // namespace benchgen

#endif  // BENCH_BENCH_INSTALLATION_H_
