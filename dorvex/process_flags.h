// The dispatcher: opens the database, chooses the first request form whose settings are
// given, performs it and leaves the exit status in prc.
#ifndef DORVEX_PROCESS_FLAGS_H_
#define DORVEX_PROCESS_FLAGS_H_

namespace dorvex {

// The request forms in their order of precedence.
enum class RequestForm {
  kPart,        // frame, cage, FRU kind and part number given
  kFru,         // frame, cage and FRU kind given
  kLocation,    // frame and cage given
  kChangePoll,  // time given
  kFrame,       // frame given
  kMtms,        // MTMS given
  kNetwork,     // network given
  kDump,        // none of frame, time, MTMS and network given
};

// The first form whose condition holds for the current settings.
RequestForm chooseForm();

// Carries out the request of the settings and sets prc: the form's own result code; 2 when
// the form performed nothing; 3 when the database cannot be opened (nothing runs); 4 when
// the dump tool cannot be started and 5 when console discovery fails (nothing written).
// Returns 0. Exceptions other than the database's are left to the caller.
int processFlags();

}  // namespace dorvex

#endif  // DORVEX_PROCESS_FLAGS_H_
