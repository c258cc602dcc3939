#include "chronicle_line.h"

#include <cinttypes>
#include <cstdio>

namespace chronicle {
namespace {

// Null texts are written as empty fields rather than crashing the caller.
const char* orEmpty(const char* s) { return s != nullptr ? s : ""; }

// A field other than the message must not break the line apart.
std::string plainField(const char* s) { return escapeMessage(s); }

}  // namespace

std::string escapeMessage(const char* message) {
  std::string out;
  for (const char* p = orEmpty(message); *p != '\0'; ++p) {
    unsigned char c = static_cast<unsigned char>(*p);
    if (c == '\\') {
      out += "\\\\";
    } else if (c == '\n') {
      out += "\\n";
    } else if (c == '\t') {
      out += "\\t";
    } else if (c < 0x20 || c == 0x7f) {
      char hex[8];
      std::snprintf(hex, sizeof hex, "\\x%02x", c);
      out += hex;
    } else {
      out += static_cast<char>(c);
    }
  }
  return out;
}

std::string formatRecord(const timeval& when, uint32_t level, const char* component,
                         const char* operation, uint32_t location, const char* source_file,
                         uint32_t source_line, const char* host, const char* message) {
  char head[96];
  std::snprintf(head, sizeof head, "%lld.%06ld\t%" PRIu32 "\t", static_cast<long long>(when.tv_sec),
                static_cast<long>(when.tv_usec), level);
  char loc[16];
  std::snprintf(loc, sizeof loc, "0x%08" PRIx32, location);
  char line[16];
  std::snprintf(line, sizeof line, "%" PRIu32, source_line);

  std::string out = head;
  out += plainField(component);
  out += '\t';
  out += plainField(operation);
  out += '\t';
  out += loc;
  out += '\t';
  out += plainField(source_file);
  out += ':';
  out += line;
  out += '\t';
  out += plainField(host);
  out += '\t';
  out += escapeMessage(message);
  out += '\n';
  return out;
}

}  // namespace chronicle
