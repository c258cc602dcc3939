#include "table_index.h"

#include <algorithm>
#include <cstring>
#include <unordered_set>

namespace vpd {
namespace {

constexpr unsigned int kMaxFrame = (1u << loc_id_t::kFrameWidth) - 1;
constexpr unsigned int kMaxCage = (1u << loc_id_t::kUidWidth) - 1;
constexpr unsigned int kNetworks = 1u << loc_id_t::kNetworkWidth;

uint32_t frameCageKey(loc_id_t l) { return (l.getFrame() << 8) | l.getCage(); }

RecordRange rangeOf(const std::vector<Run>& v) {
  return RecordRange{v.data(), v.data() + v.size()};
}

// Appends record i with its key to runs, extending the last run when i continues it.
void addRecord(std::vector<Run>& runs, uint32_t key, std::size_t i) {
  const auto record = static_cast<uint32_t>(i);
  if (!runs.empty()) {
    Run& last = runs.back();
    if (last.key == key && last.first + last.count == record) {
      ++last.count;
      return;
    }
  }
  runs.push_back(Run{key, record, 1});
}

bool byKeyThenPosition(const Run& a, const Run& b) {
  return a.key != b.key ? a.key < b.key : a.first < b.first;
}

}  // namespace

template <class KeyOf>
RecordRange TableIndex::lookup(Grouping& g, uint32_t key, KeyOf key_of) {
  const std::size_t n = snapshot_.count();
  if (g.sorted.empty() && g.uses++ == 0) {
    scratch_.clear();
    for (std::size_t i = 0; i < n; ++i) {
      if (key_of(snapshot_.location(i)) == key) addRecord(scratch_, key, i);
    }
    return rangeOf(scratch_);
  }
  if (g.sorted.empty()) {
    for (std::size_t i = 0; i < n; ++i) addRecord(g.sorted, key_of(snapshot_.location(i)), i);
    std::sort(g.sorted.begin(), g.sorted.end(), byKeyThenPosition);
  }
  auto lo = std::lower_bound(g.sorted.begin(), g.sorted.end(), key,
                             [](const Run& r, uint32_t k) { return r.key < k; });
  auto hi =
      std::upper_bound(lo, g.sorted.end(), key, [](uint32_t k, const Run& r) { return k < r.key; });
  return RecordRange{g.sorted.data() + (lo - g.sorted.begin()),
                     g.sorted.data() + (hi - g.sorted.begin())};
}

RecordRange TableIndex::byFrameCage(unsigned int frame, unsigned int cage) {
  if (frame > kMaxFrame || cage > kMaxCage) return RecordRange{};
  return lookup(frame_cage_, (frame << 8) | cage, frameCageKey);
}

RecordRange TableIndex::byFrame(unsigned int frame) {
  if (frame > kMaxFrame) return RecordRange{};
  return lookup(frame_, frame, [](loc_id_t l) { return l.getFrame(); });
}

RecordRange TableIndex::byNetwork(unsigned int network) {
  if (network >= kNetworks) return RecordRange{};
  return lookup(network_, network, [](loc_id_t l) { return l.getNetwork(); });
}

// Two MTMS are equal when their type-models agree as strncmp over 8 characters and their
// serials over 7: that is exactly equality of the texts up to the first NUL within those
// bounds, so the bounded texts make a hash key with the same meaning.
std::string TableIndex::mtmsKey(const mtms& m) {
  return vpd::fieldText(m.tm, mtms::kTmChars) + '\0' + vpd::fieldText(m.se, mtms::kSeChars);
}

mtms TableIndex::recordMtms(std::size_t i) const {
  mtms m;
  std::memcpy(static_cast<void*>(&m), snapshot_.record(i) + desc_.mtms_offset, sizeof m);
  return m;
}

RecordRange TableIndex::firstByMtms(const mtms& key) {
  scratch_.clear();
  const std::size_t n = snapshot_.count();
  if (mtms_uses_++ == 0) {
    for (std::size_t i = 0; i < n; ++i) {
      if (recordMtms(i) == key) {
        addRecord(scratch_, 0, i);
        break;
      }
    }
    return rangeOf(scratch_);
  }
  if (first_by_mtms_.empty()) {
    for (std::size_t i = 0; i < n; ++i) {
      first_by_mtms_.emplace(mtmsKey(recordMtms(i)), static_cast<uint32_t>(i));  // keeps the first
    }
  }
  auto it = first_by_mtms_.find(mtmsKey(key));
  if (it != first_by_mtms_.end()) addRecord(scratch_, 0, it->second);
  return rangeOf(scratch_);
}

RecordRange TableIndex::firstOfEachFrameCage() {
  scratch_.clear();
  std::unordered_set<uint32_t> seen;
  for (std::size_t i = 0; i < snapshot_.count(); ++i) {
    uint32_t key = frameCageKey(snapshot_.location(i));
    if (seen.insert(key).second) scratch_.push_back(Run{key, static_cast<uint32_t>(i), 1});
  }
  return rangeOf(scratch_);
}

}  // namespace vpd
