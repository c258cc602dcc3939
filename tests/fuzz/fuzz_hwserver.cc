// etc/hwserver.json as the stand-ins read it, then, when it loads, console discovery over
// the stand-ins' replies. The file lives in a private folder on tmpfs ($OLV_ROOT/etc) and is
// rewritten for every input; an empty input stands for a missing file.
//
// Checked: reading the file agrees with parsing its text; discovery throws 3548 exactly when
// the file does not load; otherwise every console of the file arrives once, in file order,
// with the BPA list and MTMS of the first console of its address, and every BPA with the
// MTMS of the first BPA of its virtual port (empty when there is none).
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>

#include "console_discovery.h"
#include "fuzz_check.h"
#include "hwconfig.h"

namespace {

std::string config_path;

void writeConfig(const uint8_t* data, size_t size) {
  if (size == 0) {
    unlink(config_path.c_str());
    return;
  }
  int fd = open(config_path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
  FUZZ_CHECK(fd >= 0);
  FUZZ_CHECK(write(fd, data, size) == static_cast<ssize_t>(size));
  close(fd);
}

bool mtmsIs(const mtms& m, const std::string& tm, const std::string& se) {
  mtms expected(tm.c_str(), se.c_str());
  return std::memcmp(&m, &expected, sizeof m) == 0;
}

void removeRoot() {
  unlink(config_path.c_str());
  std::string root = config_path.substr(0, config_path.rfind("/etc/"));
  rmdir((root + "/etc").c_str());
  rmdir(root.c_str());
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
  char root[] = "/dev/shm/fuzz_hwserver.XXXXXX";
  if (mkdtemp(root) == nullptr) {
    char fallback[] = "/tmp/fuzz_hwserver.XXXXXX";
    if (mkdtemp(fallback) == nullptr) std::abort();
    std::strcpy(root, fallback);
  }
  std::string etc = std::string(root) + "/etc";
  if (mkdir(etc.c_str(), 0755) != 0) std::abort();
  config_path = etc + "/hwserver.json";
  setenv("OLV_ROOT", root, 1);
  setenv("CHRONICLE_LOG", "/dev/null", 1);
  std::atexit(removeRoot);
  return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  writeConfig(data, size);
  hwserver::LoadResult parsed =
      hwserver::parse(std::string(reinterpret_cast<const char*>(data), size), config_path);
  if (size == 0) parsed = hwserver::LoadResult{true, {}, ""};  // missing: no consoles
  hwserver::LoadResult loaded = hwserver::load();
  FUZZ_CHECK(loaded.ok == parsed.ok && loaded.error == parsed.error);
  FUZZ_CHECK(parsed.ok == parsed.error.empty());

  dorvex::zev.clear();
  bool discovered = false;
  try {
    discovered = dorvex::getzevmtms() == 0;
  } catch (int e) {
    FUZZ_CHECK(e == 3548);  // both stand-ins read the same file: the first one gives up
  }
  FUZZ_CHECK(discovered == parsed.ok);
  if (!discovered) return 0;

  const hwserver::Config& config = parsed.config;
  FUZZ_CHECK(dorvex::zev.size() == config.consoles.size());
  for (std::size_t i = 0; i < config.consoles.size(); ++i) {
    const dorvex::zev_info_t& got = dorvex::zev[i];
    FUZZ_CHECK(std::memcmp(got.ip, config.consoles[i].ip.data(), 4) == 0);
    const hwserver::Console* first = hwserver::findConsole(config, got.ip);
    FUZZ_CHECK(first != nullptr);
    FUZZ_CHECK(mtmsIs(got.zevmtms, first->tm, first->se));
    FUZZ_CHECK(got.bpa.size() == first->bpa_vports.size());
    for (std::size_t j = 0; j < got.bpa.size(); ++j) {
      FUZZ_CHECK(got.bpa[j].vport == first->bpa_vports[j]);
      const hwserver::Bpa* bpa = hwserver::findBpa(config, got.bpa[j].vport);
      FUZZ_CHECK(bpa != nullptr ? mtmsIs(got.bpa[j].bpamtms, bpa->tm, bpa->se)
                                : mtmsIs(got.bpa[j].bpamtms, "", ""));
    }
  }
  dorvex::zev.clear();
  return 0;
}
