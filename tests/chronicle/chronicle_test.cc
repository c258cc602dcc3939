// The trace client's line format and sinks.
#include "chronicle.h"

#include <gtest/gtest.h>

#include <cstdlib>

#include "chronicle_line.h"
#include "test_support.h"

namespace {

TEST(ChronicleLineTest, EscapesTheMessage) {
  struct Case {
    const char* in;
    const char* out;
  } cases[] = {
      {"plain text", "plain text"},
      {"trailing blank ", "trailing blank "},
      {"back\\slash", "back\\\\slash"},
      {"new\nline", "new\\nline"},
      {"a\ttab", "a\\ttab"},
      {"bell\x07", "bell\\x07"},
      {"del\x7f", "del\\x7f"},
      {"\x1f", "\\x1f"},
      {"high \xc3\xa9", "high \xc3\xa9"},
      {"", ""},
  };
  for (const Case& c : cases) EXPECT_EQ(chronicle::escapeMessage(c.in), c.out) << c.in;
  EXPECT_EQ(chronicle::escapeMessage(nullptr), "");
}

TEST(ChronicleLineTest, EightTabSeparatedFields) {
  timeval tv{1733500000, 42};
  EXPECT_EQ(chronicle::formatRecord(tv, 64, "ZRV_VPD", "putVPD", 0x21002053u, "store.cc", 77,
                                    "console1", "Failed\tto read\n"),
            "1733500000.000042\t64\tZRV_VPD\tputVPD\t0x21002053\tstore.cc:77\tconsole1\t"
            "Failed\\tto read\\n\n");
  EXPECT_EQ(chronicle::formatRecord(tv, 1, nullptr, nullptr, 0, nullptr, 0, nullptr, nullptr),
            "1733500000.000042\t1\t\t\t0x00000000\t:0\t\t\n");
}

int traceOnce(Chronicle& c, const char* msg) {
  timeval tv{5, 6};
  return c.Trace(1, 1, "op", loc_id_t(0), 0, "ZRV_VPD", "f.cc", "1.3", 9, "host", 0, tv, 0, 0,
                 nullptr, msg);
}

TEST(ChronicleSinkTest, FileSinkAppendsAndIsOpenedOnce) {
  testsupport::TempDir tmp;
  std::string log = tmp / "t.log";
  testsupport::writeFile(log, "earlier\n");
  setenv("CHRONICLE_LOG", log.c_str(), 1);
  Chronicle c;
  unsigned long opens = Chronicle::sinkOpenCount();
  EXPECT_EQ(traceOnce(c, "one"), 0);
  EXPECT_EQ(traceOnce(c, "two"), 0);
  EXPECT_EQ(Chronicle::sinkOpenCount() - opens, 1u);
  EXPECT_EQ(testsupport::readFile(log),
            "earlier\n5.000006\t1\tZRV_VPD\top\t0x00000000\tf.cc:9\thost\tone\n"
            "5.000006\t1\tZRV_VPD\top\t0x00000000\tf.cc:9\thost\ttwo\n");
  // Another log name opens another sink.
  std::string other = tmp / "u.log";
  setenv("CHRONICLE_LOG", other.c_str(), 1);
  traceOnce(c, "three");
  EXPECT_EQ(testsupport::lines(testsupport::readFile(other)).size(), 1u);
  unsetenv("CHRONICLE_LOG");
}

TEST(ChronicleSinkTest, UnopenableSinkDropsSilently) {
  setenv("CHRONICLE_LOG", "/nonexistent-dir/x/trace.log", 1);
  Chronicle c;
  errno = 1234;
  EXPECT_EQ(traceOnce(c, "lost"), -1);
  EXPECT_EQ(errno, 1234);
  unsetenv("CHRONICLE_LOG");
}

}  // namespace
