#include "record_output.h"

#include "exit_status.h"
#include "settings.h"

namespace dorvex {
namespace {

// The leading printable characters (codes 32 to 126) of a field, at most `significant`.
void putPrintable(FILE* out, const char* field, std::size_t significant) {
  std::size_t n = 0;
  while (n < significant && field[n] >= 32 && field[n] <= 126) ++n;
  putBytes(out, field, n);
}

void putDecimal(FILE* out, unsigned int value) {
  char digits[16];
  char* start = digits + sizeof digits;
  do {
    *--start = static_cast<char>('0' + value % 10);
    value /= 10;
  } while (value != 0);
  putBytes(out, start, static_cast<std::size_t>(digits + sizeof digits - start));
}

}  // namespace

void writeKeyword(FILE* out, const char* keyword, const char* field, std::size_t significant) {
  startKeyword(out, keyword);
  putField(out, field, significant);
  putChar(out, '\n');
}

void putMtmsText(FILE* out, const mtms& m) {
  putPrintable(out, m.tm, mtms::kTmChars);
  putChar(out, '*');
  putPrintable(out, m.se, mtms::kSeChars);
}

void putQuotedMtms(FILE* out, const mtms& m) {
  putChar(out, '"');
  putField(out, m.tm, mtms::kTmChars);
  putText(out, "\" \"");
  putField(out, m.se, mtms::kSeChars);
  putChar(out, '"');
}

int outputpnsn(mtms framemtms, const char* pn, const char* fn, const char* cc) {
  if (*pn == '\0' && *fn == '\0') {
    prc = kExitNotFound;
    return 0;
  }
  FILE* out = outStream();
  putMtmsText(out, framemtms);
  putChar(out, ' ');
  putText(out, pn);
  putChar(out, ' ');
  putText(out, fn);
  putChar(out, ' ');
  putText(out, cc);
  putChar(out, '\n');
  return 0;
}

int outputmtms(mtms framemtms, loc_id_t locid) {
  if (locid.getCage() == 0 && locid.getFrame() == 0) {
    prc = kExitNotFound;
    return 0;
  }
  FILE* out = outStream();
  putDecimal(out, locid.getFrame());
  putChar(out, ' ');
  putDecimal(out, locid.getCage());
  putChar(out, ' ');
  putMtmsText(out, framemtms);
  putChar(out, '\n');
  return 0;
}

int outputfruSW(fru_stanza fru, mtms framemtms) {
  // A field is empty exactly when its first byte is NUL.
  if (fru.pn[0] == '\0' || fru.fn[0] == '\0') return 1;
  FILE* out = outStream();
  putText(out, "*FC ????????\n");
  writeKeyword(out, "DS", fru.ds, fru_stanza::kDsChars);
  writeKeyword(out, "PN", fru.pn, fru_stanza::kPnChars);
  writeKeyword(out, "EC", fru.ec, fru_stanza::kEcChars);
  writeKeyword(out, "FN", fru.fn, fru_stanza::kFnChars);
  writeKeyword(out, "SN", fru.sn, fru_stanza::kSnChars);
  startKeyword(out, "YL");
  putChar(out, 'U');
  putMtmsText(out, framemtms);
  putChar(out, '-');
  putField(out, fru.yl, fru_stanza::kYlChars);
  putChar(out, '\n');
  writeKeyword(out, "CC", fru.cc, fru_stanza::kCcChars);
  return 0;
}

void outputfruBPA(fru_stanza fru, mtms /*framemtms*/) {
  if (fru.pn[0] == '\0' || fru.fn[0] == '\0') return;
  FILE* out = outStream();
  putText(out, "*FC ????????\n");
  writeKeyword(out, "DS", fru.ds, fru_stanza::kDsChars);
  putText(out, "*YL U1.35-");
  putField(out, fru.yl, fru_stanza::kYlChars);
  putChar(out, '\n');
  writeKeyword(out, "SN", fru.sn, fru_stanza::kSnChars);
  writeKeyword(out, "CC", fru.cc, fru_stanza::kCcChars);
  writeKeyword(out, "FN", fru.fn, fru_stanza::kFnChars);
  putText(out, "*VK TQ4M\n");
}

}  // namespace dorvex
