// End-to-end: the statuses of a database that cannot be opened (3), a dump tool that cannot
// be started (4) and a console discovery that fails (5); traces go to CHRONICLE_LOG.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <cstdio>

#include "installation.h"

namespace dorvextest {
namespace {

const char kChipLines[] = "2 3 SW_CHIP 0 1 1\n";
const char kSwALine[] = "2 3 7045-SW4*0C0FFEE\n";

TEST(Failure, MissingTableEndsWithStatus3AndATrace) {
  const char* tables[] = {"chassis_vpd.db", "bpa_vpd.db", "sma_vpd.db"};
  const char* messages[] = {"Failed to open the chassisTbl", "Failed to open the bpaTbl",
                            "Failed to open the smaTbl"};
  for (int t = 0; t < 3; ++t) {
    Installation inst;
    fillStandard(inst);
    inst.setDump(kChipLines);
    inst.writeTables();
    ASSERT_EQ(std::remove(inst.path(std::string("data/") + tables[t]).c_str()), 0);
    expectRuns(inst, {
                         {tables[t], {"-y", "switch", "-f", "2", "-c", "3"}, "", 3},
                         {tables[t], {"-y", "netvpd", "-n", "1"}, "", 3},
                         {tables[t], {"-y", "all"}, "", 3},
                     });
    // What was written before the end still arrives.
    testsupport::RunResult r = inst.run({"-x", "-y", "all"});
    EXPECT_EQ(r.out, "0\n") << tables[t];
    EXPECT_EQ(r.status, 3) << tables[t];
    std::string trace = inst.traces();
    EXPECT_NE(trace.find("\t64\tZRV_VPD\tvpdDB\t0x00000000\t"), std::string::npos) << trace;
    EXPECT_NE(trace.find(messages[t]), std::string::npos) << trace;
  }
}

TEST(Failure, DumpToolThatCannotBeStartedEndsWithStatus4) {
  struct {
    const char* name;
    void (*spoil)(Installation&);
  } tools[] = {
      {"missing", [](Installation& i) { std::remove(i.path("bin/rackprobe").c_str()); }},
      {"not executable", [](Installation& i) { chmod(i.path("bin/rackprobe").c_str(), 0644); }},
      {"a folder",
       [](Installation& i) {
         std::remove(i.path("bin/rackprobe").c_str());
         testsupport::makeDirs(i.path("bin/rackprobe"));
       }},
      {"no interpreter",
       [](Installation& i) {
         testsupport::writeFile(i.path("bin/rackprobe"), "#!/no/such/shell\n", 0755);
       }},
  };
  for (const auto& tool : tools) {
    Installation inst;
    fillStandard(inst);
    inst.setDump(kChipLines);
    tool.spoil(inst);
    expectRuns(
        inst,
        {
            {tool.name, {"-y", "switch", "-n", "1"}, "", 4},
            {tool.name, {"-y", "bpa", "-n", "1"}, "", 4},
            {tool.name, {"-y", "netvpd", "-n", "1"}, "", 4},
            {tool.name, {"-y", "switch", "-f", "2", "-c", "3"}, kSwALine, 0},  // not needed here
        });
    testsupport::RunResult r = inst.run({"-x", "-y", "switch", "-n", "1"});
    EXPECT_EQ(r.out, "0\n") << tool.name;
    EXPECT_EQ(r.status, 4) << tool.name;
  }
}

TEST(Failure, DumpToolStatusIsNotExamined) {
  Installation inst;
  fillStandard(inst);
  testsupport::writeFile(inst.path("bin/rackprobe"),
                         "#!/bin/sh\necho '2 3 SW_CHIP 0 0 1'\nexit 3\n", 0755);
  expectRuns(inst, {{"failing tool", {"-y", "switch", "-n", "1"}, kSwALine, 0}});
}

TEST(Failure, ConsoleDiscoveryFailureEndsWithStatus5) {
  const char* configs[] = {
      "{",                                                                    // cannot be parsed
      "[1, 2]",                                                               // not an object
      R"({"consoles": [{"ip": "10.0.0.5", "tm": "123456789", "se": "1"}]})",  // tm too long
      R"({"consoles": [{"ip": "10.0.0", "tm": "1", "se": "1"}]})",            // no dotted quad
  };
  for (const char* config : configs) {
    Installation inst;
    fillStandard(inst);
    inst.setDump(kChipLines);
    inst.setHwserver(config);
    expectRuns(inst, {
                         {config, {"-y", "netvpd", "-n", "1"}, "", 5},
                         {config, {"-y", "switch", "-n", "1"}, kSwALine, 0},  // no discovery for it
                     });
    std::remove(inst.path("bin/rackprobe").c_str());
    expectRuns(inst, {{config, {"-y", "netvpd", "-n", "1"}, "", 5}});  // discovery comes first
  }
}

TEST(Failure, LookupsTraceToTheLogOnly) {
  Installation inst;
  fillStandard(inst);
  expectRuns(inst, {{"missing switch", {"-y", "switch", "-f", "9", "-c", "9"}, "", 1}});
  std::string trace = inst.traces();
  EXPECT_NE(trace.find("\t1\tZRV_VPD\tgetSwitchvpd\t0x00000000\t"), std::string::npos) << trace;
  EXPECT_NE(trace.find("The specified frame 9, cage 9 is not find in the chassisTable\n"),
            std::string::npos)
      << trace;
}

}  // namespace
}  // namespace dorvextest
