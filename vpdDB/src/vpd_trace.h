// How the database reports to the trace service.
#ifndef VPDDB_SRC_VPD_TRACE_H_
#define VPDDB_SRC_VPD_TRACE_H_

#include "chronicle.h"
#include "locid.h"
#include "zrv_const.h"

// The trace client of the process, the host name handed to every record, and the buffer
// each message is formatted into just before it is sent.
extern Chronicle vpd_tr;
extern char vpd_hostname[255];
extern char trace_msg[256];

namespace vpd {

// Fills vpd_hostname (always NUL-terminated, even when the name is cut).
void loadHostname();

// Formats the message into trace_msg with bounded printf formatting and sends it with the
// operation name and location. Never fails and never changes errno.
void traceAt(unsigned int level, const char* operation, loc_id_t location, const char* source_file,
             unsigned int source_line, const char* format, ...)
    __attribute__((format(printf, 6, 7)));

}  // namespace vpd

#define VPD_TRACE(level, operation, location, ...) \
  ::vpd::traceAt((level), (operation), (location), __FILE__, __LINE__, __VA_ARGS__)

#endif  // VPDDB_SRC_VPD_TRACE_H_
