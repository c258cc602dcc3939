#include "text_bytes.h"

#include <nlohmann/json.hpp>

namespace vpdload {

bool isUtf8(const std::string& bytes) {
  const auto* s = reinterpret_cast<const unsigned char*>(bytes.data());
  std::size_t n = bytes.size(), i = 0;
  while (i < n) {
    unsigned char c = s[i];
    if (c < 0x80) {
      ++i;
      continue;
    }
    std::size_t len;
    unsigned char lo = 0x80, hi = 0xBF;  // allowed range of the second byte
    if (c >= 0xC2 && c <= 0xDF) {
      len = 2;
    } else if (c >= 0xE0 && c <= 0xEF) {
      len = 3;
      if (c == 0xE0) lo = 0xA0;  // overlong
      if (c == 0xED) hi = 0x9F;  // surrogates
    } else if (c >= 0xF0 && c <= 0xF4) {
      len = 4;
      if (c == 0xF0) lo = 0x90;  // overlong
      if (c == 0xF4) hi = 0x8F;  // above U+10FFFF
    } else {
      return false;
    }
    if (n - i < len) return false;
    if (s[i + 1] < lo || s[i + 1] > hi) return false;
    for (std::size_t k = 2; k < len; ++k) {
      if (s[i + k] < 0x80 || s[i + k] > 0xBF) return false;
    }
    i += len;
  }
  return true;
}

std::string toHex(const std::string& bytes) {
  static const char kDigits[] = "0123456789abcdef";
  std::string out;
  out.reserve(bytes.size() * 2);
  for (unsigned char c : bytes) {
    out += kDigits[c >> 4];
    out += kDigits[c & 15];
  }
  return out;
}

namespace {

int hexValue(char c) {
  if (c >= '0' && c <= '9') return c - '0';
  if (c >= 'a' && c <= 'f') return c - 'a' + 10;
  if (c >= 'A' && c <= 'F') return c - 'A' + 10;
  return -1;
}

}  // namespace

bool fromHex(const std::string& hex, std::string* bytes, std::string* why) {
  for (std::size_t i = 0; i < hex.size(); ++i) {
    if (hexValue(hex[i]) < 0) {
      *why = "character " + std::to_string(i + 1) + " is not a hex digit";
      return false;
    }
  }
  if (hex.size() % 2 != 0) {
    *why = "an odd number of hex digits (" + std::to_string(hex.size()) + ")";
    return false;
  }
  bytes->clear();
  for (std::size_t i = 0; i < hex.size(); i += 2) {
    bytes->push_back(static_cast<char>(hexValue(hex[i]) * 16 + hexValue(hex[i + 1])));
  }
  return true;
}

std::string quoted(const std::string& text) {
  // Invalid UTF-8 (possible only in texts that did not come from the JSON parser) is
  // replaced rather than thrown on: a message must never fail.
  return nlohmann::json(text).dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

}  // namespace vpdload
