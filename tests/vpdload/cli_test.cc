// The command line of vpdload: generations, files and streams, usage, and what export
// makes of tables that it did not write.
#include <gtest/gtest.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "test_support.h"
#include "vpdload_test_util.h"

namespace {

using testsupport::fileExists;
using testsupport::readFile;
using testsupport::TempDir;
using testsupport::writeFile;
using vpdloadtest::importText;
using vpdloadtest::makeInventory;
using vpdloadtest::oldTables;
using vpdloadtest::sameFiles;
using vpdloadtest::snapshot;
using vpdloadtest::tables;
using vpdloadtest::vpdload;

TEST(VpdloadCli, EachImportKeepsThePreviousGenerationInTheOldFiles) {
  TempDir tmp;
  std::string data = tmp / "data";
  // Reference tables of each inventory, imported on their own.
  std::string inv[3] = {makeInventory(3, 2, 1, "A"), makeInventory(5, 1, 2, "B"),
                        makeInventory(1, 3, 1, "C")};
  std::map<std::string, std::string> ref[3];
  for (int i = 0; i < 3; ++i) {
    std::string dir = tmp / ("ref" + std::to_string(i));
    ASSERT_EQ(importText(dir, inv[i], tmp / "ref.json").status, 0);
    ref[i] = tables(dir);
  }

  ASSERT_EQ(importText(data, inv[0], tmp / "in.json").status, 0);
  EXPECT_TRUE(sameFiles(tables(data), ref[0]));
  for (const auto& t : oldTables(data)) EXPECT_FALSE(fileExists(data + "/" + t.first + ".old"));

  for (int i = 1; i < 3; ++i) {
    SCOPED_TRACE("import " + std::to_string(i + 1));
    auto r = importText(data, inv[i], tmp / "in.json");
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_TRUE(sameFiles(tables(data), ref[i]));
    EXPECT_TRUE(sameFiles(oldTables(data), ref[i - 1]));
  }
  EXPECT_TRUE(vpdloadtest::stagingLeftovers(data).empty());
}

TEST(VpdloadCli, AMissingLiveTableLeavesAnOlderOldFileAlone) {
  TempDir tmp;
  std::string data = tmp / "data";
  ASSERT_EQ(importText(data, makeInventory(2, 1, 1, "A"), tmp / "in.json").status, 0);
  ASSERT_EQ(importText(data, makeInventory(3, 1, 1, "B"), tmp / "in.json").status, 0);
  std::string older = readFile(data + "/bpa_vpd.db.old");
  std::string previous_sma = readFile(data + "/sma_vpd.db");
  ASSERT_EQ(::unlink((data + "/bpa_vpd.db").c_str()), 0);

  ASSERT_EQ(importText(data, makeInventory(4, 1, 1, "C"), tmp / "in.json").status, 0);
  EXPECT_EQ(readFile(data + "/bpa_vpd.db.old"), older);
  EXPECT_EQ(readFile(data + "/sma_vpd.db.old"), previous_sma);
  EXPECT_TRUE(fileExists(data + "/bpa_vpd.db"));
}

TEST(VpdloadCli, AnImportRemovesTheStagingFoldersOfKilledImports) {
  TempDir tmp;
  std::string data = tmp / "data";
  ASSERT_EQ(importText(data, makeInventory(2, 1, 1, "A"), tmp / "in.json").status, 0);
  // What a killed import leaves: a staging folder with tables in it.
  for (const char* name : {".vpdload.k1LLed", ".vpdload.Xy12z9"}) {
    testsupport::makeDirs(data + "/" + name);
    writeFile(data + "/" + name + "/sma_vpd.db", std::string(100, 'x'));
    writeFile(data + "/" + name + "/chassis_vpd.db.old", "");
  }
  writeFile(data + "/.vpdload.notes", "not a folder: not ours to remove");

  ASSERT_EQ(importText(data, makeInventory(3, 1, 1, "B"), tmp / "in.json").status, 0);
  auto left = snapshot(data);
  EXPECT_EQ(vpdloadtest::stagingLeftovers(data), std::vector<std::string>());
  EXPECT_EQ(left.count(".vpdload.notes"), 1u);
  EXPECT_EQ(left.count(".vpdload.lock"), 1u);
}

TEST(VpdloadCli, FilesStreamsAndTheDefaultDataDirectory) {
  TempDir tmp;
  std::string inv = makeInventory(4, 2, 1, "S");
  std::map<std::string, std::string> root_env = {{"OLV_ROOT", tmp / "root"}};

  // Standard input, into $OLV_ROOT/data (created with its parents).
  auto r = vpdload({"import", "-"}, &inv, root_env);
  ASSERT_EQ(r.status, 0) << r.err;
  EXPECT_EQ(r.err,
            "vpdload: stored 2 chassis, 1 BPA and 4 SMA records in " + tmp / "root/data" + "\n");
  EXPECT_EQ(r.out, "");
  auto via_file = importText(tmp / "other", inv, tmp / "in.json");
  ASSERT_EQ(via_file.status, 0);
  EXPECT_TRUE(sameFiles(tables(tmp / "root/data"), tables(tmp / "other")));

  // Export to a file, to "-" and with no file at all.
  auto to_stdout = vpdload({"export"}, nullptr, root_env);
  ASSERT_EQ(to_stdout.status, 0);
  auto dash = vpdload({"export", "-"}, nullptr, root_env);
  EXPECT_EQ(dash.out, to_stdout.out);
  auto to_file = vpdload({"export", tmp / "out.json"}, nullptr, root_env);
  ASSERT_EQ(to_file.status, 0);
  EXPECT_EQ(to_file.out, "");
  EXPECT_EQ(readFile(tmp / "out.json"), to_stdout.out);
  // --data wins over OLV_ROOT.
  auto other = vpdload({"--data", tmp / "other", "export"}, nullptr, {{"OLV_ROOT", tmp / "none"}});
  EXPECT_EQ(other.out, to_stdout.out);
}

TEST(VpdloadCli, ExportOfTablesItDidNotWrite) {
  TempDir tmp;
  std::string data = tmp / "data";
  ASSERT_EQ(importText(data, makeInventory(2, 1, 1, "P"), tmp / "in.json").status, 0);
  auto whole = vpdload({"export", "--data", data});
  ASSERT_EQ(whole.status, 0);

  // Bytes that are no whole record: left out, with a warning.
  writeFile(data + "/sma_vpd.db", readFile(data + "/sma_vpd.db") + std::string(17, 'x'));
  auto partial = vpdload({"export", "--data", data});
  EXPECT_EQ(partial.status, 0);
  EXPECT_EQ(partial.out, whole.out);
  EXPECT_EQ(partial.err, "vpdload: warning: " + data +
                             "/sma_vpd.db ends with 17 bytes that are not a whole record; they "
                             "are left out\n");

  // A missing table: nothing to export.
  ASSERT_EQ(::unlink((data + "/bpa_vpd.db").c_str()), 0);
  auto missing = vpdload({"export", "--data", data});
  EXPECT_EQ(missing.status, 3);
  EXPECT_EQ(missing.out, "");
  EXPECT_EQ(missing.err,
            "vpdload: cannot read " + data + "/bpa_vpd.db: No such file or directory\n");
}

TEST(VpdloadCli, UsageAndStatuses) {
  TempDir tmp;
  writeFile(tmp / "ok.json", "{}");
  struct Case {
    const char* name;
    std::vector<std::string> args;
    int status;
    std::string err;  // whole standard error
  } cases[] = {
      {"no command", {}, 2, "vpdload: no command: import or export\nTry 'vpdload --help'.\n"},
      {"unknown command",
       {"load", "x"},
       2,
       "vpdload: unknown command \"load\": import or export\nTry 'vpdload --help'.\n"},
      {"import without a file",
       {"import"},
       2,
       "vpdload: import needs a FILE (- for standard input)\nTry 'vpdload --help'.\n"},
      {"import of two files",
       {"import", "a", "b"},
       2,
       "vpdload: import takes one FILE, not 2\nTry 'vpdload --help'.\n"},
      {"export to two files",
       {"export", "a", "b"},
       2,
       "vpdload: export takes at most one FILE, not 2\nTry 'vpdload --help'.\n"},
      {"unknown option",
       {"import", "--force", "a"},
       2,
       "vpdload: unknown option --force\nTry 'vpdload --help'.\n"},
      {"option without its value",
       {"export", "--data"},
       2,
       "vpdload: option --data needs a value\nTry 'vpdload --help'.\n"},
      {"negative wait",
       {"export", "--wait=-1"},
       2,
       "vpdload: option --wait takes seconds from 0 to 86400, not \"-1\"\nTry 'vpdload --help'.\n"},
      {"wait that is no number",
       {"export", "--wait", "5s"},
       2,
       "vpdload: option --wait takes seconds from 0 to 86400, not \"5s\"\nTry 'vpdload --help'.\n"},
      {"missing input file",
       {"import", "--data", tmp / "d", tmp / "nope.json"},
       3,
       "vpdload: cannot read " + tmp / "nope.json" + ": No such file or directory\n"},
      {"input that is a folder",
       {"import", "--data", tmp / "d", tmp.path()},
       3,
       "vpdload: cannot read " + tmp.path() + ": Is a directory\n"},
      {"output that cannot be written",
       {"export", "--data", tmp / "d", "/dev/full"},
       4,
       "vpdload: cannot write /dev/full: No space left on device\n"},
      {"data directory that is a file",
       {"import", "--data", tmp / "ok.json", tmp / "ok.json"},
       4,
       "vpdload: cannot use " + tmp / "ok.json" + ": Not a directory\n"},
  };
  // The export case needs tables.
  ASSERT_EQ(vpdload({"import", "--data", tmp / "d", tmp / "ok.json"}).status, 0);
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    auto r = vpdload(c.args);
    EXPECT_EQ(r.status, c.status);
    EXPECT_EQ(r.err, c.err);
    EXPECT_EQ(r.out, "");
  }
}

TEST(VpdloadCli, HelpDocumentsTheStatusesAndTheEscape) {
  for (const char* flag : {"--help", "-h"}) {
    auto r = vpdload({"export", flag});
    EXPECT_EQ(r.status, 0);
    EXPECT_EQ(r.err, "");
    for (const char* needle : {"Usage: vpdload", "Exit status:", "  5  another import held",
                               "{\"hex\": \"c3a9ff\"}", "--wait SECONDS", "--data DIR"}) {
      EXPECT_NE(r.out.find(needle), std::string::npos) << flag << " lacks " << needle;
    }
  }
}

}  // namespace
