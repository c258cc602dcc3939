#include "process_flags.h"

#include <memory>

#include "exit_status.h"
#include "requests.h"
#include "settings.h"
#include "vpdDB.h"

namespace dorvex {
namespace {
bool given(int setting) { return setting != kNotGiven; }
}  // namespace

RequestForm chooseForm() {
  if (given(frame) && given(cage) && given(fruid) && given(partnum)) return RequestForm::kPart;
  if (given(frame) && given(cage) && given(fruid)) return RequestForm::kFru;
  if (given(frame) && given(cage)) return RequestForm::kLocation;
  if (given(mtime)) return RequestForm::kChangePoll;
  if (given(frame)) return RequestForm::kFrame;
  if (mtmsid != nullptr) return RequestForm::kMtms;
  if (given(network)) return RequestForm::kNetwork;
  return RequestForm::kDump;
}

int processFlags() {
  std::unique_ptr<vpdDB> vpd;
  try {
    vpd = std::make_unique<vpdDB>(1);
  } catch (int) {
    prc = kExitNoDatabase;  // no form runs
    return 0;
  }

  int rc = kNothingPerformed;
  RequestFailure failure = RequestFailure::kNone;
  switch (chooseForm()) {
    case RequestForm::kPart:
      rc = partRequest(*vpd);
      break;
    case RequestForm::kFru:
      rc = fruRequest(*vpd);
      break;
    case RequestForm::kLocation:
      rc = locationRequest(*vpd);
      break;
    case RequestForm::kChangePoll:
      rc = changePoll(*vpd);
      break;
    case RequestForm::kFrame:
      rc = frameRequest(*vpd);
      break;
    case RequestForm::kMtms:
      rc = mtmsRequest(*vpd);
      break;
    case RequestForm::kNetwork:
      rc = networkRequest(*vpd, failure);
      break;
    case RequestForm::kDump:
      rc = dumpRequest(*vpd);
      break;
  }

  if (failure == RequestFailure::kNoDumpTool) {
    prc = kExitNoDumpTool;
  } else if (failure == RequestFailure::kNoConsoles) {
    prc = kExitNoConsoles;
  } else if (rc == kNothingPerformed) {
    prc = kExitNoRequest;
  }
  return 0;
}

}  // namespace dorvex
