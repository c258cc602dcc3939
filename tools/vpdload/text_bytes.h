// Byte-level helpers for the text fields of the records, which may hold any bytes.
#ifndef TOOLS_VPDLOAD_TEXT_BYTES_H_
#define TOOLS_VPDLOAD_TEXT_BYTES_H_

#include <string>

namespace vpdload {

// True when `bytes` is well-formed UTF-8: no overlong forms, no surrogates, nothing above
// U+10FFFF, no truncated sequence. Such text can be written as a JSON string unchanged.
bool isUtf8(const std::string& bytes);

// Two lower-case hex digits per byte.
std::string toHex(const std::string& bytes);

// Decodes hex digits (either case) into bytes. On failure returns false and says why in
// `why` (an odd number of digits, or the first character that is not a hex digit).
bool fromHex(const std::string& hex, std::string* bytes, std::string* why);

// A short text quoted as a JSON string, safe to print in a message.
std::string quoted(const std::string& text);

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_TEXT_BYTES_H_
