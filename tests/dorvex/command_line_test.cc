// End-to-end: the argument count, keyword prefixes, decimal values, the "0" line of an
// unknown option, --help and --version, and which request form wins.
#include <gtest/gtest.h>

#include "installation.h"

namespace dorvextest {
namespace {

class CommandLine : public ::testing::Test {
 protected:
  static void SetUpTestSuite() {
    inst_ = new Installation;
    fillStandard(*inst_);
  }
  static void TearDownTestSuite() {
    delete inst_;
    inst_ = nullptr;
  }
  static Installation* inst_;
};
Installation* CommandLine::inst_ = nullptr;

const char kSwA[] = "2 3 7045-SW4*0C0FFEE\n";

TEST_F(CommandLine, ArgumentsAndKeywords) {
  expectRuns(
      *inst_,
      {
          {"no arguments", {}, "", 2},
          {"one word, although a whole option", {"-yall"}, "", 2},
          {"one unknown word", {"-x"}, "", 2},
          {"--help with more words is no help", {"-y", "--help"}, "", 2},
          {"keyword with more characters", {"-y", "switchboard", "-f", "2", "-c", "3"}, kSwA, 0},
          {"cecabc is cec", {"-y", "cecabc", "-f", "5", "-c", "2"}, "5 2 9119-595*0212345\n", 0},
          {"ce is no keyword", {"-y", "ce", "-f", "5", "-c", "2"}, "", 2},
          {"an unknown later keyword keeps the code",
           {"-y", "switch", "-y", "sw", "-f", "2", "-c", "3"},
           kSwA,
           0},
          {"the last keyword wins", {"-y", "bpa", "-y", "switch", "-f", "2", "-c", "3"}, kSwA, 0},
          {"bp is no fru kind",
           {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bp", "-a", "2"},
           "2 255 9458-100*02A1B2C\n",
           0},
          {"bpcx is bpc",
           {"-y", "bpa", "-f", "2", "-c", "255", "-r", "bpcx", "-a", "2"},
           "9458-100*02A1B2C 12R3456 YH10BC000002 2B01\n",
           0},
          {"frame without digits is 0", {"-y", "switch", "-f", "abc", "-c", "3"}, "", 1},
          {"digits before a letter", {"-y", "switch", "-f", "2x", "-c", "3"}, kSwA, 0},
          {"blanks and a sign", {"-y", "switch", "-f", " 2", "-c", "+3"}, kSwA, 0},
          {"frame -1 is no frame", {"-y", "switch", "-f", "-1", "-c", "3"}, "", 2},
          {"the last value wins", {"-y", "switch", "-f", "9", "-c", "3", "-f", "2"}, kSwA, 0},
          {"port is ignored", {"-p", "9", "-y", "switch", "-f", "2", "-c", "3"}, kSwA, 0},
          {"words that are no options",
           {"-y", "switch", "extra", "-f", "2", "-c", "3", "more"},
           kSwA,
           0},
          {"joined values", {"-yswitch", "-f2", "-c3"}, kSwA, 0},
      });
}

TEST_F(CommandLine, UnknownOptionWritesZeroAndGoesOn) {
  struct {
    const char* name;
    std::vector<std::string> args;
    std::string out;
    int status;
    const char* err_part;  // of getopt's own message
  } cases[] = {
      {"unknown letter",
       {"-x", "5", "-y", "switch", "-f", "2", "-c", "3"},
       std::string("0\n") + kSwA,
       0,
       "invalid option"},
      {"two unknown letters",
       {"-x", "-z", "-y", "switch", "-f", "2", "-c", "3"},
       std::string("0\n0\n") + kSwA,
       0,
       "invalid option"},
      {"trailing option without value",
       {"-y", "switch", "-f", "2", "-c", "3", "-f"},
       std::string("0\n") + kSwA,
       0,
       "requires an argument"},
      {"trailing -y keeps nothing", {"-f", "2", "-c", "3", "-y"}, "0\n", 2, "requires an argument"},
  };
  for (const auto& c : cases) {
    testsupport::RunResult r = inst_->run(c.args);
    EXPECT_EQ(r.out, c.out) << c.name;
    EXPECT_EQ(r.status, c.status) << c.name;
    EXPECT_NE(r.err.find(c.err_part), std::string::npos) << c.name << ": " << r.err;
  }
}

TEST_F(CommandLine, HelpAndVersion) {
  testsupport::RunResult help = inst_->run({"--help"});
  EXPECT_EQ(help.status, 0);
  EXPECT_EQ(help.out.rfind("usage: dorvex -y TYPE", 0), 0u) << help.out;
  EXPECT_NE(help.out.find("5 console discovery failed"), std::string::npos) << help.out;
  EXPECT_EQ(help.err, "");

  testsupport::RunResult version = inst_->run({"--version"});
  EXPECT_EQ(version.out, "dorvex " DORVEX_VERSION_TEXT "\n");
  EXPECT_EQ(version.status, 0);
}

// The first form whose settings are given wins, whatever its type can do.
TEST_F(CommandLine, Precedence) {
  expectRuns(
      *inst_,
      {
          {"location beats network", {"-y", "netvpd", "-n", "1", "-f", "2", "-c", "3"}, "", 2},
          {"location beats time", {"-y", "switch", "-f", "2", "-c", "3", "-t", "5"}, kSwA, 0},
          {"fru beats location", {"-y", "switch", "-f", "2", "-c", "3", "-r", "dca"}, "", 2},
          {"part beats fru",
           {"-y", "switch", "-f", "2", "-c", "3", "-r", "planar", "-h", "1"},
           "",
           2},
          {"time beats frame", {"-y", "switch", "-f", "2", "-t", "5"}, "", 2},
          {"time beats mtms and network",
           {"-y", "cec", "-t", "1700000000", "-m", "x", "-n", "1"},
           "NoChange\n",
           0},
          {"frame beats mtms",
           {"-y", "switch", "-f", "2", "-m", "7045SW4X*1234567"},
           "2 3 7045-SW4*0C0FFEE\n2 4 7045-SW4*0C0FFEF\n",
           0},
          {"mtms beats network",
           {"-y", "switch", "-m", "7045SW4X*1234567", "-n", "1"},
           "6 1 7045SW4X*1234567\n",
           0},
          {"cage alone is a dump", {"-y", "switch", "-c", "3", "-n", "-1"}, "", 2},
          {"no type fits no form", {"-f", "2", "-c", "3", "-r", "planar"}, "", 2},
      });
}

}  // namespace
}  // namespace dorvextest
