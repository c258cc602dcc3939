#include "switch_list.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <climits>
#include <cstring>
#include <string>

#include "olv_root.h"
#include "zrv_const.h"

namespace dorvex {
namespace {

const char kSwitchChipType[] = "SW_CHIP";
constexpr std::size_t kSwitchChipTypeLength = sizeof kSwitchChipType - 1;

// strtol's white space in the C locale; a blank never reaches a field.
bool isLeadingSpace(char c) {
  return c == ' ' || c == '\t' || c == '\n' || c == '\v' || c == '\f' || c == '\r';
}

bool isDigit(char c) { return c >= '0' && c <= '9'; }

uint64_t positionKey(int frame, int cage) {
  return (uint64_t{static_cast<uint32_t>(frame)} << 32) | static_cast<uint32_t>(cage);
}

}  // namespace

void StreamingDecimal::add(char c) {
  switch (state_) {
    case kLeading:
      if (isLeadingSpace(c)) return;
      if (c == '+' || c == '-') {
        negative_ = c == '-';
        state_ = kAfterSign;
        return;
      }
      [[fallthrough]];
    case kAfterSign:
    case kDigits:
      if (!isDigit(c)) {
        state_ = kDone;
        return;
      }
      state_ = kDigits;
      if (!overflow_) {
        unsigned long digit = static_cast<unsigned long>(c - '0');
        if (magnitude_ > (ULONG_MAX - digit) / 10) {
          overflow_ = true;
        } else {
          magnitude_ = magnitude_ * 10 + digit;
        }
      }
      return;
    case kDone:
      return;
  }
}

long StreamingDecimal::value() const {
  const unsigned long kMaxPositive = LONG_MAX;
  if (!overflow_ && magnitude_ <= kMaxPositive) {
    return negative_ ? -static_cast<long>(magnitude_) : static_cast<long>(magnitude_);
  }
  if (negative_ && !overflow_ && magnitude_ == kMaxPositive + 1) return LONG_MIN;
  return negative_ ? LONG_MIN : LONG_MAX;
}

SwitchChipCollector::SwitchChipCollector(int network, int* frames, int* cages)
    : network_(network), frames_(frames), cages_(cages) {
  std::memset(frames_, 0, sizeof(int) * kMaxChipEntries);
  std::memset(cages_, 0, sizeof(int) * kMaxChipEntries);
}

void SwitchChipCollector::feed(const char* data, std::size_t length) {
  const char* p = data;
  const char* end = data + length;
  bool newline_ahead = true;  // until a search for one fails: then none is left in this piece
  while (p < end) {
    if (fields_ == 0 && newline_ahead) {  // nothing but blanks of this line seen so far
      const char* newline =
          static_cast<const char*>(std::memchr(p, '\n', static_cast<std::size_t>(end - p)));
      if (newline != nullptr) {  // the whole line is here: read it at once
        readLine(p, newline);
        p = newline + 1;
        continue;
      }
      newline_ahead = false;
    }
    if (skipping_) {
      // Nothing more of this line can change what it stores: go straight to its newline.
      p = static_cast<const char*>(std::memchr(p, '\n', static_cast<std::size_t>(end - p)));
      if (p == nullptr) return;
    }
    char c = *p++;
    if (c == '\n') {
      endLine();
    } else if (c == ' ') {
      // The end of the type field decides whether the line is a chip line at all.
      if (in_field_ && fields_ == 3 && !typeIsSwitchChip()) skipping_ = true;
      in_field_ = false;
    } else {
      if (!in_field_) {
        in_field_ = true;
        if (++fields_ == 7) {  // fields from the seventh on are not used
          skipping_ = true;
          continue;
        }
      }
      addToField(c);
    }
  }
}

// The same reading as the byte-by-byte one, on a line that lies whole in one piece: only
// the line's first six fields are found, and only a chip line's numbers are read.
void SwitchChipCollector::readLine(const char* p, const char* end) {
  struct {
    const char* begin;
    const char* end;
  } field[6];
  int count = 0;
  while (count < 6) {
    while (p < end && *p == ' ') ++p;
    if (p == end) return;  // fewer than six fields
    field[count].begin = p;
    while (p < end && *p != ' ') ++p;
    field[count++].end = p;
    if (count == 3 && (static_cast<std::size_t>(p - field[2].begin) < kSwitchChipTypeLength ||
                       std::memcmp(field[2].begin, kSwitchChipType, kSwitchChipTypeLength) != 0)) {
      return;  // not a chip line
    }
  }
  auto number = [&](int i) {
    StreamingDecimal d;
    for (const char* c = field[i].begin; c < field[i].end; ++c) d.add(*c);
    return static_cast<int>(d.value());
  };
  if (number(5) == network_) store(number(0), number(1));
}

bool SwitchChipCollector::typeIsSwitchChip() const {
  return type_length_ == kSwitchChipTypeLength &&
         std::memcmp(type_, kSwitchChipType, kSwitchChipTypeLength) == 0;
}

void SwitchChipCollector::finish() {
  if (fields_ > 0) endLine();
}

void SwitchChipCollector::addToField(char c) {
  switch (fields_) {
    case 1:
      frame_.add(c);
      break;
    case 2:
      cage_.add(c);
      break;
    case 3:
      if (type_length_ < sizeof type_) type_[type_length_++] = c;
      break;
    case 6:
      network_field_.add(c);
      break;
    default:
      break;  // fields 4, 5 and 7 on are not used
  }
}

void SwitchChipCollector::endLine() {
  if (fields_ >= 6 && typeIsSwitchChip() && static_cast<int>(network_field_.value()) == network_) {
    store(static_cast<int>(frame_.value()), static_cast<int>(cage_.value()));
  }
  fields_ = 0;
  in_field_ = false;
  skipping_ = false;
  frame_ = StreamingDecimal();
  cage_ = StreamingDecimal();
  network_field_ = StreamingDecimal();
  type_length_ = 0;
}

void SwitchChipCollector::store(int frame, int cage) {
  if (num_ == kMaxChipEntries) return;
  if (stored_.insert(positionKey(frame, cage)).second) {
    frames_[num_] = frame;
    cages_[num_] = cage;
  }  // else a repeat: its entry stays a (0, 0) hole
  ++num_;
}

int getSwitchList(int network, int* frames, int* cages) {
  SwitchChipCollector collector(network, frames, cages);

  std::string tool = olv::underRoot(ZRV_RACKPROBE);
  std::string dump_arg = "dump", detail_arg = "-d";
  char* argv[] = {&tool[0], &dump_arg[0], &detail_arg[0], nullptr};

  int pipe_fds[2];
  if (pipe2(pipe_fds, O_CLOEXEC) != 0) return kSwitchListNoTool;
  posix_spawn_file_actions_t actions;
  if (posix_spawn_file_actions_init(&actions) != 0) {
    close(pipe_fds[0]);
    close(pipe_fds[1]);
    return kSwitchListNoTool;
  }
  // dup2 onto standard output drops close-on-exec for the child's copy only.
  int rc = posix_spawn_file_actions_adddup2(&actions, pipe_fds[1], STDOUT_FILENO);
  pid_t pid = -1;
  if (rc == 0) rc = posix_spawn(&pid, tool.c_str(), &actions, nullptr, argv, environ);
  posix_spawn_file_actions_destroy(&actions);
  close(pipe_fds[1]);
  if (rc != 0) {  // glibc reports a failed exec here, so a missing tool ends up here too
    close(pipe_fds[0]);
    return kSwitchListNoTool;
  }

  char buffer[65536];
  for (;;) {
    ssize_t n = read(pipe_fds[0], buffer, sizeof buffer);
    if (n > 0) {
      collector.feed(buffer, static_cast<std::size_t>(n));
    } else if (n == 0 || errno != EINTR) {
      break;
    }
  }
  collector.finish();
  close(pipe_fds[0]);

  int status;
  while (waitpid(pid, &status, 0) < 0 && errno == EINTR) {
  }
  return 0;
}

}  // namespace dorvex
