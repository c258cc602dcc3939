#include "record_output.h"

#include "exit_status.h"
#include "output_stream.h"
#include "settings.h"

namespace dorvex {

void writeKeyword(const char* keyword, const std::string& value) {
  writeLine(std::string("*") + keyword + " " + value);
}

std::string quotedPair(const std::string& first, const std::string& second) {
  return "\"" + first + "\" \"" + second + "\"";
}

int outputpnsn(mtms framemtms, const char* pn, const char* fn, const char* cc) {
  if (*pn == '\0' && *fn == '\0') {
    prc = kExitNotFound;
    return 0;
  }
  writeLine(framemtms.text() + " " + pn + " " + fn + " " + cc);
  return 0;
}

int outputmtms(mtms framemtms, loc_id_t locid) {
  if (locid.getCage() == 0 && locid.getFrame() == 0) {
    prc = kExitNotFound;
    return 0;
  }
  writeLine(std::to_string(locid.getFrame()) + " " + std::to_string(locid.getCage()) + " " +
            framemtms.text());
  return 0;
}

int outputfruSW(fru_stanza fru, mtms framemtms) {
  if (fru.getPN().empty() || fru.getFN().empty()) return 1;
  writeLine("*FC ????????");
  writeKeyword("DS", fru.getDS());
  writeKeyword("PN", fru.getPN());
  writeKeyword("EC", fru.getEC());
  writeKeyword("FN", fru.getFN());
  writeKeyword("SN", fru.getSN());
  writeKeyword("YL", "U" + framemtms.text() + "-" + fru.getYL());
  writeKeyword("CC", fru.getCC());
  return 0;
}

void outputfruBPA(fru_stanza fru, mtms /*framemtms*/) {
  if (fru.getPN().empty() || fru.getFN().empty()) return;
  writeLine("*FC ????????");
  writeKeyword("DS", fru.getDS());
  writeKeyword("YL", "U1.35-" + fru.getYL());
  writeKeyword("SN", fru.getSN());
  writeKeyword("CC", fru.getCC());
  writeKeyword("FN", fru.getFN());
  writeLine("*VK TQ4M");
}

}  // namespace dorvex
