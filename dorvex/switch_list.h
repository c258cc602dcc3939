// The switch chips of one network, taken from the output of the sibling dump tool
// ($OLV_ROOT/bin/rackprobe dump -d).
//
// A line's fields are separated by runs of spaces (a tab belongs to a field); the line's
// newline ends it. Of at least six fields, the first is the frame, the second the cage,
// the third the device type and the sixth the network, numbers read as strtol base 10
// reads them. A line whose type begins with "SW_CHIP" and whose network is the requested
// one stores its (frame, cage) at the next index; a position already stored leaves a
// (0, 0) hole instead, so each position appears once, at its first line.
#ifndef DORVEX_SWITCH_LIST_H_
#define DORVEX_SWITCH_LIST_H_

#include <cstddef>
#include <cstdint>
#include <unordered_set>

namespace dorvex {

// Entries of the frame and cage arrays, repeats and holes included.
constexpr int kMaxChipEntries = 2048;

// getSwitchList's result when the dump tool cannot be started.
constexpr int kSwitchListNoTool = -1;

// Reads a decimal number one character at a time, exactly as strtol(text, nullptr, 10)
// reads the whole text: leading white space, an optional sign, digits up to the first
// other character; 0 without digits; LONG_MAX or LONG_MIN when out of range.
class StreamingDecimal {
 public:
  void add(char c);
  long value() const;

 private:
  enum State { kLeading, kAfterSign, kDigits, kDone };
  State state_ = kLeading;
  bool negative_ = false;
  bool overflow_ = false;
  unsigned long magnitude_ = 0;
};

// Collects the chip entries of one network from the dump output, fed in pieces of any size.
// Lines of any length are one line; only the first six fields are looked at, so memory does
// not grow with the line.
class SwitchChipCollector {
 public:
  // Zeroes all kMaxChipEntries entries of both arrays (owned by the caller).
  SwitchChipCollector(int network, int* frames, int* cages);
  void feed(const char* data, std::size_t length);
  // Ends a last line that has no newline.
  void finish();
  // Entries stored so far (holes included); at most kMaxChipEntries.
  int count() const { return num_; }

 private:
  void readLine(const char* begin, const char* end);
  void addToField(char c);
  bool typeIsSwitchChip() const;
  void endLine();
  // Stores a chip line's position at the next index, or a hole for a repeat.
  void store(int frame, int cage);

  int network_;
  int* frames_;
  int* cages_;
  int num_ = 0;
  std::unordered_set<uint64_t> stored_;  // positions stored so far

  // State of the current line.
  int fields_ = 0;  // fields begun so far, up to 7
  bool in_field_ = false;
  bool skipping_ = false;  // the rest of the line cannot matter
  StreamingDecimal frame_, cage_, network_field_;
  char type_[7] = {};
  std::size_t type_length_ = 0;
};

// Runs the dump tool (no shell), reads its output to the end, waits for it, and fills both
// arrays (kMaxChipEntries each) for `network`; output beyond the last entry is read and
// ignored. Returns 0, or kSwitchListNoTool (arrays all zero) when the tool cannot be
// started. The tool's exit status is not examined.
int getSwitchList(int network, int* frames, int* cages);

}  // namespace dorvex

#endif  // DORVEX_SWITCH_LIST_H_
