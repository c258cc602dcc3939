// Summary lines and FRU keyword stanzas.
//
// Every line ends with one newline. A keyword line is "*", two characters, one blank and
// the value (the blank stays when the value is empty). Values are written raw, as they
// stand in the record up to the first NUL and never past the field's significant length.
// A stanza starts with "*FC ????????" and has no closing line.
#ifndef DORVEX_RECORD_OUTPUT_H_
#define DORVEX_RECORD_OUTPUT_H_

#include <cstddef>
#include <cstdio>

#include "fru_stanza.h"
#include "locid.h"
#include "mtms.h"
#include "output_stream.h"

namespace dorvex {

// One FRU: "<MTMS text> <pn> <fn> <cc>". Callers pass a FRU's pn, sn and cc, in that order,
// so `fn` carries the serial number. When pn and fn are both empty, writes nothing and sets
// prc to "not found". Returns 0.
int outputpnsn(mtms framemtms, const char* pn, const char* fn, const char* cc);

// One enclosure: "<frame> <cage> <MTMS text>". When the location's frame and cage are both
// 0, writes nothing and sets prc to "not found". Returns 0.
int outputmtms(mtms framemtms, loc_id_t locid);

// Keyword stanza of a switch-side FRU (FC, DS, PN, EC, FN, SN, YL, CC); the location line is
// "U" + the MTMS text of `framemtms` + "-" + yl. Returns 0 when written, 1 when the FRU has
// no part number or no FRU number (nothing written).
int outputfruSW(fru_stanza fru, mtms framemtms);

// Keyword stanza of a BPA-side FRU (FC, DS, YL, SN, CC, FN, VK), location "U1.35-" + yl.
// Nothing is written for a FRU without part number or FRU number. `framemtms` is unused.
void outputfruBPA(fru_stanza fru, mtms framemtms);

// "*" + keyword + " ": the start of a keyword line; the caller writes the value and the
// newline.
inline void startKeyword(FILE* out, const char* keyword) {
  putChar(out, '*');
  putText(out, keyword);
  putChar(out, ' ');
}

// A whole keyword line whose value is the text of a fixed-width field.
void writeKeyword(FILE* out, const char* keyword, const char* field, std::size_t significant);

// The text form of an MTMS (mtms::text()): the printable leading characters of tm, "*",
// those of se.
void putMtmsText(FILE* out, const mtms& m);

// The quoted pair of an MTMS's field texts: "\"tm\" \"se\"".
void putQuotedMtms(FILE* out, const mtms& m);

}  // namespace dorvex

#endif  // DORVEX_RECORD_OUTPUT_H_
