// Reading the fixed-width character fields of the records.
#ifndef VPDDB_INCLUDE_VPD_TEXT_H_
#define VPDDB_INCLUDE_VPD_TEXT_H_

#include <cstring>
#include <string>

namespace vpd {

// The text of a character field: its bytes up to the first NUL, at most `significant` of them.
// Never reads past `significant` bytes, so a field without a terminator is safe.
inline std::string fieldText(const char* field, std::size_t significant) {
  return std::string(field, strnlen(field, significant));
}

// The leading printable characters (codes 32 to 126) of a field, at most `significant`.
inline std::string printableText(const char* field, std::size_t significant) {
  std::size_t n = 0;
  while (n < significant && field[n] >= 32 && field[n] <= 126) ++n;
  return std::string(field, n);
}

// strncpy bounded by the destination's significant length: copies at most
// min(n, significant) characters of src, stopping at its NUL, and pads with NUL up to
// that count. The byte after the significant ones is never written. A null src clears.
inline void boundedCopy(char* dst, std::size_t significant, const char* src, int n) {
  std::size_t limit = n < 0 ? 0 : static_cast<std::size_t>(n);
  if (limit > significant) limit = significant;
  std::size_t len = src == nullptr ? 0 : strnlen(src, limit);
  if (dst != src && len > 0) std::memmove(dst, src, len);
  if (len < limit) std::memset(dst + len, 0, limit - len);
}

// Copies a text into a field of `size` bytes that need no terminator (a timestamp): at most
// `size` bytes, NUL-padded. A null src clears the field.
inline void copyPadded(char* dst, std::size_t size, const char* src) {
  std::size_t len = src == nullptr ? 0 : strnlen(src, size);
  if (len > 0) std::memmove(dst, src, len);
  std::memset(dst + len, 0, size - len);
}

}  // namespace vpd

#endif  // VPDDB_INCLUDE_VPD_TEXT_H_
