#include "settings.h"

#include "exit_status.h"

namespace dorvex {

int network = kNotGiven;
int frame = kNotGiven;
int cage = kNotGiven;
int mtime = kNotGiven;
int partnum = kNotGiven;
int port = kNotGiven;
int bpanum = kNotGiven;
int type = kNotGiven;
int fruid = kNotGiven;
char* mtmsid = nullptr;
int prc = kExitDone;

void resetSettings() {
  network = frame = cage = mtime = partnum = port = bpanum = type = fruid = kNotGiven;
  mtmsid = nullptr;
  prc = kExitDone;
}

}  // namespace dorvex
