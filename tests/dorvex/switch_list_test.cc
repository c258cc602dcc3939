// The switch chip list: line splitting, matching, de-duplication, the entry limit, and
// running the dump tool.
#include "switch_list.h"

#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cerrno>
#include <climits>
#include <cstdlib>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "installation.h"
#include "requests.h"

namespace dorvextest {
namespace {

using Positions = std::vector<std::pair<int, int>>;
using dorvex::kMaxChipEntries;

struct Chips {
  std::vector<int> frames = std::vector<int>(kMaxChipEntries, -7);
  std::vector<int> cages = std::vector<int>(kMaxChipEntries, -7);
  Positions first(int n) const {
    Positions p;
    for (int i = 0; i < n; ++i) p.emplace_back(frames[i], cages[i]);
    return p;
  }
};

// Feeds `text` whole, or one byte at a time; returns the entry count.
int collect(const std::string& text, int network, Chips& chips, bool bytewise) {
  dorvex::SwitchChipCollector collector(network, chips.frames.data(), chips.cages.data());
  if (bytewise) {
    for (char c : text) collector.feed(&c, 1);
  } else {
    collector.feed(text.data(), text.size());
  }
  collector.finish();
  return collector.count();
}

TEST(SwitchList, DecimalFieldsReadAsStrtolReadsThem) {
  const char* texts[] = {"",
                         "0",
                         "12",
                         "01",
                         "1x",
                         "-3",
                         "+4",
                         "\t7",
                         "\r\v\f9",
                         "-",
                         "+-1",
                         "x1",
                         "1\r",
                         "\t-\t1",
                         "4294967297",
                         "-2147483649",
                         "99999999999999999999",
                         "-99999999999999999999",
                         "9223372036854775807",
                         "9223372036854775808",
                         "-9223372036854775808",
                         "-9223372036854775809",
                         "000000000000000000000042"};
  for (const char* text : texts) {
    dorvex::StreamingDecimal d;
    for (const char* p = text; *p != '\0'; ++p) d.add(*p);
    EXPECT_EQ(d.value(), std::strtol(text, nullptr, 10)) << '"' << text << '"';
  }
}

TEST(SwitchList, LinesAndFields) {
  const std::string long_field(200, 'x');
  // A line longer than a 128-byte buffer whose tail would look like a chip line.
  const std::string long_line =
      "1 1 HEADER 0 0 0 " + std::string(110, 'y') + " 5 6 SW_CHIP 0 1 1\n";
  struct {
    const char* name;
    std::string text;
    int network;
    Positions expected;
  } cases[] = {
      {"one chip", "3 2 SW_CHIP 0 1 1\n", 1, {{3, 2}}},
      {"another network", "3 2 SW_CHIP 0 1 1\n", 2, {}},
      {"repeat leaves a hole",
       "3 2 SW_CHIP 0 1 1\n3 2 SW_CHIP 0 1 1\n4 2 SW_CHIP 0 1 1\n",
       1,
       {{3, 2}, {0, 0}, {4, 2}}},
      {"chips of one chassis", "3 2 SW_CHIP 0 1 1\n3 2 SW_CHIP 1 1 1\n", 1, {{3, 2}, {0, 0}}},
      {"same frame, other cage", "3 2 SW_CHIP 0 1 1\n3 4 SW_CHIP 0 1 1\n", 1, {{3, 2}, {3, 4}}},
      {"SW_CHIPX counts", "3 2 SW_CHIPX 0 1 1\n", 1, {{3, 2}}},
      {"tab inside the type", "3 2 SW_CHIP\tX 0 1 1\n", 1, {{3, 2}}},
      {"lower case does not", "3 2 sw_chip 0 1 1\n", 1, {}},
      {"short type does not", "3 2 SW_CHI 0 1 1\n", 1, {}},
      {"runs of spaces", "  3   2 SW_CHIP  0 1     1  \n", 1, {{3, 2}}},
      {"tabs do not separate", "3\t2\tSW_CHIP\t0\t1\t1\n", 1, {}},
      {"leading zero", "3 2 SW_CHIP 0 1 01\n", 1, {{3, 2}}},
      {"trailing letter", "3 2 SW_CHIP 0 1 1x\n", 1, {{3, 2}}},
      {"carriage return", "3 2 SW_CHIP 0 1 1\r\n", 1, {{3, 2}}},
      {"more fields", "3 2 SW_CHIP 0 1 1 " + long_field + " more\n", 1, {{3, 2}}},
      {"five fields", "3 2 SW_CHIP 0 1\n", 0, {}},
      {"five fields and a blank", "3 2 SW_CHIP 0 1 \n", 0, {}},
      {"blank and heading lines", "\n   \nFRAME CAGE TYPE\n3 2 SW_CHIP 0 1 1\n", 1, {{3, 2}}},
      {"last line without newline", "4 4 SW_CHIP 0 1 1\n3 2 SW_CHIP 0 1 1", 1, {{4, 4}, {3, 2}}},
      {"a long line is one line", long_line, 1, {}},
      {"a long line, then a chip", long_line + "7 7 SW_CHIP 0 1 1\n", 1, {{7, 7}}},
      {"position 0 0 is stored", "0 0 SW_CHIP 0 1 1\n3 2 SW_CHIP 0 1 1\n", 1, {{0, 0}, {3, 2}}},
      {"numbers as strtol reads them",
       "-1 abc SW_CHIP 0 1 +1\n 12x 4294967298 SW_CHIP 0 1 1\n",
       1,
       {{-1, 0}, {12, 2}}},
  };
  for (const auto& c : cases) {
    for (bool bytewise : {false, true}) {
      Chips chips;
      int n = collect(c.text, c.network, chips, bytewise);
      EXPECT_EQ(n, static_cast<int>(c.expected.size()))
          << c.name << (bytewise ? " (bytewise)" : "");
      EXPECT_EQ(chips.first(n), c.expected) << c.name << (bytewise ? " (bytewise)" : "");
      for (int i = n; i < kMaxChipEntries; ++i) {
        ASSERT_TRUE(chips.frames[i] == 0 && chips.cages[i] == 0) << c.name << " entry " << i;
      }
    }
  }
}

// Pieces may end anywhere, also in a part of a line that is passed over unread: cut every
// text at every pair of places and compare with feeding it whole.
TEST(SwitchList, PiecesEndAnywhere) {
  const char* texts[] = {
      "3 2 SW_CHIP 0 1 1\n4 2 BPA 0 1 1\n5 2 SW_CHIP 0 1 1 x y z\n6 2 SW_CHIP 0 1 1",
      "7 7 SMA 0 1 1 SW_CHIP\n8 8 SW_CHIP 0 1 1\n9 9 SW_CHIPS 0 1 1 8 8\n",
      "1 1 SW_CHI 0 0 1\n2 2 SW_CHIP\t0 0 1\n3 3 SW_CHIP 0 0 1\t1\n 4  4  SW_CHIP  0  0  1  \n",
      "5 5 SW_CHIP 0 0\n6 6 SW_CHIP 0 0 1 7\n7 7 X\n\n8 8 SW_CHIP 0 0 1",
  };
  for (const std::string text : texts) {
    Chips whole;
    int n = collect(text, 1, whole, false);
    ASSERT_GT(n, 0) << text;
    for (std::size_t a = 0; a <= text.size(); ++a) {
      for (std::size_t b = a; b <= text.size(); ++b) {
        Chips chips;
        dorvex::SwitchChipCollector collector(1, chips.frames.data(), chips.cages.data());
        collector.feed(text.data(), a);
        collector.feed(text.data() + a, b - a);
        collector.feed(text.data() + b, text.size() - b);
        collector.finish();
        ASSERT_EQ(collector.count(), n) << text << " cut at " << a << " and " << b;
        ASSERT_EQ(chips.first(n), whole.first(n)) << text << " cut at " << a << " and " << b;
      }
    }
  }
}

// A piece of blanks without a newline is looked through once, not once per blank (which
// would take hours here).
TEST(SwitchList, ALongPieceWithoutANewlineIsReadOnce) {
  const std::string blanks(8 << 20, ' ');
  Chips chips;
  dorvex::SwitchChipCollector collector(1, chips.frames.data(), chips.cages.data());
  collector.feed(blanks.data(), blanks.size());
  const std::string rest = "3 2 SW_CHIP 0 1 1\n4 2 SW_CHIP 0 1 1\n";
  collector.feed(rest.data(), rest.size());
  collector.finish();
  EXPECT_EQ(collector.count(), 2);
  EXPECT_EQ(chips.first(2), (Positions{{3, 2}, {4, 2}}));
}

TEST(SwitchList, StoresAtMost2048EntriesAndReadsTheRest) {
  std::string text;
  for (int i = 1; i <= 3000; ++i) {
    text += std::to_string(i) + " 1 SW_CHIP 0 0 1\n";
    if (i == 2048) text += "1 1 SW_CHIP 0 0 1\n";  // a repeat past the limit stores nothing
  }
  Chips chips;
  EXPECT_EQ(collect(text, 1, chips, false), kMaxChipEntries);
  EXPECT_EQ(chips.first(1), (Positions{{1, 1}}));
  EXPECT_EQ(chips.frames[kMaxChipEntries - 1], 2048);
}

// The linear de-duplication gives what comparing every pair of entries gives.
TEST(SwitchList, DeduplicationMatchesThePairwiseRule) {
  std::mt19937 rng(20240611);
  for (int round = 0; round < 200; ++round) {
    int lines = static_cast<int>(rng() % 60);
    std::string text;
    std::vector<int> frames(kMaxChipEntries, 0), cages(kMaxChipEntries, 0);
    int num = 0;
    for (int l = 0; l < lines; ++l) {
      int frame = static_cast<int>(rng() % 4), cage = static_cast<int>(rng() % 3);
      text += std::to_string(frame) + " " + std::to_string(cage) + " SW_CHIP 0 0 1\n";
      frames[num] = frame;
      cages[num] = cage;
      ++num;
      for (int i = 0; i < num; ++i) {
        for (int j = i + 1; j < num; ++j) {
          if (frames[i] == frames[j] && cages[i] == cages[j]) frames[j] = cages[j] = 0;
        }
      }
    }
    Chips chips;
    collect(text, 1, chips, false);
    ASSERT_EQ(chips.frames, frames) << text;
    ASSERT_EQ(chips.cages, cages) << text;

    // Clearing duplicate frames, on the same list.
    // Entries past the last stored one are all (0, 0) and stay so: leave them out.
    const int end = num + 1;
    std::vector<int> ref_frames = frames, ref_cages = cages;
    for (int i = 0; i < end - 1; ++i) {
      for (int j = i + 1; j < end; ++j) {
        if (ref_frames[j] == ref_frames[i]) ref_frames[j] = ref_cages[j] = 0;
      }
    }
    dorvex::clearDuplicateFrames(frames.data(), cages.data());
    ASSERT_EQ(frames, ref_frames) << text;
    ASSERT_EQ(cages, ref_cages) << text;
  }
}

TEST(SwitchList, RunsTheToolAndWaitsForIt) {
  Installation inst;
  setenv("OLV_ROOT", inst.root().c_str(), 1);
  struct {
    const char* name;
    std::string script;
    int result;
    Positions expected;
  } cases[] = {
      {"path and arguments",
       "#!/bin/sh\n[ \"$0 $#:$1:$2\" = \"" + inst.path("bin/rackprobe") +
           " 2:dump:-d\" ] && echo '4 5 SW_CHIP 0 0 1'\n",
       0,
       {{4, 5}}},
      {"much output",
       "#!/bin/sh\nhead -c 3000000 /dev/zero | tr '\\0' x\necho\n"
       "i=0; while [ $i -lt 50 ]; do echo \"$i 1 SW_CHIP 0 0 1\"; i=$((i+1)); done\n",
       0,
       {{0, 1}, {1, 1}, {2, 1}}},
      {"failing tool", "#!/bin/sh\necho '8 8 SW_CHIP 0 0 1'\nexit 9\n", 0, {{8, 8}}},
      {"no interpreter", "#!/no/such/shell\n", dorvex::kSwitchListNoTool, {{0, 0}}},
  };
  for (const auto& c : cases) {
    testsupport::writeFile(inst.path("bin/rackprobe"), c.script, 0755);
    Chips chips;
    EXPECT_EQ(dorvex::getSwitchList(1, chips.frames.data(), chips.cages.data()), c.result)
        << c.name;
    EXPECT_EQ(chips.first(static_cast<int>(c.expected.size())), c.expected) << c.name;
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1) << c.name << ": a child was left behind";
    EXPECT_EQ(errno, ECHILD) << c.name;
  }
  std::remove(inst.path("bin/rackprobe").c_str());
  Chips chips;
  EXPECT_EQ(dorvex::getSwitchList(1, chips.frames.data(), chips.cages.data()),
            dorvex::kSwitchListNoTool);
  unsetenv("OLV_ROOT");
}

}  // namespace
}  // namespace dorvextest
