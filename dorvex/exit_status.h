// Exit statuses of dorvex. The front end reports only through these; they are chosen in
// main and processFlags (the summary writers only ever set the "not found" code).
#ifndef DORVEX_EXIT_STATUS_H_
#define DORVEX_EXIT_STATUS_H_

namespace dorvex {

enum ExitStatus : int {
  kExitDone = 0,        // the request was carried out
  kExitNotFound = 1,    // the requested data was not found
  kExitNoRequest = 2,   // too few arguments, or the settings fit no request form or branch
  kExitNoDatabase = 3,  // the VPD database could not be opened
  kExitNoDumpTool = 4,  // the switch chip dump tool could not be started
  kExitNoConsoles = 5,  // console discovery failed; nothing is written
};

}  // namespace dorvex

#endif  // DORVEX_EXIT_STATUS_H_
