// Network VPD of one frame's bulk power assembly: a header stanza and the stanzas of every
// BPC, BPR and BPD of both sides that has VPD.
#ifndef DORVEX_BPA_NETVPD_H_
#define DORVEX_BPA_NETVPD_H_

#include "vpd_records.h"

namespace dorvex {

// Writes the header (always, even for an empty record) and then, side 1 before side 2, the
// BPC, the three BPRs and the three BPDs of each side; FRUs without part or FRU number are
// left out. Returns 0.
int outputnetvpdBPA(bpaVPD bpadata);

}  // namespace dorvex

#endif  // DORVEX_BPA_NETVPD_H_
