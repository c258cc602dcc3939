// The table records of a generated installation, built from its layout. Every byte of a
// record is a function of the layout, so writing the same layout twice gives the same files.
#ifndef BENCH_INSTALLATION_RECORDS_H_
#define BENCH_INSTALLATION_RECORDS_H_

#include "installation_layout.h"
#include "vpd_records.h"

namespace gen {

// Switch chassis s: board, both DCAs and all 16 risers with VPD, every jack cabled.
chassisVPD chassisRecord(const Layout& layout, unsigned int s);
// The BPA of frame f (1-based): both sides complete (BPC, three BPRs, three BPDs).
bpaVPD bpaRecord(const Layout& layout, unsigned int f);
// SMA chip `chip` of CEC c, with the CEC's MTMS and the switch it is cabled to.
smaVPD smaRecord(const Layout& layout, unsigned int c, unsigned int chip);

}  // namespace gen

#endif  // BENCH_INSTALLATION_RECORDS_H_
