// Every request form asked of the bundled example installation, answered byte for byte as
// the files under golden/ show and with the documented exit status.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "example_root.h"
#include "test_support.h"

namespace producttest {
namespace {

struct TourCase {
  const char* name;
  std::vector<std::string> args;
  int status;
  const char* golden;  // expected standard output; nullptr: nothing
  const char* trace;   // a text the trace log must hold; nullptr: not checked
};

const TourCase kTour[] = {
    // Part requests: frame, cage, FRU kind and part number.
    {"switch DCA 1",
     {"-y", "switch", "-f", "2", "-c", "3", "-r", "dca", "-h", "1"},
     0,
     "part_switch_dca.out",
     nullptr},
    {"switch DCA 3 chooses none",
     {"-y", "switch", "-f", "2", "-c", "3", "-r", "dca", "-h", "3"},
     0,
     nullptr,
     nullptr},
    {"riser in the last slot",
     {"-y", "switch", "-f", "1", "-c", "3", "-r", "riser", "-h", "15"},
     0,
     "part_switch_riser15.out",
     nullptr},
    {"riser slot beyond the chassis",
     {"-y", "switch", "-f", "1", "-c", "3", "-r", "riser", "-h", "16"},
     2,
     nullptr,
     nullptr},
    {"switches of a CEC's adapter 1",
     {"-y", "switch", "-f", "1", "-c", "5", "-r", "adapter", "-h", "1"},
     0,
     "part_switch_adapter1.out",
     nullptr},
    {"switches of a CEC's adapter 2",
     {"-y", "switch", "-f", "2", "-c", "6", "-r", "adapter", "-h", "2"},
     0,
     "part_switch_adapter2.out",
     nullptr},
    {"CEC adapter 2",
     {"-y", "cec", "-f", "1", "-c", "5", "-r", "adapter", "-h", "2"},
     0,
     "part_cec_adapter2.out",
     nullptr},
    {"adapter of a cage without CEC",
     {"-y", "cec", "-f", "1", "-c", "9", "-r", "adapter", "-h", "1"},
     1,
     nullptr,
     "The specified frame 1, cage 9 is not in the smaTbl"},
    {"BPR 2 of side 1",
     {"-y", "bpa", "-f", "1", "-c", "255", "-r", "bpr", "-a", "1", "-h", "2"},
     0,
     "part_bpa_bpr.out",
     nullptr},
    {"BPD 0 of side 2",
     {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpd", "-a", "2", "-h", "0"},
     0,
     "part_bpa_bpd.out",
     nullptr},
    {"BPD index beyond the side",
     {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpd", "-a", "2", "-h", "3"},
     2,
     nullptr,
     nullptr},
    {"ibf is looked up, never written",
     {"-y", "bpa", "-f", "1", "-c", "255", "-r", "ibf", "-a", "1", "-h", "0"},
     0,
     nullptr,
     nullptr},
    // FRU requests: frame, cage and FRU kind.
    {"BPC of side 2",
     {"-y", "bpa", "-f", "1", "-c", "255", "-r", "bpc", "-a", "2"},
     0,
     "fru_bpa_bpc2.out",
     nullptr},
    {"BPC without a side", {"-y", "bpa", "-f", "1", "-c", "255", "-r", "bpc"}, 2, nullptr, nullptr},
    {"switch board",
     {"-y", "switch", "-f", "1", "-c", "4", "-r", "planar"},
     0,
     "fru_switch_planar.out",
     nullptr},
    {"switch board of an empty cage",
     {"-y", "switch", "-f", "3", "-c", "3", "-r", "planar"},
     1,
     nullptr,
     "The specified frame 3, cage 3 is not find in the chassisTable"},
    // Location requests: frame and cage.
    {"BPA by location", {"-y", "bpa", "-f", "2", "-c", "255"}, 0, "location_bpa.out", nullptr},
    {"switch by location",
     {"-y", "switch", "-f", "2", "-c", "4"},
     0,
     "location_switch.out",
     nullptr},
    {"CEC by location", {"-y", "cec", "-f", "2", "-c", "6"}, 0, "location_cec.out", nullptr},
    {"a location wins over the network",
     {"-y", "netvpd", "-n", "1", "-f", "2", "-c", "3"},
     2,
     nullptr,
     nullptr},
    // The change poll.
    {"change poll", {"-y", "cec", "-t", "0"}, 0, "change_poll.out", nullptr},
    {"change poll with a frame",
     {"-y", "cec", "-f", "1", "-t", "1710400000"},
     0,
     "change_poll.out",
     nullptr},
    {"change poll, nothing new",
     {"-y", "cec", "-t", "1710403200"},
     0,
     "change_poll_none.out",
     nullptr},
    // Frame requests.
    {"switches of frame 1", {"-y", "switch", "-f", "1"}, 0, "frame_switch.out", nullptr},
    {"frame request for a BPA", {"-y", "bpa", "-f", "1"}, 2, nullptr, nullptr},
    // MTMS requests.
    {"BPA by MTMS", {"-y", "bpa", "-m", "9458-100*02B7E20"}, 0, "mtms_bpa.out", nullptr},
    {"switch by MTMS", {"-y", "switch", "-m", "7045-SW4*02F0A14"}, 0, "mtms_switch.out", nullptr},
    {"unknown MTMS", {"-y", "switch", "-m", "7045-SW4*0000000"}, 1, nullptr, nullptr},
    // Network requests.
    {"switches of network 1", {"-y", "switch", "-n", "1"}, 0, "network_switch1.out", nullptr},
    {"switches of network 2", {"-y", "switch", "-n", "2"}, 0, "network_switch2.out", nullptr},
    {"BPAs of network 1", {"-y", "bpa", "-n", "1"}, 0, "network_bpa1.out", nullptr},
    {"a network without switches", {"-y", "switch", "-n", "5"}, 1, nullptr, nullptr},
    {"network VPD of network 1", {"-y", "netvpd", "-n", "1"}, 0, "netvpd1.out", nullptr},
    {"network VPD of network 2", {"-y", "netvpd", "-n", "2"}, 0, "netvpd2.out", nullptr},
    // The dump.
    {"dump", {"-y", "all"}, 0, "dump.out", nullptr},
};

TEST(ExampleTour, EveryRequestFormAnswersAsDocumented) {
  testsupport::TempDir root;
  ASSERT_EQ(installExample({VPDLOAD_BIN, EXAMPLES_DIR, RACKPROBE_BIN}, root.path()), "");
  const std::string log = root / "trace.log";
  for (const TourCase& c : kTour) {
    std::vector<std::string> argv = {DORVEX_BIN};
    argv.insert(argv.end(), c.args.begin(), c.args.end());
    testsupport::writeFile(log, "");
    testsupport::RunResult r = testsupport::run(argv, rootEnv(root.path()));
    std::string where = std::string(c.name) + ": " + commandText(c.args);
    EXPECT_EQ(r.status, c.status) << where;
    EXPECT_EQ(r.out, c.golden ? golden(c.golden) : "") << where;
    EXPECT_EQ(r.err, "") << where;
    if (c.trace) {
      EXPECT_NE(testsupport::readFile(log).find(c.trace), std::string::npos)
          << where << "\ntraces:\n"
          << testsupport::readFile(log);
    }
  }
}

// The poll hands its time to the next poll: an answer passed back says "NoChange" until the
// tables are loaded again.
TEST(ExampleTour, ChangePollFollowsAnImport) {
  testsupport::TempDir root;
  ASSERT_EQ(installExample({VPDLOAD_BIN, EXAMPLES_DIR, RACKPROBE_BIN}, root.path()), "");
  const std::string dorvex = DORVEX_BIN;
  auto env = rootEnv(root.path());
  testsupport::RunResult first = testsupport::run({dorvex, "-y", "cec", "-t", "0"}, env);
  ASSERT_EQ(first.status, 0);
  std::string stamp = testsupport::lines(first.out).at(0);
  EXPECT_EQ(stamp, std::to_string(kPollTime));

  testsupport::RunResult again = testsupport::run({dorvex, "-y", "cec", "-t", stamp}, env);
  EXPECT_EQ(again.out, "NoChange\n");
  EXPECT_EQ(again.status, 0);

  // A new generation of the tables is a change, whatever the clock said before.
  testsupport::RunResult load = testsupport::run(
      {VPDLOAD_BIN, "import", std::string(EXAMPLES_DIR) + "/installation.json"}, env);
  ASSERT_EQ(load.status, 0) << load.err;
  testsupport::RunResult after = testsupport::run({dorvex, "-y", "cec", "-t", stamp}, env);
  EXPECT_EQ(after.status, 0);
  std::vector<std::string> got = testsupport::lines(after.out);
  ASSERT_EQ(got.size(), 5u) << after.out;
  EXPECT_GT(std::stol(got[0]), kPollTime);
  EXPECT_EQ(after.out.substr(after.out.find('\n') + 1), first.out.substr(first.out.find('\n') + 1));
}

}  // namespace
}  // namespace producttest
