#include "example_root.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <ctime>

namespace producttest {

using testsupport::readFile;
using testsupport::run;
using testsupport::writeFile;

std::string installExample(const Tools& tools, const std::string& root) {
  testsupport::makeDirs(root + "/etc");
  testsupport::makeDirs(root + "/bin");
  testsupport::RunResult load =
      run({tools.vpdload, "import", tools.examples + "/installation.json"}, rootEnv(root));
  if (load.status != 0) {
    return "vpdload import ended with status " + std::to_string(load.status) + ": " + load.err;
  }
  for (const char* name : {"hwserver.json", "rackprobe.dump"}) {
    writeFile(root + "/etc/" + name, readFile(tools.examples + "/" + name));
  }
  if (!tools.rackprobe.empty()) {
    writeFile(root + "/bin/rackprobe", readFile(tools.rackprobe), 0755);
  }
  const std::string sma = root + "/data/sma_vpd.db";
  struct timespec times[2];
  times[0].tv_sec = times[1].tv_sec = kPollTime;
  times[0].tv_nsec = times[1].tv_nsec = 0;
  if (::utimensat(AT_FDCWD, sma.c_str(), times, 0) != 0) {
    return "cannot set the time of " + sma + ": " + std::strerror(errno);
  }
  return "";
}

std::map<std::string, std::string> rootEnv(const std::string& root) {
  return {{"OLV_ROOT", root}, {"CHRONICLE_LOG", root + "/trace.log"}};
}

std::string golden(const std::string& name) {
  return readFile(std::string(GOLDEN_DIR) + "/" + name);
}

std::string commandText(const std::vector<std::string>& args) {
  std::string text = "dorvex";
  for (const std::string& a : args) text += " " + a;
  return text;
}

}  // namespace producttest
