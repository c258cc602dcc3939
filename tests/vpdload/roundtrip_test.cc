// Import, export, import again: the tables that come back are the ones that went in, byte
// for byte, and they are the records an inventory describes.
#include <gtest/gtest.h>

#include <cstring>
#include <functional>
#include <string>
#include <vector>

#include "test_support.h"
#include "vpd_records.h"
#include "vpd_types.h"
#include "vpdload_test_util.h"

namespace {

using testsupport::TempDir;
using vpdloadtest::importText;
using vpdloadtest::sameFiles;
using vpdloadtest::tables;
using vpdloadtest::vpdload;

// The table bytes that an inventory must produce, built with the record setters.
struct Expected {
  std::vector<smaVPD> sma;
  std::vector<chassisVPD> chassis;
  std::vector<bpaVPD> bpa;

  template <typename R>
  static std::string bytes(const std::vector<R>& records) {
    std::string out;
    for (const R& r : records) out.append(reinterpret_cast<const char*>(&r), sizeof r);
    return out;
  }
  std::map<std::string, std::string> tables() const {
    return {
        {"sma_vpd.db", bytes(sma)}, {"chassis_vpd.db", bytes(chassis)}, {"bpa_vpd.db", bytes(bpa)}};
  }
};

const char kDs[] = "DS3456789012345678901234567890";  // 30
const char kTs[] = "2024-05-06 07:08:09.123456 Z";    // 28, no room for a NUL

fru_stanza fullFru() {
  return fru_stanza(kDs, "PN3456789012", "EC3456789012", "FN3456789012", "SN3456789012", "CC34",
                    "YL3456789012345");
}

const std::string kFullFru =
    R"({"ds": "DS3456789012345678901234567890", "pn": "PN3456789012", "ec": "EC3456789012",
        "fn": "FN3456789012", "sn": "SN3456789012", "cc": "CC34", "yl": "YL3456789012345"})";
const std::string kFullMtms = R"({"tm": "TM345678", "se": "SE34567"})";

std::string loc(const std::string& type, int chip = 15) {
  return R"({"frame": 4095, "cage": 255, "chip": )" + std::to_string(chip) + R"(, "type": )" +
         type + R"(, "plane": 1, "network": 7})";
}

struct RoundTripCase {
  const char* name;
  std::string json;
  std::function<void(Expected*)> expect;
};

