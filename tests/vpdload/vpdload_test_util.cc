#include "vpdload_test_util.h"

#include <dirent.h>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <spawn.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

extern char** environ;

namespace vpdloadtest {

const char* vpdloadPath() { return VPDLOAD_BIN; }

testsupport::RunResult vpdload(const std::vector<std::string>& args, const std::string* input,
                               std::map<std::string, std::string> env) {
  std::vector<std::string> argv{VPDLOAD_BIN};
  argv.insert(argv.end(), args.begin(), args.end());
  env.emplace("CHRONICLE_LOG", "/dev/null");
  return testsupport::run(argv, env, input);
}

testsupport::RunResult importText(const std::string& data_dir, const std::string& json,
                                  const std::string& scratch_file) {
  testsupport::writeFile(scratch_file, json);
  return vpdload({"import", "--data", data_dir, scratch_file});
}

std::map<std::string, std::string> snapshot(const std::string& dir) {
  std::map<std::string, std::string> out;
  DIR* d = opendir(dir.c_str());
  if (d == nullptr) return out;
  while (dirent* e = readdir(d)) {
    std::string name = e->d_name;
    if (name == "." || name == "..") continue;
    std::string path = dir + "/" + name;
    struct stat st;
    if (lstat(path.c_str(), &st) != 0) continue;
    if (S_ISDIR(st.st_mode)) {
      out[name + "/"] = "";
    } else {
      out[name] = testsupport::readFile(path);
    }
  }
  closedir(d);
  return out;
}

testing::AssertionResult sameFiles(const std::map<std::string, std::string>& actual,
                                   const std::map<std::string, std::string>& expected) {
  std::string diff;
  auto describe = [](const std::map<std::string, std::string>& m, const std::string& name) {
    auto it = m.find(name);
    return it == m.end() ? std::string("missing") : std::to_string(it->second.size()) + " bytes";
  };
  std::map<std::string, bool> names;
  for (const auto& kv : actual) names[kv.first] = true;
  for (const auto& kv : expected) names[kv.first] = true;
  for (const auto& n : names) {
    auto a = actual.find(n.first), e = expected.find(n.first);
    bool same = a != actual.end() && e != expected.end() && a->second == e->second;
    if (!same) {
      diff += " " + n.first + " (" + describe(actual, n.first) + ", expected " +
              describe(expected, n.first) + ")";
    }
  }
  if (diff.empty()) return testing::AssertionSuccess();
  return testing::AssertionFailure() << "files differ:" << diff;
}

namespace {

std::map<std::string, std::string> tablesWithSuffix(const std::string& dir,
                                                    const std::string& suffix) {
  std::map<std::string, std::string> out;
  for (const char* name : {"chassis_vpd.db", "bpa_vpd.db", "sma_vpd.db"}) {
    std::string path = dir + "/" + name + suffix;
    out[name] = testsupport::fileExists(path) ? testsupport::readFile(path) : "";
  }
  return out;
}

std::string fru(const std::string& pn, const std::string& sn) {
  return R"({"ds": "unit", "pn": ")" + pn + R"(", "sn": ")" + sn + R"(", "cc": "2B4C"})";
}

}  // namespace

std::map<std::string, std::string> tables(const std::string& dir) {
  return tablesWithSuffix(dir, "");
}

std::map<std::string, std::string> oldTables(const std::string& dir) {
  return tablesWithSuffix(dir, ".old");
}

std::string makeInventory(int sma, int chassis, int bpa, const std::string& tag) {
  std::string j = "{\"sma\": [";
  for (int i = 0; i < sma; ++i) {
    j += i ? ",\n" : "\n";
    j += R"({"loc": {"frame": )" + std::to_string(1 + i / 4096) + R"(, "cage": )" +
         std::to_string((i / 16) % 256) + R"(, "chip": )" + std::to_string(i % 16) +
         R"(}, "fru": )" + fru("SMA" + std::to_string(i), tag + std::to_string(i)) +
         R"(, "cec": {"tm": "9125-F2A", "se": ")" + tag + R"("}, "timestamp": "t)" + tag + "\"}";
  }
  j += "],\n\"chassis\": [";
  for (int i = 0; i < chassis; ++i) {
    j += i ? ",\n" : "\n";
    j += R"({"loc": {"frame": 1, "cage": )" + std::to_string(i % 256) + R"(, "network": )" +
         std::to_string(i % 8) + R"(}, "mtms": {"tm": "7045-SW4", "se": ")" + tag +
         std::to_string(i % 1000) + R"("}, "fru": )" + fru("SW", tag) + R"(, "dca1": )" +
         fru("DCA1", tag) + R"(, "risers": [{"slot": 0, "fru": )" + fru("R0", tag) +
         R"(, "nbr1": {"frame": 2, "cage": 3, "type": "SMA"}, "port1": 1}]})";
  }
  j += "],\n\"bpa\": [";
  for (int i = 0; i < bpa; ++i) {
    j += i ? ",\n" : "\n";
    j += R"({"loc": {"frame": )" + std::to_string(i + 1) +
         R"(, "cage": 255}, "mtms": {"tm": "9458-100", "se": ")" + tag + R"("}, "bpc1": )" +
         fru("BPC", tag) + R"(, "bpr1": [)" + fru("BPR", tag) + "]}";
  }
  return j + "]}\n";
}

pid_t spawnQuiet(const std::vector<std::string>& argv) {
  setenv("CHRONICLE_LOG", "/dev/null", 1);  // children inherit it: no system log traffic
  std::vector<std::string> args = argv;
  std::vector<char*> argp;
  for (auto& s : args) argp.push_back(&s[0]);
  argp.push_back(nullptr);
  posix_spawn_file_actions_t fa;
  posix_spawn_file_actions_init(&fa);
  posix_spawn_file_actions_addopen(&fa, 0, "/dev/null", O_RDONLY, 0);
  posix_spawn_file_actions_addopen(&fa, 1, "/dev/null", O_WRONLY, 0);
  posix_spawn_file_actions_addopen(&fa, 2, "/dev/null", O_WRONLY, 0);
  pid_t pid = -1;
  int rc = posix_spawn(&pid, argp[0], &fa, nullptr, argp.data(), environ);
  posix_spawn_file_actions_destroy(&fa);
  if (rc != 0) {
    ADD_FAILURE() << "cannot start " << argv[0] << ": " << std::strerror(rc);
    return -1;
  }
  return pid;
}

int waitChild(pid_t pid) {
  int ws = 0;
  while (waitpid(pid, &ws, 0) < 0) {
    if (errno != EINTR) return -1;
  }
  if (WIFEXITED(ws)) return WEXITSTATUS(ws);
  if (WIFSIGNALED(ws)) return 128 + WTERMSIG(ws);
  return -1;
}

std::vector<std::string> stagingLeftovers(const std::string& dir) {
  std::vector<std::string> out;
  for (const auto& entry : snapshot(dir)) {
    if (entry.first.rfind(".vpdload.", 0) == 0 && entry.first.back() == '/') {
      out.push_back(entry.first);
    }
  }
  return out;
}

}  // namespace vpdloadtest
