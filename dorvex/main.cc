// dorvex: prints the vital product data of the installation's hardware.
#include <cstdio>
#include <cstdlib>

#include "exit_status.h"
#include "options.h"
#include "process_flags.h"
#include "settings.h"

int main(int argc, char** argv) {
  using namespace dorvex;
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
