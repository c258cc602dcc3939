#include "bpa_netvpd.h"

#include "output_stream.h"
#include "record_output.h"

namespace dorvex {

int outputnetvpdBPA(bpaVPD bpadata) {
  mtms framemtms;
  framemtms = bpadata.frame_mtms;

  FILE* out = outStream();
  putText(out, "*FC ????????\n*VC 5.0\n*DS MT/M Serial VPD\n*YK BPA\n*YL U1.35\n");
  writeKeyword(out, "SE", framemtms.se, mtms::kSeChars);
  writeKeyword(out, "TM", framemtms.tm, mtms::kTmChars);
  putText(out, "*VK TQ4M\n");

  auto write = [&](const fru_stanza& unit) { outputfruBPA(unit, framemtms); };
  write(bpadata.bpc1_fru);
  for (const fru_stanza& unit : bpadata.bpr1_fru) write(unit);
  for (const fru_stanza& unit : bpadata.bpd1_fru) write(unit);
  write(bpadata.bpc2_fru);
  for (const fru_stanza& unit : bpadata.bpr2_fru) write(unit);
  for (const fru_stanza& unit : bpadata.bpd2_fru) write(unit);
  return 0;
}

}  // namespace dorvex
