// Writes a generated installation into an install root: the three tables under data/
// (through vpdDB and putVPD, as the console's producer does), etc/rackprobe.dump and
// etc/hwserver.json.
#ifndef BENCH_INSTALLATION_WRITER_H_
#define BENCH_INSTALLATION_WRITER_H_

#include <cstdint>
#include <string>

#include "installation_layout.h"

namespace gen {

struct Written {
  uint64_t chassis_records = 0;
  uint64_t bpa_records = 0;
  uint64_t sma_records = 0;
  uint64_t table_bytes = 0;  // the three tables together
};

// Creates root, root/data and root/etc as needed and writes the installation. The tables
// start a new generation (the previous one stays in the ".old" files, as vpdDB() leaves it).
// Returns "" on success, else what failed; `out` may be null.
// REQUIRES: checkParams(layout.params()) is empty.
std::string writeInstallation(const std::string& root, const Layout& layout, Written* out);

// The dump that rackprobe prints: frame by frame, each frame's BPA, then its cages in
// ascending order, one line per switch chip and per SMA chip.
std::string rackprobeDump(const Layout& layout);

// The hardware server's view: each frame's BPA reached by two consoles (one when there is
// only one), vport = frame number.
std::string hwserverJson(const Layout& layout);

}  // namespace gen

#endif  // BENCH_INSTALLATION_WRITER_H_
