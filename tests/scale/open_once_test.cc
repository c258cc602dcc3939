// A run opens each table once and answers from the generation it opened at its start, however
// many cable lines it writes.
#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <string>

#include "output_stream.h"
#include "process_flags.h"
#include "settings.h"
#include "table_io.h"
#include "test_support.h"
#include "vpdDB.h"

namespace {

constexpr int kChassis = 6;

// Chassis 1..6 in frames 1..2, every reported riser cabled on both jacks: jack 1 to the next
// chassis, jack 2 to an SMA adapter of a CEC.
void buildInstallation(const std::string& data) {
  vpdDB db(data);
  for (int i = 1; i <= kChassis; ++i) {
    chassisVPD c;
    c.loc_id = loc_id_t(1 + i % 2, i, 0, CHASSIS, 0, 1);
    c.sw_mtms = mtms("7045-SW4", ("SW" + std::to_string(i)).c_str());
    c.sw_fru = fru_stanza("Switch", "SWPN", "EC", "SWFN", "SN", "CC", "P1");
    for (int slot = 0; slot < 16; ++slot) {
      c.riser[slot].riser_fru = fru_stanza("Riser", "RPN", "EC", "RFN", "SN", "CC", "C");
      int next = i % kChassis + 1;
      c.riser[slot].nbr1 = loc_id_t(1 + next % 2, next, slot % 8, NSB, 0, 1);
      c.riser[slot].port1 = slot % 4;
      c.riser[slot].nbr2 = loc_id_t(10 + slot, 1, slot % 8, SMA, 0, 1);
      c.riser[slot].port2 = 0;
    }
    db.putVPD(c.loc_id, &c);
  }
  for (int slot = 0; slot < 16; ++slot) {
    smaVPD s;
    s.loc_id = loc_id_t(10 + slot, 1, 0, SMA, 0, 1);
    s.cec_mtms = mtms("7040-681", ("CEC" + std::to_string(slot)).c_str());
    db.putVPD(s.loc_id, &s);
  }
  for (int f = 1; f <= 2; ++f) {
    bpaVPD b;
    b.loc_id = loc_id_t(f, 255, 0, BPA, 0, 1);
    b.frame_mtms = mtms("9458-100", ("BPA" + std::to_string(f)).c_str());
    db.putVPD(b.loc_id, &b);
  }
}

class OpenOnceTest : public ::testing::Test {
 protected:
  void SetUp() override {
    testsupport::makeDirs(tmp_ / "data");
    testsupport::makeDirs(tmp_ / "bin");
    buildInstallation(tmp_ / "data");
    std::string dump;
    for (int i = 1; i <= kChassis; ++i) {
      dump += std::to_string(1 + i % 2) + " " + std::to_string(i) + " SW_CHIP 0 0 1\n";
    }
    testsupport::writeFile(tmp_ / "etc.dump", dump);
    testsupport::writeFile(tmp_ / "bin/rackprobe", "#!/bin/sh\ncat '" + (tmp_ / "etc.dump") + "'\n",
                           0755);
    setenv("OLV_ROOT", tmp_.path().c_str(), 1);
    setenv("CHRONICLE_LOG", (tmp_ / "trace.log").c_str(), 1);
    out_ = std::tmpfile();
    dorvex::setOutStream(out_);
    dorvex::resetSettings();
  }
  void TearDown() override {
    dorvex::setOutStream(nullptr);
    std::fclose(out_);
    unsetenv("OLV_ROOT");
    unsetenv("CHRONICLE_LOG");
    dorvex::resetSettings();
  }
  std::string output() {
    std::fflush(out_);
    std::rewind(out_);
    std::string text;
    char buf[4096];
    size_t n;
    while ((n = std::fread(buf, 1, sizeof buf, out_)) > 0) text.append(buf, n);
    return text;
  }
  static int count(const std::string& text, const std::string& what) {
    int n = 0;
    for (size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + 1)) ++n;
    return n;
  }

  testsupport::TempDir tmp_;
  FILE* out_ = nullptr;
};

TEST_F(OpenOnceTest, NetworkVpdOpensEachTableOnce) {
  dorvex::type = dorvex::kTypeNetvpd;
  dorvex::network = 1;
  unsigned long before = vpd::tableOpenCount();
  dorvex::processFlags();
  EXPECT_EQ(vpd::tableOpenCount() - before, 3u);
  EXPECT_EQ(dorvex::prc, 0);
  std::string text = output();
  // 6 chassis x 15 reported risers x 2 jacks, each jack's far end looked up.
  EXPECT_EQ(count(text, "*CB "), kChassis * 15 * 2);
  EXPECT_EQ(count(text, "-P1-H"), kChassis * 15);
  EXPECT_EQ(count(text, "\"U7040-681CEC3-P1-H4Q4\""), kChassis) << "SMA far end found";
  EXPECT_EQ(count(text, "*DS 4 GB Switch"), kChassis);
  EXPECT_EQ(count(text, "*YK BPA"), 2);
}

TEST_F(OpenOnceTest, RunAnswersFromTheGenerationItOpened) {
  vpdDB reader(tmp_ / "data", 1);
  // A producer replaces every table while the reader is open.
  std::string fresh = tmp_ / "fresh";
  testsupport::makeDirs(fresh);
  {
    vpdDB producer(fresh);
    chassisVPD c;
    c.loc_id = loc_id_t(1, 1, 0, CHASSIS, 0, 1);
    c.sw_mtms = mtms("NEW-GEN", "1");
    producer.putVPD(c.loc_id, &c);
  }
  for (const char* t : {"chassis_vpd.db", "bpa_vpd.db", "sma_vpd.db"}) {
    ASSERT_EQ(std::rename((fresh + "/" + t).c_str(), (tmp_ / "data/" + t).c_str()), 0);
  }
  chassisVPD got;
  ASSERT_EQ(reader.getSwitchvpd(2, 1, got), 0) << "the old generation still answers";
  EXPECT_EQ(got.sw_mtms.getSE(), "SW1");
  std::list<chassisVPD> all;
  reader.getSwitchvpd(1u, all);
  EXPECT_EQ(all.size(), 3u);
}

}  // namespace
