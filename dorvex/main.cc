// dorvex: prints the vital product data of the installation's hardware.
#include <unistd.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>

#include "exit_status.h"
#include "options.h"
#include "process_flags.h"
#include "settings.h"

namespace {

// Small tables are mapped, not copied. Our producers never shrink a table in place, but a table
// cut short by hand while a request runs would fault the mapping: end as for a database that
// cannot be read, rather than with a crash.
extern "C" void tableVanished(int) { _exit(dorvex::kExitNoDatabase); }

}  // namespace

int main(int argc, char** argv) {
  using namespace dorvex;
  std::signal(SIGBUS, tableVanished);
  // A network VPD request writes megabytes; the default buffer of a file or pipe would
  // cost a write call every 4 KiB. A terminal stays line-buffered, so that a person
  // watching sees each line as it comes.
  static char out_buffer[1 << 16];
  if (isatty(STDOUT_FILENO) == 0) std::setvbuf(stdout, out_buffer, _IOFBF, sizeof out_buffer);
  int status = kExitNoRequest;
  try {
    switch (parseCommandLine(argc, argv)) {
      case CommandLine::kHelp:
        printHelp(stdout);
        status = kExitDone;
        break;
      case CommandLine::kVersion:
        printVersion(stdout);
        status = kExitDone;
        break;
      case CommandLine::kTooFewWords:
        prc = kExitNoRequest;
        status = prc;
        break;
      case CommandLine::kRequest:
        processFlags();
        status = prc;
        break;
    }
  } catch (...) {
    // Nothing may leave main; what was written so far still reaches standard output.
    status = kExitNoRequest;
  }
  std::fflush(stdout);
  std::exit(status);
}
