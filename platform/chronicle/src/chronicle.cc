#include "chronicle.h"

#include <fcntl.h>
#include <syslog.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <string>

#include "chronicle_line.h"

namespace {

const char kLogEnv[] = "CHRONICLE_LOG";
const char kSyslogIdent[] = "ZRV_VPD";
constexpr uint32_t kErrorLevel = 64;

// The sink of this process. Opened on first use; kept until CHRONICLE_LOG names another.
struct Sink {
  bool open = false;
  std::string name;  // the CHRONICLE_LOG value it was opened for
  int fd = -1;       // file or stderr; -1 for syslog
  bool syslog = false;
  unsigned long opens = 0;

  void close() {
    if (fd > STDERR_FILENO) ::close(fd);
    if (syslog) closelog();
    fd = -1;
    syslog = false;
    open = false;
  }

  // Returns false when the sink cannot be opened; the record is then dropped.
  bool ensure() {
    const char* env = secure_getenv(kLogEnv);
    std::string want = env != nullptr ? env : "";
    if (open && want == name) return true;
    close();
    name = want;
    ++opens;
    if (want.empty()) {
      openlog(kSyslogIdent, LOG_PID, LOG_USER);
      syslog = true;
    } else if (want == "-") {
      fd = STDERR_FILENO;
    } else {
      fd = ::open(want.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0644);
      if (fd < 0) return false;
    }
    open = true;
    return true;
  }
};

Sink& sink() {
  static Sink s;
  return s;
}

// One write per record, so that concurrent writers never interleave within a line.
bool writeWhole(int fd, const std::string& line) {
  ssize_t n;
  do {
    n = ::write(fd, line.data(), line.size());
  } while (n < 0 && errno == EINTR);
  return n == static_cast<ssize_t>(line.size());
}

}  // namespace

Chronicle::Chronicle() = default;

Chronicle::~Chronicle() = default;

unsigned long Chronicle::sinkOpenCount() { return sink().opens; }

int Chronicle::Trace(uint32_t level, uint8_t, const char* operation, loc_id_t location, uint8_t,
                     const char* component, const char* source_file, const char*,
                     uint32_t source_line, const char* host, uint64_t, timeval when, uint64_t,
                     uint32_t, const char*, const char* message, ...) {
  int saved_errno = errno;  // tracing never changes what the caller sees
  Sink& s = sink();
  int rc = -1;
  if (s.ensure()) {
    std::string line = chronicle::formatRecord(when, level, component, operation, location.toInt(),
                                               source_file, source_line, host, message);
    if (s.syslog) {
      line.pop_back();  // syslog ends the record itself
      ::syslog(level == kErrorLevel ? LOG_ERR : LOG_INFO, "%s", line.c_str());
      rc = 0;
    } else {
      rc = writeWhole(s.fd, line) ? 0 : -1;
    }
  }
  errno = saved_errno;
  return rc;
}
