// The VPD keyword values of one field-replaceable unit.
//
// Layout (104 bytes), each field a character array of its significant length plus one:
//   ds  0  31     pn 31  13     ec 44  13     fn 57  13
//   sn 70  13     cc 83   5     yl 88  16
#ifndef VPDDB_INCLUDE_FRU_STANZA_H_
#define VPDDB_INCLUDE_FRU_STANZA_H_

#include <cstddef>
#include <string>

#include "vpd_text.h"

struct fru_stanza {
  // Significant characters of each field.
  static constexpr std::size_t kDsChars = 30, kPnChars = 12, kEcChars = 12, kFnChars = 12,
                               kSnChars = 12, kCcChars = 4, kYlChars = 15;

  char ds[kDsChars + 1];
  char pn[kPnChars + 1];
  char ec[kEcChars + 1];
  char fn[kFnChars + 1];
  char sn[kSnChars + 1];
  char cc[kCcChars + 1];
  char yl[kYlChars + 1];

  // Copies all 104 bytes.
  fru_stanza(const fru_stanza&) = default;
  // Every byte NUL.
  fru_stanza() : ds{}, pn{}, ec{}, fn{}, sn{}, cc{}, yl{} {}
  fru_stanza(const char* ds_, const char* pn_, const char* ec_, const char* fn_, const char* sn_,
             const char* cc_, const char* yl_)
      : fru_stanza() {
    setDS(ds_, kDsChars);
    setPN(pn_, kPnChars);
    setEC(ec_, kEcChars);
    setFN(fn_, kFnChars);
    setSN(sn_, kSnChars);
    setCC(cc_, kCcChars);
    setYL(yl_, kYlChars);
  }

  // strncpy of at most n characters of s, never more than the field's significant length.
  void setDS(const char* s, int n) { vpd::boundedCopy(ds, kDsChars, s, n); }
  void setPN(const char* s, int n) { vpd::boundedCopy(pn, kPnChars, s, n); }
  void setEC(const char* s, int n) { vpd::boundedCopy(ec, kEcChars, s, n); }
  void setFN(const char* s, int n) { vpd::boundedCopy(fn, kFnChars, s, n); }
  void setSN(const char* s, int n) { vpd::boundedCopy(sn, kSnChars, s, n); }
  void setCC(const char* s, int n) { vpd::boundedCopy(cc, kCcChars, s, n); }
  void setYL(const char* s, int n) { vpd::boundedCopy(yl, kYlChars, s, n); }

  // A field's text up to its first NUL, at most its significant length.
  std::string getDS() const { return vpd::fieldText(ds, kDsChars); }
  std::string getPN() const { return vpd::fieldText(pn, kPnChars); }
  std::string getEC() const { return vpd::fieldText(ec, kEcChars); }
  std::string getFN() const { return vpd::fieldText(fn, kFnChars); }
  std::string getSN() const { return vpd::fieldText(sn, kSnChars); }
  std::string getCC() const { return vpd::fieldText(cc, kCcChars); }
  std::string getYL() const { return vpd::fieldText(yl, kYlChars); }

  // Copies each field's significant characters in the manner of strncpy; the last byte of
  // each array keeps what it held.
  fru_stanza& operator=(const fru_stanza& o) {
    setDS(o.ds, kDsChars);
    setPN(o.pn, kPnChars);
    setEC(o.ec, kEcChars);
    setFN(o.fn, kFnChars);
    setSN(o.sn, kSnChars);
    setCC(o.cc, kCcChars);
    setYL(o.yl, kYlChars);
    return *this;
  }
};

static_assert(sizeof(fru_stanza) == 104, "fru_stanza is 104 bytes on disk");
static_assert(offsetof(fru_stanza, ds) == 0 && offsetof(fru_stanza, pn) == 31 &&
                  offsetof(fru_stanza, ec) == 44 && offsetof(fru_stanza, fn) == 57 &&
                  offsetof(fru_stanza, sn) == 70 && offsetof(fru_stanza, cc) == 83 &&
                  offsetof(fru_stanza, yl) == 88,
              "fru_stanza field offsets");

#endif  // VPDDB_INCLUDE_FRU_STANZA_H_
