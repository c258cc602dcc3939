// An inventory with any bad value is refused as a whole: the message names the record and
// the field, the status is 1, and the live tables and their ".old" files stay as they were.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "test_support.h"
#include "vpdload_test_util.h"

namespace {

using testsupport::TempDir;
using vpdloadtest::importText;
using vpdloadtest::makeInventory;
using vpdloadtest::sameFiles;
using vpdloadtest::snapshot;

struct BadCase {
  const char* name;
  std::string json;
  std::vector<std::string> problems;  // every line before the summary, without prefixes
  std::size_t total = 0;              // when more were found than shown
};

std::string deep(int levels) { return std::string(levels, '[') + std::string(levels, ']'); }

std::string manyBadFrames(int n) {
  std::string j = "{\"sma\": [";
  for (int i = 0; i < n; ++i) j += std::string(i ? ", " : "") + "{\"loc\": {\"frame\": -1}}";
  return j + "]}";
}

std::vector<BadCase> badCases() {
  const std::string kChassisKeys = "expected one of loc, mtms, fru, dca1, dca2, risers, timestamp";
  std::vector<std::string> twenty(20, "");
  for (int i = 0; i < 20; ++i) {
    twenty[i] = "sma[" + std::to_string(i) + "].loc.frame: -1 is negative, at least 0";
  }
  return {
      // Texts longer than their field.
      {"text one character too long",
       R"({"chassis": [{"loc": {"cage": 0}}, {"loc": {"cage": 1}}, {"loc": {"cage": 2}},
                       {"loc": {"cage": 3}, "dca1": {"pn": "1234567890123"}}]})",
       {"chassis[3].dca1.pn: 13 characters, at most 12"}},
      {"UTF-8 text too long in bytes",
       R"({"sma": [{"cec": {"se": "\u00e9\u00e9\u00e9\u00e9"}}]})",
       {"sma[0].cec.se: 8 bytes, at most 7"}},
      {"hex text too long",
       R"({"bpa": [{"timestamp": {"hex": "3031323334353637383930313233343536373839303132333435363738"}}]})",
       {"bpa[0].timestamp: 29 bytes, at most 28"}},
      {"text with a NUL",
       R"({"sma": [{"fru": {"sn": "A\u0000B"}}]})",
       {"sma[0].fru.sn: contains a NUL character, which would end the text"}},
      {"hex with an odd number of digits",
       R"({"sma": [{"fru": {"pn": {"hex": "abc"}}}]})",
       {"sma[0].fru.pn.hex: an odd number of hex digits (3)"}},
      {"hex with a character that is no digit",
       R"({"sma": [{"fru": {"pn": {"hex": "0g"}}}]})",
       {"sma[0].fru.pn.hex: character 2 is not a hex digit"}},
      // Numbers that do not fit.
      {"frame beyond 12 bits",
       R"({"sma": [{"loc": {"frame": 4096}}]})",
       {"sma[0].loc.frame: 4096 does not fit 12 bits, at most 4095"}},
      {"plane beyond 1 bit",
       R"({"bpa": [{"loc": {"plane": 2}}]})",
       {"bpa[0].loc.plane: 2 does not fit 1 bit, at most 1"}},
      {"network of a neighbour beyond 3 bits",
       R"({"sma": [{"neighbor": {"network": 8}}]})",
       {"sma[0].neighbor.network: 8 does not fit 3 bits, at most 7"}},
      {"negative cage",
       R"({"chassis": [{"loc": {"cage": -1}}]})",
       {"chassis[0].loc.cage: -1 is negative, at least 0"}},
      {"number too long for any field",
       R"({"sma": [{"loc": {"chip": 100000000000000000000}}]})",
       {"sma[0].loc.chip: 1e+20 does not fit 4 bits, at most 15"}},
      {"fraction",
       R"({"sma": [{"loc": {"chip": 1.5}}]})",
       {"sma[0].loc.chip: expected an integer, not 1.5"}},
      {"port beyond 32 bits both ways",
       R"({"chassis": [{"risers": [{"slot": 1, "port1": 2147483648, "port2": -2147483649}]}]})",
       {"chassis[0].risers[0].port1: 2147483648 does not fit 32 bits, at most 2147483647",
        "chassis[0].risers[0].port2: -2147483649 does not fit 32 bits, at least -2147483648"}},
      // Device types.
      {"unknown type name",
       R"({"sma": [{"loc": {"type": "FOO"}}]})",
       {"sma[0].loc.type: unknown type \"FOO\" (names: NSB SMA ISB BPA DCA CHASSIS BOARD RISER, "
        "or a number 0 to 15)"}},
      {"type number beyond 4 bits",
       R"({"chassis": [{"risers": [{"slot": 0, "nbr2": {"type": 16}}]}]})",
       {"chassis[0].risers[0].nbr2.type: 16 does not fit 4 bits, at most 15"}},
      {"record of another table's type",
       R"({"sma": [{"loc": {"type": "CHASSIS"}}]})",
       {"sma[0].loc.type: CHASSIS, but records of this table are SMA"}},
      {"record of a type without a name",
       R"({"bpa": [{"loc": {"type": 9}}]})",
       {"bpa[0].loc.type: type 9, but records of this table are BPA"}},
      // Wrong JSON types.
      {"MTMS as a string",
       R"({"bpa": [{"loc": {"frame": 1}}, {"loc": {"frame": 2}, "mtms": "9458-100*1234567"}]})",
       {"bpa[1].mtms: expected an object"}},
      {"text as a number",
       R"({"chassis": [{"fru": {"sn": 12}}]})",
       {"chassis[0].fru.sn: expected a string or a {\"hex\": \"...\"} object"}},
      {"number as a string",
       R"({"sma": [{"loc": {"frame": "1"}}]})",
       {"sma[0].loc.frame: expected an integer"}},
      {"table as an object", R"({"sma": {}})", {"sma: expected an array"}},
      {"risers as an object",
       R"({"chassis": [{"risers": {"slot": 1}}]})",
       {"chassis[0].risers: expected an array"}},
      {"inventory as an array", "[]", {"inventory: expected an object"}},
      {"null for a member", R"({"sma": [{"cec": null}]})", {"sma[0].cec: expected an object"}},
      // Unknown and repeated keys.
      {"unknown key in a record",
       R"({"chassis": [{"dca3": {}}]})",
       {"chassis[0].dca3: unknown key; " + kChassisKeys}},
      {"unknown top-level key",
       R"({"smas": []})",
       {"smas: unknown key; expected one of sma, chassis, bpa"}},
      {"unknown key that is not a word",
       R"({"sma": [{"fru": {"p n": "x"}}]})",
       {"sma[0].fru.\"p n\": unknown key; expected one of ds, pn, ec, fn, sn, cc, yl"}},
      {"key given twice",
       R"({"sma": [{"fru": {"pn": "a", "pn": "b"}}]})",
       {"sma[0].fru.pn: key given twice"}},
      {"table given twice", R"({"sma": [], "bpa": [], "sma": []})", {"sma: key given twice"}},
      {"key given twice deep in arrays",
       R"({"chassis": [{}, {"risers": [{"slot": 1}, {"slot": 2, "fru": {}, "slot": 3}]}]})",
       {"chassis[1].risers[1].slot: key given twice"}},
      // Risers and BPA units.
      {"riser slot beyond 15",
       R"({"chassis": [{"risers": [{"slot": 16}]}]})",
       {"chassis[0].risers[0].slot: 16 is not a riser slot (0 to 15)"}},
      {"riser slot given twice",
       R"({"chassis": [{"risers": [{"slot": 5}, {"slot": 4}, {"slot": 5, "port1": 1}]}]})",
       {"chassis[0].risers[2].slot: slot 5 again (first at chassis[0].risers[0])"}},
      {"riser without a slot",
       R"({"chassis": [{"risers": [{"port1": 3}]}]})",
       {"chassis[0].risers[0]: no \"slot\": every riser names its slot, 0 to 15"}},
      {"four regulators",
       R"({"bpa": [{"bpr1": [{}, {}, {}, {}]}]})",
       {"bpa[0].bpr1: 4 entries, at most 3"}},
      // Records that would replace each other.
      {"SMA location given twice",
       R"({"sma": [{"loc": {"frame": 1, "cage": 2, "chip": 3}},
                   {"loc": {"frame": 1, "cage": 2, "chip": 4}},
                   {"loc": {"frame": 1, "cage": 2, "chip": 3, "network": 5}}]})",
       {"sma[2].loc: frame 1, cage 2, chip 3 again (first at sma[0])"}},
      {"chassis location given twice, chips differ",
       R"({"chassis": [{"loc": {"frame": 1, "cage": 2, "chip": 1}},
                       {"loc": {"frame": 1, "cage": 2, "chip": 2}}]})",
       {"chassis[1].loc: frame 1, cage 2 again (first at chassis[0])"}},
      // Not JSON at all.
      {"malformed JSON",
       R"({"sma": [)",
       {"parse error at line 1, column 10: syntax error while parsing value - unexpected end of "
        "input; expected '[', '{', or a literal"}},
      {"empty file",
       "",
       {"parse error at line 1, column 1: syntax error while parsing value - unexpected end of "
        "input; expected '[', '{', or a literal"}},
      {"bytes that are not UTF-8 in a string",
       "{\"sma\": [{\"fru\": {\"pn\": \"\xff\"}}]}",
       {"parse error at line 1, column 26: syntax error while parsing value - invalid string: "
        "ill-formed UTF-8 byte; last read: '\"\\xff'"}},
      {"trailing garbage",
       R"({"sma": []} x)",
       {"parse error at line 1, column 13: syntax error while parsing value - invalid literal; "
        "last read: '\"sma\": []} x'; expected end of input"}},
      {"nesting too deep",
       deep(40),
       {"[0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0][0]"
        "[0][0][0]: nested deeper than 32 levels"}},
      // Records are checked as they are read: indexes and paths hold across the records
      // already checked, the document's own faults come first, tables in document order,
      // and a document that turns out malformed reports only that.
      {"a value that is not a record, then a bad record",
       R"({"sma": [1, {"loc": {"frame": 5000}}]})",
       {"sma[0]: expected an object", "sma[1].loc.frame: 5000 does not fit 12 bits, at most 4095"}},
      {"key given twice after records already checked",
       R"({"sma": [{}, {}, {"fru": {}, "fru": {}}]})",
       {"sma[2].fru: key given twice"}},
      {"unknown top-level key after a bad record",
       R"({"sma": [{"cec": 1}], "smas": [1]})",
       {"smas: unknown key; expected one of sma, chassis, bpa", "sma[0].cec: expected an object"}},
      {"tables in document order",
       R"({"bpa": [{"mtms": 1}], "sma": [{"cec": 1}]})",
       {"bpa[0].mtms: expected an object", "sma[0].cec: expected an object"}},
      {"bad records, then malformed JSON",
       R"({"sma": [{"loc": {"frame": 5000}}, {"cec": 1}, )",
       {"parse error at line 1, column 48: syntax error while parsing value - unexpected end of "
        "input; expected '[', '{', or a literal"}},
      // Several problems: all are reported, the first twenty shown.
      {"three problems in one record",
       R"({"chassis": [{"loc": {"frame": 5000}, "mtms": {"tm": "123456789"}, "dca2": []}]})",
       {"chassis[0].loc.frame: 5000 does not fit 12 bits, at most 4095",
        "chassis[0].mtms.tm: 9 characters, at most 8", "chassis[0].dca2: expected an object"}},
      {"more problems than are shown", manyBadFrames(25), twenty, 25},
  };
}

