#include "table_index.h"

#include <cstring>

namespace vpd {
namespace {

constexpr unsigned int kMaxFrame = (1u << loc_id_t::kFrameWidth) - 1;
constexpr unsigned int kMaxCage = (1u << loc_id_t::kUidWidth) - 1;
constexpr unsigned int kNetworks = 1u << loc_id_t::kNetworkWidth;

uint32_t frameCageKey(unsigned int frame, unsigned int cage) { return (frame << 8) | cage; }

}  // namespace

void TableIndex::buildFrameCage() {
  frame_cage_built_ = true;
  for (std::size_t i = 0; i < snapshot_.count(); ++i) {
    loc_id_t loc = snapshot_.location(i);
    RecordList& list = frame_cage_[frameCageKey(loc.getFrame(), loc.getCage())];
    if (list.empty()) first_of_frame_cage_.push_back(static_cast<uint32_t>(i));
    list.push_back(static_cast<uint32_t>(i));
  }
}

const RecordList& TableIndex::byFrameCage(unsigned int frame, unsigned int cage) {
  if (frame > kMaxFrame || cage > kMaxCage) return empty_;
  if (!frame_cage_built_) buildFrameCage();
  auto it = frame_cage_.find(frameCageKey(frame, cage));
  return it == frame_cage_.end() ? empty_ : it->second;
}

const RecordList& TableIndex::firstOfEachFrameCage() {
  if (!frame_cage_built_) buildFrameCage();
  return first_of_frame_cage_;
}

const RecordList& TableIndex::byFrame(unsigned int frame) {
  if (frame > kMaxFrame) return empty_;
  if (!frame_built_) {
    frame_built_ = true;
    for (std::size_t i = 0; i < snapshot_.count(); ++i) {
      frame_[snapshot_.location(i).getFrame()].push_back(static_cast<uint32_t>(i));
    }
  }
  auto it = frame_.find(frame);
  return it == frame_.end() ? empty_ : it->second;
}

const RecordList& TableIndex::byNetwork(unsigned int network) {
  if (network >= kNetworks) return empty_;
  if (!network_built_) {
    network_built_ = true;
    network_.resize(kNetworks);
    for (std::size_t i = 0; i < snapshot_.count(); ++i) {
      network_[snapshot_.location(i).getNetwork()].push_back(static_cast<uint32_t>(i));
    }
  }
  return network_[network];
}

// Two MTMS are equal when their type-models agree as strncmp over 8 characters and their
// serials over 7: that is exactly equality of the texts up to the first NUL within those
// bounds, so the bounded texts make a hash key with the same meaning.
std::string TableIndex::mtmsKey(const mtms& m) {
  return vpd::fieldText(m.tm, mtms::kTmChars) + '\0' + vpd::fieldText(m.se, mtms::kSeChars);
}

long TableIndex::firstByMtms(const mtms& key) {
  if (!mtms_built_) {
    mtms_built_ = true;
    for (std::size_t i = 0; i < snapshot_.count(); ++i) {
      mtms m;
      std::memcpy(static_cast<void*>(&m), snapshot_.record(i) + desc_.mtms_offset, sizeof m);
      mtms_.emplace(mtmsKey(m), static_cast<uint32_t>(i));  // keeps the first
    }
  }
  auto it = mtms_.find(mtmsKey(key));
  return it == mtms_.end() ? -1 : static_cast<long>(it->second);
}

}  // namespace vpd
