#include "options.h"

#include <cerrno>
#include <cmath>
#include <cstdlib>

namespace vpdload {

namespace {

// Non-negative seconds, fractions allowed; at most a day, so that a typo cannot hang a
// script for ever.
bool parseSeconds(const std::string& text, double* out) {
  if (text.empty()) return false;
  char* end = nullptr;
  errno = 0;
  double v = std::strtod(text.c_str(), &end);
  if (errno != 0 || *end != '\0' || !std::isfinite(v) || v < 0 || v > 86400) return false;
  if (text.find_first_not_of("0123456789.") != std::string::npos) return false;
  *out = v;
  return true;
}

}  // namespace

bool parseOptions(const std::vector<std::string>& args, Options* opts, std::string* error) {
  std::vector<std::string> words;
  bool options_end = false;
  for (std::size_t i = 0; i < args.size(); ++i) {
    const std::string& a = args[i];
    if (options_end || a == "-" || a.empty() || a[0] != '-') {
      words.push_back(a);
      continue;
    }
    if (a == "--") {
      options_end = true;
      continue;
    }
    if (a == "--help" || a == "-h") {
      opts->command = Command::kHelp;
      return true;
    }
    std::string name = a, value;
    bool inline_value = false;
    std::size_t eq = a.find('=');
    if (a.compare(0, 2, "--") == 0 && eq != std::string::npos) {
      name = a.substr(0, eq);
      value = a.substr(eq + 1);
      inline_value = true;
    }
    if (name != "--data" && name != "--wait") {
      *error = "unknown option " + a;
      return false;
    }
    if (!inline_value) {
      if (i + 1 >= args.size()) {
        *error = "option " + name + " needs a value";
        return false;
      }
      value = args[++i];
    }
    if (name == "--data") {
      if (value.empty()) {
        *error = "option --data needs a directory";
        return false;
      }
      opts->data_dir = value;
    } else if (!parseSeconds(value, &opts->wait_seconds)) {
      *error = "option --wait takes seconds from 0 to 86400, not \"" + value + "\"";
      return false;
    }
  }
  if (words.empty()) {
    *error = "no command: import or export";
    return false;
  }
  if (words[0] == "import") {
    opts->command = Command::kImport;
    if (words.size() != 2) {
      *error = words.size() < 2 ? "import needs a FILE (- for standard input)"
                                : "import takes one FILE, not " + std::to_string(words.size() - 1);
      return false;
    }
  } else if (words[0] == "export") {
    opts->command = Command::kExport;
    if (words.size() > 2) {
      *error = "export takes at most one FILE, not " + std::to_string(words.size() - 1);
      return false;
    }
  } else {
    *error = "unknown command \"" + words[0] + "\": import or export";
    return false;
  }
  if (words.size() == 2) opts->file = words[1];
  return true;
}

const char* helpText() {
  return R"(Usage: vpdload [OPTIONS] import FILE
       vpdload [OPTIONS] export [FILE]
       vpdload --help

Loads an installation inventory (JSON) into the VPD tables, or writes the tables
back as an inventory. FILE - is standard input (import) or standard output
(export, also without FILE).

  import    Checks the whole inventory, then makes it the new generation of the
            chassis, BPA and SMA tables; each previous table is kept in its
            ".old" file. Readers see each table whole, old or new, at any moment.
            On any error the live tables and their ".old" files stay as they were.
  export    Writes every record of the three tables as an inventory. Importing
            it rebuilds byte-identical tables.

Options:
  --data DIR      data directory (default: $OLV_ROOT/data, or /opt/olv/data)
  --wait SECONDS  longest wait for another import to finish (default 30)
  -h, --help      this text

Inventory:
  {"sma":     [{"loc": LOC, "fru": FRU, "cec": MTMS, "neighbor": LOC,
                "timestamp": TEXT}],
   "chassis": [{"loc": LOC, "mtms": MTMS, "fru": FRU, "dca1": FRU, "dca2": FRU,
                "risers": [{"slot": 0-15, "fru": FRU, "nbr1": LOC, "port1": INT,
                            "nbr2": LOC, "port2": INT}],
                "timestamp": TEXT}],
   "bpa":     [{"loc": LOC, "timestamp": TEXT, "mtms": MTMS, "bpc1": FRU,
                "bpr1": [FRU, FRU, FRU], "bpd1": [...], "bpc2": FRU,
                "bpr2": [...], "bpd2": [...]}]}
  LOC   {"frame": 0-4095, "cage": 0-255, "chip": 0-15, "type": NAME or 0-15,
         "plane": 0-1, "network": 0-7}
        NAME: NSB SMA ISB BPA DCA CHASSIS BOARD RISER. A record's own "type" is
        that of its table (SMA, CHASSIS, BPA) and may be left out.
  MTMS  {"tm": at most 8 bytes, "se": at most 7}
  FRU   {"ds": at most 30 bytes, "pn", "ec", "fn", "sn": 12, "cc": 4, "yl": 15}
  TEXT  a string (the timestamp: at most 28 bytes), or {"hex": "c3a9ff"}: the
        bytes in hex. Export writes a text that is not valid UTF-8 that way.
  INT   a signed 32-bit integer.
  Absent members are empty or zero. Unknown keys, a key given twice, a riser
  slot given twice and a location given twice in one table are errors, each
  reported with its place, e.g. "chassis[3].dca1.pn: 13 characters, at most 12".
  Texts must not contain NUL.

Exit status:
  0  done
  1  the inventory is invalid (nothing was changed)
  2  usage error
  3  cannot read the input file, or the tables (export)
  4  cannot write the tables (import; nothing was changed) or the output (export)
  5  another import held the lock for the whole --wait (nothing was changed)
)";
}

}  // namespace vpdload
