// The small result that every step of vpdload hands back to main.
#ifndef TOOLS_VPDLOAD_STATUS_H_
#define TOOLS_VPDLOAD_STATUS_H_

#include <string>
#include <utility>

namespace vpdload {

// What went wrong, in the terms main turns into an exit status.
enum class Outcome {
  kOk,
  kInvalidInventory,  // the inventory breaks the schema; nothing was changed
  kCannotRead,        // the input file or a table cannot be read
  kCannotWrite,       // the tables or the output cannot be written
  kLocked,            // another import kept the data directory locked for the whole wait
};

struct Status {
  Outcome outcome = Outcome::kOk;
  std::string message;  // one line, without the "vpdload: " prefix; empty when ok

  bool ok() const { return outcome == Outcome::kOk; }
  static Status Ok() { return Status(); }
  static Status Fail(Outcome o, std::string m) { return Status{o, std::move(m)}; }
};

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_STATUS_H_
