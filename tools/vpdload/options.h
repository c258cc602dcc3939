// The command line of vpdload.
#ifndef TOOLS_VPDLOAD_OPTIONS_H_
#define TOOLS_VPDLOAD_OPTIONS_H_

#include <string>
#include <vector>

namespace vpdload {

// Exit statuses; chosen only in main.
enum class ExitStatus {
  kDone = 0,
  kInvalidInventory = 1,
  kUsage = 2,
  kCannotRead = 3,
  kCannotWrite = 4,
  kLocked = 5,
};

enum class Command { kNone, kHelp, kImport, kExport };

struct Options {
  Command command = Command::kNone;
  std::string file;          // import: required; export: "" or "-" for standard output
  std::string data_dir;      // "" for the default, $OLV_ROOT/data
  double wait_seconds = 30;  // longest wait for another import's lock
};

// Parses argv[1..]. Returns false with a one-line reason in `error` for a usage error.
bool parseOptions(const std::vector<std::string>& args, Options* opts, std::string* error);

// The text of --help.
const char* helpText();

}  // namespace vpdload

#endif  // TOOLS_VPDLOAD_OPTIONS_H_
