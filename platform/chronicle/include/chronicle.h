// Trace service client, as the console's libchronicle offers it.
//
// This stand-in writes each record as one line to the sink named by CHRONICLE_LOG:
// unset or empty: syslog (ident ZRV_VPD, facility user); "-": standard error; any other
// value: that file, opened for append. The sink is opened on the first record and kept
// for the life of the process (it is reopened only when CHRONICLE_LOG changes).
#ifndef PLATFORM_CHRONICLE_INCLUDE_CHRONICLE_H_
#define PLATFORM_CHRONICLE_INCLUDE_CHRONICLE_H_

#include <sys/time.h>

#include <cstdint>

#include "locid.h"

class Chronicle {
 public:
  Chronicle();
  ~Chronicle();
  Chronicle(const Chronicle&) = delete;
  Chronicle& operator=(const Chronicle&) = delete;

  // Sends one record. Returns 0 when it was handed to the sink, -1 when it was dropped;
  // a sink that cannot be opened or written drops the record silently.
  // Parameters 2, 5, 11, 13, 14, 15 and the variable part are accepted and not used.
  int Trace(uint32_t level, uint8_t kind, const char* operation, loc_id_t location, uint8_t flags,
            const char* component, const char* source_file, const char* file_version,
            uint32_t source_line, const char* host, uint64_t tag, timeval when, uint64_t sequence,
            uint32_t reserved, const char* extra, const char* message, ...);

  // How many times a sink was opened by this process (for tests and benchmarks).
  static unsigned long sinkOpenCount();
};

#endif  // PLATFORM_CHRONICLE_INCLUDE_CHRONICLE_H_
