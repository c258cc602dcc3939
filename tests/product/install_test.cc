// `cmake --install` into a temporary prefix, then the installed programs run the example
// installation from that tree alone, with the prefix as their install root.
#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <fstream>
#include <regex>
#include <string>
#include <vector>

#include "example_root.h"
#include "test_support.h"

namespace producttest {
namespace {

using testsupport::fileExists;
using testsupport::run;

// What the console's tree holds after an install.
const char* const kInstalled[] = {
    "bin/dorvex",
    "bin/vpdload",
    "bin/rackprobe",
    "lib/libchronicle.so",
    "lib/libnodebridge.so",
    "lib/librackpower.so",
    "lib/libvpddb.a",
    "lib/libolvcommon.a",
    "include/vpdDB/vpdDB.h",
    "share/man/man1/dorvex.1",
    "share/man/man1/vpdload.1",
    "share/doc/dorvex/examples/installation.json",
    "share/doc/dorvex/examples/hwserver.json",
    "share/doc/dorvex/examples/rackprobe.dump",
};

// Whether a line of the page names `option` in bold (.B, .BI or .BR) as its first word.
bool hasEntry(const std::string& page, const std::string& option) {
  std::string escaped;
  for (char c : option) escaped += c == '-' ? std::string("\\-") : std::string(1, c);
  for (const std::string& line : testsupport::lines(page)) {
    for (const char* macro : {".B ", ".BI ", ".BR "}) {
      std::string start = macro + escaped;
      if (line.compare(0, start.size(), start) == 0 &&
          (line.size() == start.size() || line[start.size()] == ' ')) {
        return true;
      }
    }
  }
  return false;
}

class InstalledTree : public ::testing::Test {
 protected:
  static void SetUpTestSuite() {
    prefix_ = new testsupport::TempDir;
    install_ = new testsupport::RunResult(
        run({CMAKE_BIN, "--install", BUILD_DIR, "--prefix", prefix_->path()}));
  }
  static void TearDownTestSuite() {
    delete install_;
    delete prefix_;
  }
  void SetUp() override { ASSERT_EQ(install_->status, 0) << install_->out << install_->err; }

  static std::string path(const std::string& relative) { return *prefix_ / relative; }