TEST(VpdloadValidation, ABadValueIsNamedAndNoTableChanges) {
  TempDir tmp;
  std::string data = tmp / "data";
  // Live tables and a previous generation, both of which must survive every bad import.
  ASSERT_EQ(importText(data, makeInventory(3, 2, 1, "OLD"), tmp / "a.json").status, 0);
  ASSERT_EQ(importText(data, makeInventory(4, 1, 2, "NEW"), tmp / "b.json").status, 0);
  const auto before = snapshot(data);
  ASSERT_EQ(before.count("sma_vpd.db.old"), 1u);

  const std::string file = tmp / "bad.json";
  for (const BadCase& c : badCases()) {
    SCOPED_TRACE(c.name);
    auto r = importText(data, c.json, file);
    std::string expected;
    for (const std::string& p : c.problems) expected += "vpdload: " + file + ": " + p + "\n";
    std::size_t total = c.total ? c.total : c.problems.size();
    expected +=
        "vpdload: " + file + ": " + std::to_string(total) + (total == 1 ? " error" : " errors") +
        (total > c.problems.size() ? " (the first 20 shown)" : "") + "; no table was changed\n";
    EXPECT_EQ(r.status, 1);
    EXPECT_EQ(r.err, expected);
    EXPECT_EQ(r.out, "");
    EXPECT_TRUE(sameFiles(snapshot(data), before));
  }
}

TEST(VpdloadValidation, ABadInventoryCreatesNoDataDirectory) {
  TempDir tmp;
  auto r = importText(tmp / "data", R"({"sma": [{"loc": {"frame": -2}}]})", tmp / "bad.json");
  EXPECT_EQ(r.status, 1);
  EXPECT_FALSE(testsupport::fileExists(tmp / "data"));
}

}  // namespace
