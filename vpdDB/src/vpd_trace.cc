#include "vpd_trace.h"

#include <sys/time.h>
#include <unistd.h>

#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstring>

Chronicle vpd_tr;
char vpd_hostname[255];
char trace_msg[256];

namespace vpd {
namespace {

const char kFileVersion[] = "1.3";

const char* baseName(const char* path) {
  const char* slash = std::strrchr(path, '/');
  return slash != nullptr ? slash + 1 : path;
}

}  // namespace

void loadHostname() {
  if (gethostname(vpd_hostname, sizeof vpd_hostname) != 0) vpd_hostname[0] = '\0';
  vpd_hostname[sizeof vpd_hostname - 1] = '\0';
}

void traceAt(unsigned int level, const char* operation, loc_id_t location, const char* source_file,
             unsigned int source_line, const char* format, ...) {
  int saved_errno = errno;
  va_list args;
  va_start(args, format);
  std::vsnprintf(trace_msg, sizeof trace_msg, format, args);
  va_end(args);
  timeval now;
  gettimeofday(&now, nullptr);
  vpd_tr.Trace(level, 1, operation, location, 0, ZRV_VPD_COMPONENT, baseName(source_file),
               kFileVersion, source_line, vpd_hostname, 0, now, 0, 0, nullptr, trace_msg);
  errno = saved_errno;
}

}  // namespace vpd
