#include "bpa_netvpd.h"

#include "output_stream.h"
#include "record_output.h"

namespace dorvex {

int outputnetvpdBPA(bpaVPD bpadata) {
  mtms framemtms;
  framemtms = bpadata.frame_mtms;

  writeLine("*FC ????????");
  writeLine("*VC 5.0");
  writeLine("*DS MT/M Serial VPD");
  writeLine("*YK BPA");
  writeLine("*YL U1.35");
  writeKeyword("SE", framemtms.getSE());
  writeKeyword("TM", framemtms.getTM());
  writeLine("*VK TQ4M");

  fru_stanza fru;
  auto write = [&](const fru_stanza& unit) {
    fru = unit;
    outputfruBPA(fru, framemtms);
  };
  write(bpadata.bpc1_fru);
  for (const fru_stanza& unit : bpadata.bpr1_fru) write(unit);
  for (const fru_stanza& unit : bpadata.bpd1_fru) write(unit);
  write(bpadata.bpc2_fru);
  for (const fru_stanza& unit : bpadata.bpr2_fru) write(unit);
  for (const fru_stanza& unit : bpadata.bpd2_fru) write(unit);
  return 0;
}

}  // namespace dorvex
