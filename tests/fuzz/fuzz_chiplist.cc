// The dump tool's output as the switch chip list reads it, for any network number: the
// streaming reader, fed whole and in pieces, must agree with a plain line-by-line reading
// of the same text, and the frame filter of the network requests must keep one entry per
// frame.
//
// Input: u32 network, u8 piece size (0: one piece), then the dump text.
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>
#include <unordered_set>
#include <vector>

#include "fuzz_check.h"
#include "fuzz_input.h"
#include "requests.h"
#include "switch_list.h"

namespace {

using dorvex::kMaxChipEntries;

// Plain arrays filled with memset: element-by-element loops over 2048 entries would spend
// most of each run in the coverage callbacks.
struct Chips {
  explicit Chips(unsigned char fill) {
    std::memset(frames, fill, sizeof frames);
    std::memset(cages, fill, sizeof cages);
  }
  int frames[kMaxChipEntries];
  int cages[kMaxChipEntries];
  int count = 0;
};

// Lines end at a newline; fields are separated by runs of spaces; numbers read as strtol
// reads the field (which stops at an embedded NUL, as the streaming reader does).
Chips plainReading(const std::string& text, int network) {
  Chips out(0);
  std::unordered_set<uint64_t> seen;
  std::size_t start = 0;
  while (start < text.size()) {
    std::size_t end = text.find('\n', start);
    if (end == std::string::npos) end = text.size();
    std::vector<std::string> fields;
    std::size_t i = start;
    while (i < end && fields.size() < 6) {
      while (i < end && text[i] == ' ') ++i;
      std::size_t f = i;
      while (i < end && text[i] != ' ') ++i;
      if (i > f) fields.push_back(text.substr(f, i - f));
    }
    start = end + 1;
    if (fields.size() < 6 || fields[2].compare(0, 7, "SW_CHIP") != 0) continue;
    if (static_cast<int>(std::strtol(fields[5].c_str(), nullptr, 10)) != network) continue;
    if (out.count == kMaxChipEntries) continue;
    int frame = static_cast<int>(std::strtol(fields[0].c_str(), nullptr, 10));
    int cage = static_cast<int>(std::strtol(fields[1].c_str(), nullptr, 10));
    uint64_t key = (uint64_t{static_cast<uint32_t>(frame)} << 32) | static_cast<uint32_t>(cage);
    if (seen.insert(key).second) {
      out.frames[out.count] = frame;
      out.cages[out.count] = cage;
    }
    ++out.count;
  }
  return out;
}

Chips streamed(const std::string& text, int network, std::size_t piece) {
  Chips out(0xA5);  // the collector zeroes every entry itself
  dorvex::SwitchChipCollector collector(network, out.frames, out.cages);
  for (std::size_t at = 0; at < text.size(); at += piece) {
    std::size_t n = text.size() - at < piece ? text.size() - at : piece;
    collector.feed(text.data() + at, n);
  }
  collector.finish();
  out.count = collector.count();
  return out;
}

bool same(const Chips& a, const Chips& b) {
  return a.count == b.count && std::memcmp(a.frames, b.frames, sizeof a.frames) == 0 &&
         std::memcmp(a.cages, b.cages, sizeof a.cages) == 0;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  fuzzsupport::FuzzInput in(data, size);
  int network = static_cast<int>(in.u32());
  uint8_t piece = in.u8();
  std::string text = in.rest();

  Chips expected = plainReading(text, network);
  Chips whole = streamed(text, network, text.size() + 1);
  FUZZ_CHECK(same(whole, expected));
  if (piece != 0) FUZZ_CHECK(same(streamed(text, network, piece), expected));

  // The network requests keep the first entry of each frame. Entries past the stored ones
  // are (0, 0) and stay so.
  Chips filtered = whole;
  dorvex::clearDuplicateFrames(filtered.frames, filtered.cages);
  std::size_t tail = sizeof(int) * static_cast<std::size_t>(kMaxChipEntries - whole.count);
  FUZZ_CHECK(std::memcmp(filtered.frames + whole.count, expected.frames + whole.count, tail) == 0);
  std::unordered_set<int> kept;
  for (int i = 0; i < whole.count; ++i) {
    int f = filtered.frames[i];
    if (f == 0) continue;
    FUZZ_CHECK(kept.insert(f).second);
    FUZZ_CHECK(f == whole.frames[i] && filtered.cages[i] == whole.cages[i]);
  }
  for (int i = 0; i < whole.count; ++i) {
    if (whole.frames[i] != 0) FUZZ_CHECK(kept.count(whole.frames[i]) == 1);
  }
  return 0;
}
