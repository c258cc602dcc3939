// Machine type-model and serial number.
//
// Layout (17 bytes): tm at 0, 9 bytes (8 significant characters);
//                    se at 9, 8 bytes (7 significant characters).
#ifndef VPDDB_INCLUDE_MTMS_H_
#define VPDDB_INCLUDE_MTMS_H_

#include <cstddef>
#include <string>

#include "vpd_text.h"

struct mtms {
  static constexpr std::size_t kTmChars = 8;  // significant characters of tm
  static constexpr std::size_t kSeChars = 7;  // significant characters of se

  char tm[kTmChars + 1];
  char se[kSeChars + 1];

  // Copies all 17 bytes.
  mtms(const mtms&) = default;
  // The 8 significant characters of tm and the 7 of se are NUL; so are the terminators.
  mtms() : tm{}, se{} {}
  mtms(const char* tm_text, const char* se_text) : mtms() {
    setTM(tm_text, kTmChars);
    setSE(se_text, kSeChars);
  }
  // From the command line's form: 8 characters of type-model, one separator, 7 of serial.
  // A shorter text leaves the missing characters NUL; nothing past its end is read.
  explicit mtms(const char* text) : mtms() {
    if (text == nullptr) return;
    setTM(text, kTmChars);
    if (strnlen(text, kTmChars + 1) == kTmChars + 1) setSE(text + kTmChars + 1, kSeChars);
  }

  // strncpy of at most n characters (never more than the significant length).
  void setTM(const char* s, int n) { vpd::boundedCopy(tm, kTmChars, s, n); }
  void setSE(const char* s, int n) { vpd::boundedCopy(se, kSeChars, s, n); }

  // The field's text up to its first NUL, at most the significant length.
  std::string getTM() const { return vpd::fieldText(tm, kTmChars); }
  std::string getSE() const { return vpd::fieldText(se, kSeChars); }

  // Equal when the first 8 characters of tm and the first 7 of se compare equal as strncmp
  // would compare them.
  bool operator==(const mtms& o) const {
    return std::strncmp(tm, o.tm, kTmChars) == 0 && std::strncmp(se, o.se, kSeChars) == 0;
  }
  bool operator!=(const mtms& o) const { return !(*this == o); }

  // Copies at most 8 characters of tm and 7 of se in the manner of strncpy; the
  // terminator bytes of this object keep what they held.
  mtms& operator=(const mtms& o) {
    setTM(o.tm, kTmChars);
    setSE(o.se, kSeChars);
    return *this;
  }

  // Text form: printable leading characters of tm, "*", printable leading characters of se.
  std::string text() const {
    return vpd::printableText(tm, kTmChars) + "*" + vpd::printableText(se, kSeChars);
  }
};

static_assert(sizeof(mtms) == 17, "mtms is 17 bytes on disk");
static_assert(offsetof(mtms, tm) == 0 && offsetof(mtms, se) == 9, "mtms field offsets");

#endif  // VPDDB_INCLUDE_MTMS_H_
