// The installation generator: same parameters give the same bytes, and what it writes is an
// installation the database and dorvex read back as laid out (every cable's far end exists,
// every switch chassis reaches dorvex's chip list).
#include <gtest/gtest.h>
#include <unistd.h>

#include <list>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "installation_layout.h"
#include "installation_records.h"
#include "installation_writer.h"
#include "test_support.h"
#include "vpdDB.h"

namespace {

using testsupport::readFile;
using testsupport::run;
using testsupport::TempDir;

const char* const kFiles[] = {"data/chassis_vpd.db", "data/bpa_vpd.db", "data/sma_vpd.db",
                              "etc/rackprobe.dump", "etc/hwserver.json"};

gen::Params custom(unsigned int switches, unsigned int networks, unsigned int cecs,
                   unsigned int sma, unsigned int frames, unsigned int consoles) {
  gen::Params p;
  p.switches_per_network = switches;
  p.networks = networks;
  p.cecs = cecs;
  p.sma_per_cec = sma;
  p.frames = frames;
  p.consoles = consoles;
  return p;
}

struct Shape {
  const char* name;
  gen::Params params;
};

const Shape kShapes[] = {
    {"scale 1", gen::Params::scaled(1)},
    {"three networks, odd counts", custom(5, 3, 7, 3, 2, 1)},
    {"one switch, no CECs, no consoles", custom(1, 1, 0, 8, 1, 0)},
    {"16 SMA chips per CEC", custom(4, 2, 9, 16, 3, 3)},
};

std::string write(const std::string& root, const gen::Params& p) {
  return gen::writeInstallation(root, gen::Layout(p), nullptr);
}

TEST(GenInstallation, SameParametersSameBytesOtherSeedOtherTables) {
  for (const Shape& shape : kShapes) {
    TempDir a, b, c;
    ASSERT_EQ(write(a.path(), shape.params), "") << shape.name;
    ASSERT_EQ(write(b.path(), shape.params), "") << shape.name;
    gen::Params reseeded = shape.params;
    reseeded.seed += 1;
    ASSERT_EQ(write(c.path(), reseeded), "") << shape.name;
    for (const char* file : kFiles) {
      EXPECT_EQ(readFile(a / file), readFile(b / file)) << shape.name << ": " << file;
    }
    EXPECT_NE(readFile(a / "data/chassis_vpd.db"), readFile(c / "data/chassis_vpd.db"))
        << shape.name;
  }
}

TEST(GenInstallation, TablesHoldEveryRecordWhereTheLayoutPutsIt) {
  for (const Shape& shape : kShapes) {
    TempDir root;
    gen::Layout layout(shape.params);
    gen::Written w;
    ASSERT_EQ(gen::writeInstallation(root.path(), layout, &w), "") << shape.name;
    const gen::Params& p = shape.params;
    EXPECT_EQ(w.chassis_records, layout.switchCount()) << shape.name;
    EXPECT_EQ(w.bpa_records, p.frames) << shape.name;
    EXPECT_EQ(w.sma_records, uint64_t{p.cecs} * p.sma_per_cec) << shape.name;
    EXPECT_EQ(testsupport::fileSize(root / "data/chassis_vpd.db"),
              static_cast<long>(w.chassis_records * chassisVPD::kRecordSize))
        << shape.name;
    EXPECT_EQ(testsupport::fileSize(root / "data/sma_vpd.db"),
              static_cast<long>(w.sma_records * smaVPD::kRecordSize))
        << shape.name;

    vpdDB db(root / "data", 1);
    for (unsigned int s = 0; s < layout.switchCount(); ++s) {
      chassisVPD r;
      gen::Position at = layout.switchAt(s);
      ASSERT_EQ(db.getSwitchvpd(at.frame, at.cage, r), 0) << shape.name << ": switch " << s;
      EXPECT_TRUE(r.sw_mtms == layout.switchMtms(s)) << shape.name << ": switch " << s;
      EXPECT_EQ(r.loc_id.getNetwork(), layout.networkOf(s)) << shape.name;
      for (int i = 0; i < chassisVPD::kRiserSlots; ++i) {
        EXPECT_FALSE(r.riser[i].riser_fru.getPN().empty()) << shape.name << ": riser " << i;
        for (loc_id_t far : {r.riser[i].nbr1, r.riser[i].nbr2}) {
          if (far.getType() == SMA) {
            // dorvex names the far CEC by any SMA record of its first adapter.
            std::list<smaVPD> found;
            EXPECT_LT(far.getChip(), p.sma_per_cec) << shape.name;
            EXPECT_EQ(db.getSMAvpd(far.getFrame(), far.getCage(), 1, found), 0)
                << shape.name << ": switch " << s << " riser " << i;
          } else {
            chassisVPD neighbour;
            EXPECT_TRUE(far.getType() == NSB || far.getType() == ISB) << shape.name;
            EXPECT_LT(far.getChip(), 8u) << shape.name;
            EXPECT_EQ(db.getSwitchvpd(far.getFrame(), far.getCage(), neighbour), 0)
                << shape.name << ": switch " << s << " riser " << i;
            EXPECT_EQ(neighbour.loc_id.getNetwork(), r.loc_id.getNetwork()) << shape.name;
          }
        }
      }
    }
    for (unsigned int f = 1; f <= p.frames; ++f) {
      bpaVPD r;
      ASSERT_EQ(db.getBPAvpd(f, gen::kBpaCage, r), 0) << shape.name << ": frame " << f;
      EXPECT_TRUE(r.frame_mtms == layout.bpaMtms(f)) << shape.name;
      EXPECT_FALSE(r.bpd2_fru[2].getPN().empty()) << shape.name;
    }
    std::list<loc_id_t> cecs;
    std::list<mtms> cec_mtms;
    db.getCECmtms(cecs, cec_mtms);
    EXPECT_EQ(cecs.size(), p.sma_per_cec > 0 ? p.cecs : 0u) << shape.name;
  }
}

// Every switch chassis must reach dorvex's chip list (at most 2048 lines per network,
// repeats included), and every BPA must be reachable through some console.
TEST(GenInstallation, DumpListsEverySwitchWithinTheChipListAndConsolesReachEveryBpa) {
  const Shape shapes[] = {
      {"two lines per chassis", custom(1024, 1, 4, 8, 256, 2)},
      {"one line per chassis", custom(2048, 1, 4, 8, 512, 2)},
      {"two networks", custom(600, 2, 0, 8, 100, 5)},
  };
  for (const Shape& shape : shapes) {
    ASSERT_EQ(gen::checkParams(shape.params), "") << shape.name;
    gen::Layout layout(shape.params);
    std::istringstream dump(gen::rackprobeDump(layout));
    std::vector<unsigned int> lines_of_network(8);
    std::set<std::pair<unsigned int, unsigned int>> positions;
    std::string line;
    while (std::getline(dump, line)) {
      std::istringstream fields(line);
      unsigned int frame, cage, chip, plane, network;
      std::string type;
      ASSERT_TRUE(fields >> frame >> cage >> type >> chip >> plane >> network) << line;
      if (type != "SW_CHIP") continue;
      ++lines_of_network[network];
      positions.insert({frame, cage});
    }
    for (unsigned int n = 1; n <= shape.params.networks; ++n)
      EXPECT_LE(lines_of_network[n], gen::kChipListEntries) << shape.name << ": network " << n;
    EXPECT_EQ(positions.size(), layout.switchCount()) << shape.name;

    std::string json = gen::hwserverJson(layout);
    for (unsigned int f = 1; f <= shape.params.frames; ++f) {
      EXPECT_NE(json.find("\"vport\": " + std::to_string(f) + ","), std::string::npos)
          << shape.name << ": frame " << f;
    }
  }
}

TEST(GenInstallation, RefusesShapesThatDoNotFit) {
  struct Case {
    const char* name;
    gen::Params params;
    const char* says;
  } cases[] = {
      {"no network", custom(4, 0, 4, 8, 1, 1), "networks"},
      {"eight networks", custom(4, 8, 4, 8, 1, 1), "networks"},
      {"no frame", custom(4, 1, 4, 8, 0, 1), "frames"},
      {"frame 4096", custom(4, 1, 4, 8, 4096, 1), "frames"},
      {"17 SMA chips", custom(4, 1, 4, 17, 1, 1), "SMA"},
      {"2049 switches on a network", custom(2049, 1, 0, 8, 100, 1), "chip list"},
      {"255 cages", custom(200, 1, 55, 8, 1, 1), "cages"},
  };
  for (const Case& c : cases) {
    EXPECT_NE(gen::checkParams(c.params).find(c.says), std::string::npos) << c.name;
  }
  EXPECT_EQ(gen::checkParams(custom(200, 1, 54, 8, 1, 1)), "") << "254 cages fit";
  EXPECT_EQ(gen::checkParams(gen::Params::scaled(64)), "");
}

TEST(GenInstallation, CommandLine) {
  struct Case {
    const char* name;
    std::vector<std::string> args;
    int status;
    const char* err;
  } cases[] = {
      {"no root", {"--scale", "2"}, 2, "no ROOT"},
      {"unknown option", {"--racks", "2", "r"}, 2, "unknown option --racks"},
      {"not a number", {"--cecs", "12x", "r"}, 2, "'12x' is not a whole number"},
      {"negative", {"--cecs=-1", "r"}, 2, "'-1' is not a whole number"},
      {"missing value", {"r", "--seed"}, 2, "--seed needs a number"},
      {"scale too large", {"--scale", "129", "r"}, 2, "--scale must be 1 to 128"},
      {"shape that does not fit", {"--networks", "9", "r"}, 2, "networks must be 1 to 7"},
  };
  for (const Case& c : cases) {
    std::vector<std::string> argv{GEN_INSTALLATION_BIN};
    argv.insert(argv.end(), c.args.begin(), c.args.end());
    testsupport::RunResult r = run(argv);
    EXPECT_EQ(r.status, c.status) << c.name;
    EXPECT_NE(r.err.find(c.err), std::string::npos) << c.name << ": " << r.err;
    EXPECT_EQ(r.out, "") << c.name;
  }
}

// The program and the library write the same installation, and dorvex answers a network
// VPD request on it with one stanza per switch chassis and per frame.
TEST(GenInstallation, DorvexReadsTheWholeNetwork) {
  TempDir root, library_root;
  testsupport::RunResult r =
      run({GEN_INSTALLATION_BIN, "--scale", "1", "--networks=2", "--seed", "7", root.path()});
  ASSERT_EQ(r.status, 0) << r.err;
  EXPECT_NE(r.out.find("32 chassis, 4 BPA and 512 SMA records"), std::string::npos) << r.out;

  gen::Params p = gen::Params::scaled(1);
  p.networks = 2;
  p.seed = 7;
  ASSERT_EQ(write(library_root.path(), p), "");
  for (const char* file : kFiles)
    EXPECT_EQ(readFile(root / file), readFile(library_root / file)) << file;

  testsupport::makeDirs(root / "bin");
  ASSERT_EQ(::symlink(RACKPROBE_BIN, (root / "bin/rackprobe").c_str()), 0);
  TempDir log;
  r = run({DORVEX_BIN, "-y", "netvpd", "-n", "2"},
          {{"OLV_ROOT", root.path()}, {"CHRONICLE_LOG", log / "trace"}});
  ASSERT_EQ(r.status, 0) << r.err;
  std::size_t switch_stanzas = 0, bpa_stanzas = 0, cables = 0, console_lines = 0;
  for (const std::string& line : testsupport::lines(r.out)) {
    switch_stanzas += line == "*DS 4 GB Switch";
    bpa_stanzas += line == "*YK BPA";
    cables += line.rfind("*CB ", 0) == 0;
    console_lines += line.rfind("*V1 ", 0) == 0;
  }
  EXPECT_EQ(switch_stanzas, 16u);
  EXPECT_EQ(bpa_stanzas, 4u);
  EXPECT_EQ(cables, 16u * 15 * 2);  // risers 1-15 reported, both jacks cabled
  EXPECT_EQ(console_lines, 16u * 2);
  EXPECT_FALSE(testsupport::fileExists(log / "trace")) << "every far end was found";
}

}  // namespace
