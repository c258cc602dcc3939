// The argument vector of dorvex through option parsing, request selection and the chosen
// request, against the sample installation's tables served from memory. The install root is
// a private tmpfs folder holding etc/hwserver.json and no bin/rackprobe, so a network request
// finds its consoles and then fails to start the dump tool at once: no child ever runs.
//
// Input: the arguments after the program name, each ended by a NUL byte (a last argument
// without one counts too).
#include <getopt.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "console_discovery.h"
#include "exit_status.h"
#include "fuzz_check.h"
#include "memory_tables.h"
#include "options.h"
#include "output_stream.h"
#include "process_flags.h"
#include "sample_installation.h"
#include "settings.h"

namespace {

std::string root;
fuzzsupport::TableBytes tables;
FILE* dev_null = nullptr;

void removeRoot() {
  unlink((root + "/etc/hwserver.json").c_str());
  rmdir((root + "/etc").c_str());
  rmdir(root.c_str());
}

bool networkType() {
  return dorvex::type == dorvex::kTypeBpa || dorvex::type == dorvex::kTypeSwitch ||
         dorvex::type == dorvex::kTypeNetvpd;
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
  char dir[] = "/dev/shm/fuzz_args.XXXXXX";
  char fallback[] = "/tmp/fuzz_args.XXXXXX";
  const char* made = mkdtemp(dir);
  if (made == nullptr) made = mkdtemp(fallback);
  if (made == nullptr) std::abort();
  root = made;
  if (mkdir((root + "/etc").c_str(), 0755) != 0) std::abort();
  FILE* f = std::fopen((root + "/etc/hwserver.json").c_str(), "w");
  if (f == nullptr) std::abort();
  std::string json = sample::hwserverJson();
  std::fwrite(json.data(), 1, json.size(), f);
  std::fclose(f);
  std::atexit(removeRoot);
  setenv("OLV_ROOT", root.c_str(), 1);
  setenv("CHRONICLE_LOG", "/dev/null", 1);

  tables.chassis = sample::tableBytes(sample::chassisRecords());
  tables.bpa = sample::tableBytes(sample::bpaRecords());
  tables.sma = sample::tableBytes(sample::smaRecords());
  tables.mtime = 1765000000;

  opterr = 0;  // getopt's own complaints about unknown options would flood the log
  std::fflush(stdout);
  if (std::freopen("/dev/null", "w", stdout) == nullptr) std::abort();
  dev_null = std::fopen("/dev/null", "w");
  if (dev_null == nullptr) std::abort();
  return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  // Every word is its own allocation, so that reading past one shows.
  std::vector<std::vector<char>> words;
  words.push_back({'d', 'o', 'r', 'v', 'e', 'x', '\0'});
  std::vector<char> word;
  for (size_t i = 0; i < size; ++i) {
    word.push_back(static_cast<char>(data[i]));
    if (data[i] == '\0') {
      words.push_back(word);
      word.clear();
    }
  }
  if (!word.empty()) {
    word.push_back('\0');
    words.push_back(word);
  }
  std::vector<char*> argv;
  for (std::vector<char>& w : words) argv.push_back(w.data());
  argv.push_back(nullptr);
  int argc = static_cast<int>(words.size());

  dorvex::resetSettings();
  dorvex::zev.clear();
  dorvex::setOutStream(dev_null);
  fuzzsupport::MemoryTables memory(tables, root + "/data");

  switch (dorvex::parseCommandLine(argc, argv.data())) {
    case dorvex::CommandLine::kHelp:
    case dorvex::CommandLine::kVersion:
      FUZZ_CHECK(argc == 2);
      break;
    case dorvex::CommandLine::kTooFewWords:
      FUZZ_CHECK(argc < 3);
      break;
    case dorvex::CommandLine::kRequest: {
      FUZZ_CHECK(argc >= 3);
      dorvex::RequestForm form = dorvex::chooseForm();
      FUZZ_CHECK(dorvex::processFlags() == 0);
      int prc = dorvex::prc;
      // The tables are all there and hwserver.json loads: no status 3 or 5. Status 4 comes
      // from exactly the network requests that run the dump tool.
      FUZZ_CHECK(prc == dorvex::kExitDone || prc == dorvex::kExitNotFound ||
                 prc == dorvex::kExitNoRequest || prc == dorvex::kExitNoDumpTool);
      FUZZ_CHECK((prc == dorvex::kExitNoDumpTool) ==
                 (form == dorvex::RequestForm::kNetwork && networkType()));
      // Without a request type no form has a branch to take.
      if (dorvex::type == dorvex::kNotGiven) FUZZ_CHECK(prc == dorvex::kExitNoRequest);
      break;
    }
  }
  FUZZ_CHECK(fuzzsupport::MemoryTables::openCount() == 0);
  dorvex::setOutStream(nullptr);
  return 0;
}
