// The eight request forms of dorvex. Each runs on the request's one open database, reads the
// settings, may set prc, and returns its rc: the result of its last operation, or -1 when
// the settings fit none of its branches (nothing performed).
#ifndef DORVEX_REQUESTS_H_
#define DORVEX_REQUESTS_H_

#include "vpdDB.h"

namespace dorvex {

// rc of a form that performed nothing.
constexpr int kNothingPerformed = -1;

// A failure of a network request that decides the exit status by itself.
enum class RequestFailure {
  kNone,
  kNoDumpTool,  // the switch chip dump tool could not be started
  kNoConsoles,  // console discovery could not create a platform client
};

// Form 1: one part of a FRU kind (frame, cage, FRU kind and part number given).
int partRequest(vpdDB& vpd);
// Form 2: one FRU (frame, cage and FRU kind given).
int fruRequest(vpdDB& vpd);
// Form 3: the enclosure at a frame and cage.
int locationRequest(vpdDB& vpd);
// Form 4: has the SMA table changed since mtime? The time and the CEC list, or "NoChange".
int changePoll(vpdDB& vpd);
// Form 5: the switch chassis of a frame.
int frameRequest(vpdDB& vpd);
// Form 6: the enclosure with the MTMS of mtmsid.
int mtmsRequest(vpdDB& vpd);
// Form 7: the enclosures, or the network VPD, of the switch chips of a network. Sets prc to
// 0 when some chip position was written, 1 when none; on a failure nothing is written.
int networkRequest(vpdDB& vpd, RequestFailure& failure);
// Form 8: the three tables in readable form.
int dumpRequest(vpdDB& vpd);

// Keeps the first entry of each frame: a later entry of a frame already seen becomes (0, 0).
// Cages are not compared, and holes count as frame 0 like any other (a frame-0 entry after
// the first one loses its cage). Works on kMaxChipEntries entries.
void clearDuplicateFrames(int* frames, int* cages);

}  // namespace dorvex

#endif  // DORVEX_REQUESTS_H_
