// gen_installation: writes a large, realistic installation into an install root, for the
// benchmarks and for trying dorvex on a big machine room. Same arguments, same bytes.
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "installation_layout.h"
#include "installation_writer.h"

namespace {

const char kUsage[] = R"(Usage: gen_installation [OPTIONS] ROOT

Writes an installation into the install root ROOT: the chassis, BPA and SMA tables
under ROOT/data (a new generation: an existing one is kept in the ".old" files),
ROOT/etc/rackprobe.dump and ROOT/etc/hwserver.json. The same options give the
same bytes.

  --scale N      size proportional to N: 16N switch chassis on one network,
                 64N CECs with 8 SMA records each, 4N frames (N = 64 is 1024
                 chassis, 4096 CECs, 256 frames: about 8 MB of tables)
  --switches N   switch chassis per network (default 16, at most 2048)
  --networks N   networks 1..N (default 1, at most 7)
  --cecs N       CECs (default 64)
  --sma N        SMA records per CEC, one per chip (default 8, at most 16)
  --frames N     frames, each with its BPA at cage 255 (default 4, at most 4095)
  --consoles N   management consoles (default 2)
  --seed N       seed of serial numbers, cabling and timestamps (default 1)
  -h, --help     this text

Options are applied in order, so --scale 4 --cecs 10 is scale 4 with 10 CECs.
)";

enum Exit { kDone = 0, kCannotWrite = 1, kUsageError = 2 };

bool parseNumber(const char* text, unsigned long long limit, unsigned long long* value) {
  if (text == nullptr || *text < '0' || *text > '9') return false;
  char* end = nullptr;
  errno = 0;
  unsigned long long v = std::strtoull(text, &end, 10);
  if (errno != 0 || *end != '\0' || v > limit) return false;
  *value = v;
  return true;
}

int usageError(const std::string& why) {
  std::fprintf(stderr, "gen_installation: %s\nTry 'gen_installation --help'.\n", why.c_str());
  return kUsageError;
}

}  // namespace

int main(int argc, char** argv) {
  gen::Params p;
  std::string root;
  for (int i = 1; i < argc; ++i) {
    std::string arg = argv[i];
    if (arg == "-h" || arg == "--help") {
      std::fputs(kUsage, stdout);
      return kDone;
    }
    if (arg.rfind("--", 0) != 0) {
      if (!root.empty()) return usageError("more than one ROOT: " + root + " and " + arg);
      root = arg;
      continue;
    }
    std::string name = arg, value_text;
    std::size_t eq = arg.find('=');
    if (eq != std::string::npos) {
      name = arg.substr(0, eq);
      value_text = arg.substr(eq + 1);
    } else if (i + 1 < argc) {
      value_text = argv[++i];
    } else {
      return usageError(name + " needs a number");
    }
    unsigned long long v = 0;
    unsigned long long limit = name == "--seed" ? ~0ull : 0xffffffffull;
    if (!parseNumber(value_text.c_str(), limit, &v))
      return usageError(name + ": '" + value_text + "' is not a whole number in range");
    unsigned int n = static_cast<unsigned int>(v);
    if (name == "--scale") {
      if (n < 1 || n > 128) return usageError("--scale must be 1 to 128");
      uint64_t seed = p.seed;
      p = gen::Params::scaled(n);
      p.seed = seed;
    } else if (name == "--switches") {
      p.switches_per_network = n;
    } else if (name == "--networks") {
      p.networks = n;
    } else if (name == "--cecs") {
      p.cecs = n;
    } else if (name == "--sma") {
      p.sma_per_cec = n;
    } else if (name == "--frames") {
      p.frames = n;
    } else if (name == "--consoles") {
      p.consoles = n;
    } else if (name == "--seed") {
      p.seed = v;
    } else {
      return usageError("unknown option " + name);
    }
  }
  if (root.empty()) return usageError("no ROOT given");
  std::string problem = gen::checkParams(p);
  if (!problem.empty()) return usageError(problem);

  gen::Layout layout(p);
  gen::Written w;
  std::string error = gen::writeInstallation(root, layout, &w);
  if (!error.empty()) {
    std::fprintf(stderr, "gen_installation: %s\n", error.c_str());
    return kCannotWrite;
  }
  std::printf("%s: %llu chassis, %llu BPA and %llu SMA records, %llu bytes of tables\n",
              root.c_str(), static_cast<unsigned long long>(w.chassis_records),
              static_cast<unsigned long long>(w.bpa_records),
              static_cast<unsigned long long>(w.sma_records),
              static_cast<unsigned long long>(w.table_bytes));
  return kDone;
}