std::vector<RoundTripCase> roundTripCases() {
  std::vector<RoundTripCase> cases;
  cases.push_back({"empty inventory", "{}", [](Expected*) {}});
  cases.push_back(
      {"every field at full width and every number at its limit",
       R"({"sma": [{"loc": )" + loc("\"SMA\"") + R"(, "fru": )" + kFullFru + R"(, "cec": )" +
           kFullMtms + R"(, "neighbor": )" + loc("\"CHASSIS\"", 0) + R"(, "timestamp": ")" + kTs +
           R"("}],
          "chassis": [{"loc": )" +
           loc("\"CHASSIS\"", 0) + R"(, "mtms": )" + kFullMtms + R"(, "fru": )" + kFullFru +
           R"(, "dca1": )" + kFullFru + R"(, "dca2": )" + kFullFru +
           R"(, "risers": [
              {"slot": 15, "fru": )" +
           kFullFru + R"(, "nbr1": )" + loc("\"RISER\"") + R"(, "port1": -1, "nbr2": )" + loc("0") +
           R"(, "port2": 1},
              {"slot": 0, "fru": )" +
           kFullFru + R"(, "nbr1": )" + loc("\"SMA\"") + R"(, "port1": 2147483647, "nbr2": )" +
           loc("15", 1) + R"(, "port2": -2147483648}],
            "timestamp": ")" +
           kTs + R"("}],
          "bpa": [{"loc": )" +
           loc("\"BPA\"", 0) + R"(, "timestamp": ")" + kTs + R"(", "mtms": )" + kFullMtms +
           R"(, "bpc1": )" + kFullFru + R"(, "bpc2": )" + kFullFru + R"(, "bpr1": [)" + kFullFru +
           "," + kFullFru + "," + kFullFru + R"(], "bpd1": [)" + kFullFru + "," + kFullFru + "," +
           kFullFru + R"(], "bpr2": [)" + kFullFru + "," + kFullFru + "," + kFullFru +
           R"(], "bpd2": [)" + kFullFru + "," + kFullFru + "," + kFullFru + "]}]}",
       [](Expected* e) {
         mtms m("TM345678", "SE34567");
         smaVPD s;
         s.setLocid(loc_id_t(4095, 255, 15, SMA, 1, 7));
         s.setSmafru(fullFru());
         s.setCECmtms(m);
         s.setNeighborid(loc_id_t(4095, 255, 0, CHASSIS, 1, 7));
         s.setTimestamp(kTs);
         e->sma.push_back(s);
         chassisVPD c;
         c.setLocid(loc_id_t(4095, 255, 0, CHASSIS, 1, 7));
         c.setSWmtms(m);
         c.setSWfru(fullFru());
         c.setDca1(fullFru());
         c.setDca2(fullFru());
         c.setRiser(fullFru(), 0);
         c.setNeighbor1(loc_id_t(4095, 255, 15, SMA, 1, 7), 0);
         c.setPort1(2147483647, 0);
         c.setNeighbor2(loc_id_t(4095, 255, 1, 15, 1, 7), 0);
         c.setPort2(-2147483647 - 1, 0);
         c.setRiser(fullFru(), 15);
         c.setNeighbor1(loc_id_t(4095, 255, 15, RISER, 1, 7), 15);
         c.setPort1(-1, 15);
         c.setNeighbor2(loc_id_t(4095, 255, 15, NSB, 1, 7), 15);
         c.setPort2(1, 15);
         c.setTimestamp(kTs);
         e->chassis.push_back(c);
         bpaVPD b;
         b.setLocid(loc_id_t(4095, 255, 0, BPA, 1, 7));
         b.setTimestamp(kTs);
         b.setMtms(m);
         b.setBpc1(fullFru());
         b.setBpc2(fullFru());
         for (int i = 0; i < 3; ++i) {
           b.setBpr1(fullFru(), i);
           b.setBpd1(fullFru(), i);
           b.setBpr2(fullFru(), i);
           b.setBpd2(fullFru(), i);
         }
         e->bpa.push_back(b);
       }});
  cases.push_back({"texts that are not UTF-8, and UTF-8 counted in bytes",
                   R"({"sma": [{"loc": {"frame": 1, "cage": 2, "chip": 3},
                    "fru": {"ds": {"hex": "ff"}, "pn": {"hex": "C3"}, "ec": {"hex": "eda080"},
                            "fn": {"hex": "c0af"}, "sn": "\u00e9t\u00e9", "cc": {"hex": "f4908080"},
                            "yl": {"hex": "01027f80"}},
                    "cec": {"tm": "\u20ac1234", "se": {"hex": "e282"}},
                    "timestamp": {"hex": "323032340aff"}}]})",
                   [](Expected* e) {
                     smaVPD s;
                     s.setLocid(loc_id_t(1, 2, 3, SMA, 0, 0));
                     fru_stanza f("\xff", "\xc3", "\xed\xa0\x80", "\xc0\xaf", "\xc3\xa9t\xc3\xa9",
                                  "\xf4\x90\x80\x80", "\x01\x02\x7f\x80");
                     s.setSmafru(f);
                     s.setCECmtms(
                         mtms("\xe2\x82\xac"
                              "1234",
                              "\xe2\x82"));
                     s.setTimestamp("2024\n\xff");
                     e->sma.push_back(s);
                   }});
  cases.push_back(
      {"table order kept, absent members empty, types left out or by number",
       R"({"bpa": [{"loc": {"frame": 2, "cage": 255}}, {"loc": {"frame": 1, "cage": 255},
                    "bpr2": [{}, {"pn": "R2"}]}],
           "chassis": [{"loc": {"frame": 9, "cage": 1, "type": 5}, "risers": [{"slot": 4}]}],
           "sma": [{"loc": {"frame": 3, "chip": 1, "type": "sma"}, "neighbor": {"type": 9}},
                   {"loc": {"frame": 3, "chip": 0}}]})",
       [](Expected* e) {
         bpaVPD b2, b1;
         b2.setLocid(loc_id_t(2, 255, 0, BPA, 0, 0));
         b1.setLocid(loc_id_t(1, 255, 0, BPA, 0, 0));
         b1.setBpr2(fru_stanza("", "R2", "", "", "", "", ""), 1);
         e->bpa = {b2, b1};
         chassisVPD c;
         c.setLocid(loc_id_t(9, 1, 0, CHASSIS, 0, 0));
         e->chassis = {c};
         smaVPD s1, s0;
         s1.setLocid(loc_id_t(3, 0, 1, SMA, 0, 0));
         s1.setNeighborid(loc_id_t(0, 0, 0, 9, 0, 0));
         s0.setLocid(loc_id_t(3, 0, 0, SMA, 0, 0));
         e->sma = {s1, s0};
       }});
  return cases;
}

