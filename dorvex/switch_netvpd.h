// Network VPD of one switch chassis: a header stanza (MTMS, managing consoles, the frame's
// BPA), the FRU stanzas of board, DCAs and risers, and one cable line per riser jack.
//
// Location codes:  local jack      U<tm><se>-P1-C<slot>-T<jack>
//                  switch far end  U<tm><se>-P1-C<slot>-T<jack>   (the far chassis)
//                  SMA far end     U<tm><se>-P1-H<h>Q<q>          (the CEC of the SMA)
// where <tm><se> are the MTMS fields up to their first NUL, with no separator.
#ifndef DORVEX_SWITCH_NETVPD_H_
#define DORVEX_SWITCH_NETVPD_H_

#include <string>

#include "netvpd_run.h"
#include "vpdDB.h"

namespace dorvex {

// Riser slots reported per chassis: the first 15 of the 16 (the last one never is).
constexpr int kReportedRisers = 15;

// Writes the network VPD of one switch chassis; `bpadata` is the BPA record of its frame as
// the caller found it (possibly empty). Console lines come from zev. Far ends of cables are
// looked up through `run`, which the request keeps for all of its chassis. Returns 0.
int outputnetvpdSW(NetvpdRun& run, chassisVPD switchdata, bpaVPD bpadata);
// The same for a single chassis, on a run of its own over `vpd`.
int outputnetvpdSW(vpdDB& vpd, chassisVPD switchdata, bpaVPD bpadata);
// What outputnetvpdSW writes, given only what it uses of the BPA record: its frame MTMS.
void writeSwitchStanza(NetvpdRun& run, const chassisVPD& switchdata, const mtms& bpamtms);

// Writes the cable line of one local jack: "*CB " and the quoted pair of the local and the
// far location. `locid` and `port` are the far end as stored in the riser slot, `fromriser`
// the 0-based local slot, `fromjack` 1 or 2. A far end of another type than NSB, ISB or SMA
// gives no line. Returns 0.
int outputCBinfo(NetvpdRun& run, mtms framemtms, loc_id_t locid, int port, int fromriser,
                 int fromjack);
// The same on a run of its own over `vpd`.
int outputCBinfo(vpdDB& vpd, mtms framemtms, loc_id_t locid, int port, int fromriser, int fromjack);

// "1" to "16" for 1 to 16; the empty text for anything else.
std::string riseritoa(int n);

// The 0-based riser slot on a far switch chassis reached by chip `chip`, or -1 when the
// chip has no slot (above 7).
int farRiserSlot(unsigned int chip);

// The H and Q digits of an SMA far end (from its SMA chip number); empty for a chip with
// no SMA chip number. Static texts.
const char* smaHDigit(unsigned char sma_chip);
const char* smaQDigit(unsigned char sma_chip);

}  // namespace dorvex

#endif  // DORVEX_SWITCH_NETVPD_H_
