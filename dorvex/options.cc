#include "options.h"

#include <getopt.h>

#include <cstdlib>
#include <cstring>

#include "output_stream.h"
#include "settings.h"

#ifndef DORVEX_VERSION
#define DORVEX_VERSION "unknown"
#endif

namespace dorvex {
namespace {

const char kOptionString[] = "y:f:c:r:t:h:p:a:m:n:";

const char* const kTypeKeywords[] = {"cec", "switch", "bpa", "netvpd", "all", nullptr};
const int kTypeCodes[] = {kTypeCec, kTypeSwitch, kTypeBpa, kTypeNetvpd, kTypeAll};

const char* const kFruKeywords[] = {"dca", "planar", "riser", "adapter", "bpc",
                                    "bpd", "bpr",    "ibf",   "epo_sw",  nullptr};
const int kFruCodes[] = {kFruDca, kFruPlanar, kFruRiser, kFruAdapter, kFruBpc,
                         kFruBpd, kFruBpr,    kFruIbf,   kFruEpoSw};

const char kHelpText[] =
    "usage: dorvex -y TYPE [-f FRAME] [-c CAGE] [-r FRU] [-h PART] [-a BPA] [-m MTMS]\n"
    "              [-t TIME] [-n NETWORK]\n"
    "Prints the vital product data of the installation's hardware.\n"
    "\n"
    "  -y TYPE     cec, switch, bpa, netvpd or all\n"
    "  -f FRAME    frame number\n"
    "  -c CAGE     cage number within the frame\n"
    "  -r FRU      dca, planar, riser, adapter, bpc, bpd, bpr, ibf or epo_sw\n"
    "  -h PART     DCA number (1, 2), riser index (0-15), adapter number (1, 2)\n"
    "              or BPR/BPD index (0-2)\n"
    "  -a BPA      BPA of the frame (1 or 2)\n"
    "  -m MTMS     type-model (8 characters), a separator, serial (7 characters)\n"
    "  -t TIME     SMA table time of the previous answer, in seconds since the epoch\n"
    "  -n NETWORK  network whose switch chips are listed\n"
    "  -p PORT     accepted and ignored\n"
    "\n"
    "Requests, the first that fits wins:\n"
    "  -f -c -r -h   one part of a FRU        (-y bpa, switch or cec)\n"
    "  -f -c -r      one FRU                  (-y bpa or switch)\n"
    "  -f -c         the enclosure            (-y bpa, switch or cec)\n"
    "  -t            CEC list change poll     (-y cec)\n"
    "  -f            switch chassis of frame  (-y switch)\n"
    "  -m            enclosure of an MTMS     (-y bpa or switch)\n"
    "  -n            network enclosures/VPD   (-y bpa, switch or netvpd)\n"
    "  (none)        dump of the three tables (-y all)\n"
    "\n"
    "Exit status: 0 done, 1 not found, 2 no request fits, 3 database cannot be opened,\n"
    "4 switch chip dump tool cannot be started, 5 console discovery failed.\n";

}  // namespace

int usage() { return 0; }

void printHelp(FILE* out) { std::fputs(kHelpText, out); }

void printVersion(FILE* out) { std::fputs("dorvex " DORVEX_VERSION "\n", out); }

int keywordCode(const char* value, const char* const* keywords, const int* codes, int current) {
  for (int i = 0; keywords[i] != nullptr; ++i) {
    if (std::strncmp(value, keywords[i], std::strlen(keywords[i])) == 0) return codes[i];
  }
  return current;
}

int decimalValue(const char* text) { return static_cast<int>(std::strtol(text, nullptr, 10)); }

CommandLine parseCommandLine(int argc, char** argv) {
  if (argc == 2 && std::strcmp(argv[1], "--help") == 0) return CommandLine::kHelp;
  if (argc == 2 && std::strcmp(argv[1], "--version") == 0) return CommandLine::kVersion;
  if (argc < 3) return CommandLine::kTooFewWords;

  optind = 0;  // glibc: start over, even after an earlier parse in this process
  int opt;
  while ((opt = getopt(argc, argv, kOptionString)) != -1) {
    switch (opt) {
      case 'y':
        type = keywordCode(optarg, kTypeKeywords, kTypeCodes, type);
        break;
      case 'r':
        fruid = keywordCode(optarg, kFruKeywords, kFruCodes, fruid);
        break;
      case 'f':
        frame = decimalValue(optarg);
        break;
      case 'c':
        cage = decimalValue(optarg);
        break;
      case 't':
        mtime = decimalValue(optarg);
        break;
      case 'h':
        partnum = decimalValue(optarg);
        break;
      case 'p':
        port = decimalValue(optarg);
        break;
      case 'a':
        bpanum = decimalValue(optarg);
        break;
      case 'm':
        mtmsid = optarg;
        break;
      case 'n':
        network = decimalValue(optarg);
        break;
      default:
        std::fprintf(outStream(), "%d\n", usage());
        break;
    }
  }
  return CommandLine::kRequest;
}

}  // namespace dorvex