  static testsupport::TempDir* prefix_;
  static testsupport::RunResult* install_;
};

testsupport::TempDir* InstalledTree::prefix_ = nullptr;
testsupport::RunResult* InstalledTree::install_ = nullptr;

TEST_F(InstalledTree, LaysOutTheConsolesTree) {
  for (const char* file : kInstalled) EXPECT_TRUE(fileExists(path(file))) << file;
  for (const char* program : {"bin/dorvex", "bin/vpdload", "bin/rackprobe"}) {
    EXPECT_EQ(::access(path(program).c_str(), X_OK), 0) << program << " is not executable";
  }
}

// Another producer builds against include/vpdDB alone: every header that an installed
// header includes with quotes must be installed beside it.
TEST_F(InstalledTree, HeadersAreSelfContained) {
  const std::regex include_line("^\\s*#\\s*include\\s+\"([^\"]+)\"");
  std::vector<std::string> headers = {"vpdDB.h"};
  for (std::size_t i = 0; i < headers.size(); ++i) {
    std::ifstream in(path("include/vpdDB/" + headers[i]));
    ASSERT_TRUE(in) << headers[i] << " is not installed";
    std::string line;
    std::smatch m;
    while (std::getline(in, line)) {
      if (!std::regex_search(line, m, include_line)) continue;
      std::string name = m[1];
      EXPECT_TRUE(fileExists(path("include/vpdDB/" + name)))
          << headers[i] << " includes \"" << name << "\", which is not installed";
      if (std::find(headers.begin(), headers.end(), name) == headers.end() &&
          fileExists(path("include/vpdDB/" + name))) {
        headers.push_back(name);
      }
    }
  }
}

// The installed pages describe the installed programs: every option that a program's --help
// lists has its own entry in the page, and so does every exit status.
TEST_F(InstalledTree, ManPagesCoverEveryOptionAndStatus) {
  const std::regex option_line("^ +(-[a-z]|--[a-z]+)[ ,]");
  struct {
    const char* program;
    const char* page;
    int statuses;
  } const kPages[] = {{"bin/dorvex", "dorvex.1", 6}, {"bin/vpdload", "vpdload.1", 6}};
  for (const auto& p : kPages) {
    testsupport::RunResult help = run({path(p.program), "--help"});
    ASSERT_EQ(help.status, 0) << p.program;
    std::string page = testsupport::readFile(path(std::string("share/man/man1/") + p.page));
    int options = 0;
    for (const std::string& line : testsupport::lines(help.out)) {
      std::smatch m;
      if (!std::regex_search(line, m, option_line)) continue;
      ++options;
      EXPECT_TRUE(hasEntry(page, m[1])) << p.page << " has no entry for " << m[1] << " of --help";
    }
    EXPECT_GE(options, 2) << p.program << " --help lists no options:\n" << help.out;
    std::string statuses = page.substr(page.find("\n.SH EXIT STATUS\n"));
    for (int s = 0; s < p.statuses; ++s) {
      EXPECT_NE(statuses.find("\n.TP\n.B " + std::to_string(s) + "\n"), std::string::npos)
          << p.page << " does not explain exit status " << s;
    }
  }
}

// Another producer of the tables: a program built against the installed headers and
// libraries alone stores a record that the installed dorvex then reports.
const char kProducer[] = R"(#include "vpdDB.h"

int main(int argc, char** argv) {
  if (argc != 2) return 2;
  try {
    vpdDB db{std::string(argv[1])};
    chassisVPD chassis;
    chassis.setLocid(loc_id_t(7, 2, 0, CHASSIS, 0, 1));
    chassis.setSWmtms(mtms("7045-SW4", "02F0A72"));
    chassis.setSWfru(fru_stanza("4 GB Switch Board", "44P2573", "H81593", "44P2574",
                                "YL1034A99999", "28F7", "P1"));
    return db.putVPD(chassis.getLocid(), &chassis) == 0 ? 0 : 1;
  } catch (int) {
    return 3;
  }
}
)";

TEST_F(InstalledTree, BuildsAProducerAgainstTheInstalledTree) {
  testsupport::TempDir work;
  testsupport::writeFile(work / "producer.cc", kProducer);
  std::vector<std::string> compile = {CXX_BIN,
                                      "-std=c++17",
                                      "-o",
                                      work / "producer",
                                      "-I" + path("include/vpdDB"),
                                      work / "producer.cc"};
  std::string flags = PRODUCER_FLAGS;
  if (!flags.empty()) compile.push_back(flags);
  for (const char* arg : {"-lvpddb", "-lolvcommon", "-lchronicle"}) compile.push_back(arg);
  compile.insert(compile.end() - 3, {"-L" + path("lib"), "-Wl,-rpath," + path("lib")});
  testsupport::RunResult built = run(compile);
  ASSERT_EQ(built.status, 0) << built.out << built.err;

  const std::string root = work / "root";
  testsupport::makeDirs(root + "/data");
  auto env = rootEnv(root);
  testsupport::RunResult stored = run({work / "producer", root + "/data"}, env);
  ASSERT_EQ(stored.status, 0) << stored.err;
  testsupport::RunResult answer =
      run({path("bin/dorvex"), "-y", "switch", "-f", "7", "-c", "2", "-r", "planar"}, env);
  EXPECT_EQ(answer.out, "7045-SW4*02F0A72 44P2573 YL1034A99999 28F7\n");
  EXPECT_EQ(answer.status, 0);
}

TEST_F(InstalledTree, AnswersTheExampleFromTheInstalledTree) {
  // The prefix is the install root: data/, etc/ and the installed bin/rackprobe.
  const std::string root = prefix_->path();
  ASSERT_EQ(installExample({path("bin/vpdload"), path("share/doc/dorvex/examples"), ""}, root), "");
  const std::string dorvex = path("bin/dorvex");

  testsupport::RunResult version = run({dorvex, "--version"});
  EXPECT_EQ(version.out, std::string("dorvex ") + PROJECT_VERSION_TEXT + "\n");
  EXPECT_EQ(version.status, 0);

  struct {
    std::vector<std::string> args;
    const char* golden;
  } const kQuestions[] = {
      {{"-y", "switch", "-f", "2", "-c", "3", "-r", "dca", "-h", "1"}, "part_switch_dca.out"},
      {{"-y", "cec", "-t", "0"}, "change_poll.out"},
      {{"-y", "netvpd", "-n", "2"}, "netvpd2.out"},
  };
  for (const auto& q : kQuestions) {
    std::vector<std::string> argv = {dorvex};
    argv.insert(argv.end(), q.args.begin(), q.args.end());
    // The loader's report shows where each library came from.
    auto env = rootEnv(root);
    env["LD_DEBUG"] = "libs";
    testsupport::RunResult r = run(argv, env);
    EXPECT_EQ(r.status, 0) << commandText(q.args);
    EXPECT_EQ(r.out, golden(q.golden)) << commandText(q.args);
    for (const char* lib : {"libchronicle.so", "libnodebridge.so", "librackpower.so"}) {
      EXPECT_NE(r.err.find("init: " + root + "/bin/../lib/" + lib), std::string::npos)
          << commandText(q.args) << ": " << lib << " not loaded from the installed tree";
    }
  }
}

}  // namespace
}  // namespace producttest
