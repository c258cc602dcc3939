// Form 7: the switch chips of one network, as the dump tool lists them.
#include <unordered_set>
#include <vector>

#include "bpa_netvpd.h"
#include "console_discovery.h"
#include "exit_status.h"
#include "netvpd_run.h"
#include "record_output.h"
#include "requests.h"
#include "settings.h"
#include "switch_list.h"
#include "switch_netvpd.h"

namespace dorvex {
namespace {

// Cage under which a frame's BPA is stored.
constexpr unsigned int kBpaCage = 255;

unsigned int u(int value) { return static_cast<unsigned int>(value); }

struct ChipList {
  std::vector<int> frames = std::vector<int>(kMaxChipEntries);
  std::vector<int> cages = std::vector<int>(kMaxChipEntries);
  bool isPosition(int i) const { return frames[i] != 0 && cages[i] != 0; }
};

// One enclosure line per distinct frame, for its BPA. Returns whether any was handed on.
bool bpaLines(vpdDB& vpd, ChipList& chips) {
  clearDuplicateFrames(chips.frames.data(), chips.cages.data());
  bool any = false;
  for (int i = 0; i < kMaxChipEntries; ++i) {
    if (chips.frames[i] == 0) continue;
    bpaVPD bpadata;  // fresh for each entry: a missing record never repeats an earlier one
    vpd.getBPAvpd(u(chips.frames[i]), kBpaCage, bpadata);
    outputmtms(bpadata.frame_mtms, bpadata.loc_id);
    any = true;
  }
  return any;
}

// One enclosure line per chip position, for its switch chassis.
bool switchLines(vpdDB& vpd, const ChipList& chips) {
  bool any = false;
  for (int i = 0; i < kMaxChipEntries; ++i) {
    if (!chips.isPosition(i)) continue;
    chassisVPD switchdata;
    vpd.getSwitchvpd(u(chips.frames[i]), u(chips.cages[i]), switchdata);
    outputmtms(switchdata.sw_mtms, switchdata.loc_id);
    any = true;
  }
  return any;
}

// Every switch stanza (with its frame's BPA), then one BPA stanza per frame that got a
// switch stanza, in the order of the frame's first chip position.
bool networkVpd(vpdDB& vpd, const ChipList& chips) {
  NetvpdRun run(vpd);
  bool any = false;
  for (int i = 0; i < kMaxChipEntries; ++i) {
    if (!chips.isPosition(i)) continue;
    chassisVPD switchdata;
    vpd.getSwitchvpd(u(chips.frames[i]), u(chips.cages[i]), switchdata);
    // The stanza shows only the MTMS of the frame's BPA; the run remembers it per frame.
    writeSwitchStanza(run, switchdata, run.bpaMtmsAt(u(chips.frames[i]), kBpaCage));
    any = true;
  }
  // Only the positions of the switch pass count here, so a frame whose first listed entry
  // has cage 0 still gets its BPA stanza.
  std::unordered_set<int> frames_done;
  for (int i = 0; i < kMaxChipEntries; ++i) {
    if (!chips.isPosition(i) || !frames_done.insert(chips.frames[i]).second) continue;
    bpaVPD bpadata;
    vpd.getBPAvpd(u(chips.frames[i]), kBpaCage, bpadata);
    outputnetvpdBPA(bpadata);
  }
  return any;
}

}  // namespace

void clearDuplicateFrames(int* frames, int* cages) {
  std::unordered_set<int> seen;
  bool zero_seen = false;  // an earlier entry has frame 0 (a hole, or cleared above)
  for (int j = 0; j < kMaxChipEntries; ++j) {
    if (frames[j] != 0) {
      if (!seen.insert(frames[j]).second) frames[j] = cages[j] = 0;
    } else if (zero_seen) {
      cages[j] = 0;
    }
    if (frames[j] == 0) zero_seen = true;
  }
}

int networkRequest(vpdDB& vpd, RequestFailure& failure) {
  failure = RequestFailure::kNone;
  if (type != kTypeBpa && type != kTypeSwitch && type != kTypeNetvpd) return kNothingPerformed;
  if (type == kTypeNetvpd) {
    try {
      getzevmtms();
    } catch (int) {
      failure = RequestFailure::kNoConsoles;
      return kNothingPerformed;
    }
  }
  ChipList chips;
  if (getSwitchList(network, chips.frames.data(), chips.cages.data()) != 0) {
    failure = RequestFailure::kNoDumpTool;
    return kNothingPerformed;
  }
  bool any;
  if (type == kTypeBpa) {
    any = bpaLines(vpd, chips);
  } else if (type == kTypeSwitch) {
    any = switchLines(vpd, chips);
  } else {
    any = networkVpd(vpd, chips);
  }
  prc = any ? kExitDone : kExitNotFound;
  return 0;
}

}  // namespace dorvex
