// Fixtures for the database tests: a temporary data directory, the trace log, and records.
#ifndef TESTS_VPDDB_VPD_TEST_UTIL_H_
#define TESTS_VPDDB_VPD_TEST_UTIL_H_

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "test_support.h"
#include "vpdDB.h"

namespace vpdtest {

// One line of the trace log, split into its eight fields.
struct TraceRecord {
  std::string level, component, operation, location, source, host, message;
};

// Each test gets a data directory and its own trace log.
class VpdTest : public ::testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  std::string dataDir() const { return tmp_ / "data"; }
  std::string table(const char* name) const { return dataDir() + "/" + name; }
  std::vector<TraceRecord> traces() const;
  // Messages of the traces written since the last call, as "LEVEL|OPERATION|MESSAGE".
  std::vector<std::string> takeTraces();
  // Creates the three tables with the given bytes.
  void writeTables(const std::string& chassis, const std::string& bpa, const std::string& sma);

  testsupport::TempDir tmp_;
  std::string log_;
  std::size_t traces_seen_ = 0;
};

smaVPD makeSma(unsigned frame, unsigned cage, unsigned chip, const char* pn = "SMA-PN",
               const char* tm = "7040-681", const char* se = "10ABCDE");
chassisVPD makeChassis(unsigned frame, unsigned cage, const char* tm = "7045-SW4",
                       const char* se = "20SWTCH", unsigned network = 1);
bpaVPD makeBpa(unsigned frame, unsigned cage, const char* tm = "9458-100",
               const char* se = "02A1B2C", unsigned network = 1);

// The bytes of a record as they lie in memory.
template <class Record>
std::string bytesOf(const Record& r) {
  return std::string(reinterpret_cast<const char*>(&r), sizeof r);
}

}  // namespace vpdtest

#endif  // TESTS_VPDDB_VPD_TEST_UTIL_H_
