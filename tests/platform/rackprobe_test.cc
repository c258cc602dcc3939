// The dump tool stand-in, run as a process under a temporary install root.
#include <gtest/gtest.h>
#include <unistd.h>

#include <functional>
#include <string>
#include <vector>

#include "test_support.h"

namespace {

using testsupport::TempDir;

std::string longDump() {
  std::string text = "1 1 SW_CHIP 0 1 1\n";
  text += "2 3 SW_CHIP 0 1 1 " + std::string(10000, 'x') + "\n";
  // Larger than any one read, with bytes a text-mode copy might disturb, no final newline.
  for (int i = 0; i < 20000; ++i) text += std::to_string(i) + " 5 BPA\t0 1 2 \r\n";
  text += std::string("\0\x01\xff tail", 8);
  return text;
}

TEST(Rackprobe, DumpCopiesTheFileUnchanged) {
  struct Case {
    const char* name;
    std::function<void(const TempDir&)> make;
    int status;
    std::string out;
    std::string err_start;  // what standard error begins with ("" = nothing at all)
  };
  const std::string kLong = longDump();
  const Case cases[] = {
      {"switch chip lines",
       [](const TempDir& r) {
         testsupport::writeFile(r / "etc/rackprobe.dump",
                                "3 2 SW_CHIP 0 1 1\n3 2 SW_CHIP 1 1 1\n4 2 BPA 0 0 1\n");
       },
       0, "3 2 SW_CHIP 0 1 1\n3 2 SW_CHIP 1 1 1\n4 2 BPA 0 0 1\n", ""},
      {"long lines and odd bytes",
       [&kLong](const TempDir& r) { testsupport::writeFile(r / "etc/rackprobe.dump", kLong); }, 0,
       kLong, ""},
      {"empty file", [](const TempDir& r) { testsupport::writeFile(r / "etc/rackprobe.dump", ""); },
       0, "", ""},
      {"missing file", [](const TempDir&) {}, 0, "", ""},
      {"missing etc folder", [](const TempDir& r) { ::rmdir((r / "etc").c_str()); }, 0, "", ""},
      {"directory in its place",
       [](const TempDir& r) { testsupport::makeDirs(r / "etc/rackprobe.dump"); }, 1, "",
       "rackprobe: "},
      {"symlink loop",
       [](const TempDir& r) {
         std::string p = r / "etc/rackprobe.dump";
         ASSERT_EQ(::symlink(p.c_str(), p.c_str()), 0);
       },
       1, "", "rackprobe: "},
  };
  for (const Case& c : cases) {
    TempDir root;
    testsupport::makeDirs(root / "etc");
    c.make(root);
    testsupport::RunResult r =
        testsupport::run({RACKPROBE_BIN, "dump", "-d"}, {{"OLV_ROOT", root.path()}});
    EXPECT_EQ(r.status, c.status) << c.name;
    EXPECT_TRUE(r.out == c.out) << c.name << ": " << r.out.size() << " bytes, expected "
                                << c.out.size();
    if (c.err_start.empty()) {
      EXPECT_EQ(r.err, "") << c.name;
    } else {
      EXPECT_EQ(r.err.rfind(c.err_start + root.path() + "/etc/rackprobe.dump: ", 0), 0u)
          << c.name << ": " << r.err;
    }
  }
}

TEST(Rackprobe, OtherArgumentsGetUsage) {
  const std::vector<std::vector<std::string>> cases = {
      {},
      {"dump"},
      {"-d"},
      {"dump", "-x"},
      {"-d", "dump"},
      {"dump", "-d", "extra"},
      {"DUMP", "-d"},
      {"dump", "-dd"},
      {"--help"},
  };
  TempDir root;
  testsupport::makeDirs(root / "etc");
  testsupport::writeFile(root / "etc/rackprobe.dump", "3 2 SW_CHIP 0 1 1\n");
  for (const auto& args : cases) {
    std::vector<std::string> argv = {RACKPROBE_BIN};
    argv.insert(argv.end(), args.begin(), args.end());
    std::string shown = "(none)";
    for (size_t i = 0; i < args.size(); ++i) shown = (i ? shown + " " : "") + args[i];
    testsupport::RunResult r = testsupport::run(argv, {{"OLV_ROOT", root.path()}});
    EXPECT_EQ(r.status, 2) << shown;
    EXPECT_EQ(r.out, "") << shown;
    EXPECT_EQ(r.err.rfind("usage: rackprobe dump -d\n", 0), 0u) << shown << ": " << r.err;
  }
}

}  // namespace