TEST(VpdloadRoundTrip, ImportBuildsTheRecordsAndExportRebuildsThemByteForByte) {
  for (const RoundTripCase& c : roundTripCases()) {
    SCOPED_TRACE(c.name);
    TempDir tmp;
    auto first = importText(tmp / "first", c.json, tmp / "in.json");
    ASSERT_EQ(first.status, 0) << first.err;

    Expected e;
    c.expect(&e);
    for (const auto& t : e.tables()) {
      EXPECT_TRUE(testsupport::fileExists(tmp / "first/" + t.first)) << t.first;
    }
    EXPECT_TRUE(sameFiles(tables(tmp / "first"), e.tables()));

    auto exported = vpdload({"export", "--data", tmp / "first"});
    ASSERT_EQ(exported.status, 0) << exported.err;
    EXPECT_EQ(exported.err, "");
    auto second = importText(tmp / "second", exported.out, tmp / "exported.json");
    ASSERT_EQ(second.status, 0) << second.err;
    EXPECT_TRUE(sameFiles(tables(tmp / "second"), tables(tmp / "first")));

    auto again = vpdload({"export", "-", "--data", tmp / "second"});
    EXPECT_EQ(again.out, exported.out) << "export is not stable";
  }
}

// What an export looks like: the schema that import reads, empty members left out.
TEST(VpdloadRoundTrip, ExportWritesTheInventoryForm) {
  struct Case {
    const char* name;
    const char* input;
    const char* output;
  } cases[] = {
      {"empty tables", "{}", "{\n  \"sma\": [],\n  \"chassis\": [],\n  \"bpa\": []\n}\n"},
      {"bytes that are not UTF-8 in hex, UTF-8 given in hex as a string",
       R"({"sma": [{"loc": {"frame": 1}, "fru": {"pn": {"hex": "41ff"}, "sn": {"hex": "c3a9"}},
                    "neighbor": {"cage": 2, "type": 12}}]})",
       R"({
  "sma": [
    {
      "loc": {"frame": 1, "cage": 0, "chip": 0, "type": "SMA", "plane": 0, "network": 0},
      "fru": {"pn": {"hex": "41ff"}, "sn": "é"},
      "neighbor": {"frame": 0, "cage": 2, "chip": 0, "type": 12, "plane": 0, "network": 0}
    }
  ],
  "chassis": [],
  "bpa": []
}
)"},
      {"risers in slot order, empty ones and zero ports left out",
       R"({"chassis": [{"loc": {"frame": 1, "cage": 2}, "risers": [
            {"slot": 9, "port2": 3}, {"slot": 1, "fru": {"cc": "ab"}}, {"slot": 5},
            {"slot": 7, "fru": {}, "port1": 0}]}]})",
       R"({
  "sma": [],
  "chassis": [
    {
      "loc": {"frame": 1, "cage": 2, "chip": 0, "type": "CHASSIS", "plane": 0, "network": 0},
      "risers": [
        {
          "slot": 1,
          "fru": {"cc": "ab"}
        },
        {"slot": 9, "port2": 3}
      ]
    }
  ],
  "bpa": []
}
)"},
      {"texts escaped as JSON strings",
       R"({"sma": [{"loc": {"frame": 1}, "fru": {"ds": "a\"b\\c\u0001\t\n\u001f\u007f/"}}]})",
       R"({
  "sma": [
    {
      "loc": {"frame": 1, "cage": 0, "chip": 0, "type": "SMA", "plane": 0, "network": 0},
      "fru": {"ds": "a\"b\\c\u0001\t\n\u001f)"
       "\x7f"
       R"(/"}
    }
  ],
  "chassis": [],
  "bpa": []
}
)"},
      {"trailing empty BPA units left out, inner ones kept",
       R"({"bpa": [{"loc": {"frame": 1, "cage": 255}, "bpd1": [{}, {"sn": "x"}, {}],
                    "bpr2": [{}, {}], "timestamp": "now"}]})",
       R"({
  "sma": [],
  "chassis": [],
  "bpa": [
    {
      "loc": {"frame": 1, "cage": 255, "chip": 0, "type": "BPA", "plane": 0, "network": 0},
      "timestamp": "now",
      "bpd1": [
        {},
        {"sn": "x"}
      ]
    }
  ]
}
)"},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    TempDir tmp;
    auto imported = importText(tmp / "data", c.input, tmp / "in.json");
    ASSERT_EQ(imported.status, 0) << imported.err;
    auto exported = vpdload({"export", "--data", tmp / "data"});
    EXPECT_EQ(exported.status, 0);
    EXPECT_EQ(exported.out, c.output);
  }
}

}  // namespace
