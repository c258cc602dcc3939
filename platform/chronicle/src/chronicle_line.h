// Formatting of one trace record as a line.
#ifndef PLATFORM_CHRONICLE_SRC_CHRONICLE_LINE_H_
#define PLATFORM_CHRONICLE_SRC_CHRONICLE_LINE_H_

#include <sys/time.h>

#include <cstdint>
#include <string>

namespace chronicle {

// Escapes a message: "\" as "\\", newline as "\n", tab as "\t", any other byte below 0x20
// or equal to 0x7f as "\xHH". Other bytes pass unchanged; trailing blanks are kept.
std::string escapeMessage(const char* message);

// The eight tab-separated fields and the newline:
// SECONDS.MICROS LEVEL COMPONENT OPERATION LOCATION SOURCE:LINE HOST MESSAGE
std::string formatRecord(const timeval& when, uint32_t level, const char* component,
                         const char* operation, uint32_t location, const char* source_file,
                         uint32_t source_line, const char* host, const char* message);

}  // namespace chronicle

#endif  // PLATFORM_CHRONICLE_SRC_CHRONICLE_LINE_H_
