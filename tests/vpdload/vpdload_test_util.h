// Running the built vpdload against a temporary data directory, and looking at what it left.
#ifndef TESTS_VPDLOAD_VPDLOAD_TEST_UTIL_H_
#define TESTS_VPDLOAD_VPDLOAD_TEST_UTIL_H_

#include <gtest/gtest.h>
#include <sys/types.h>

#include <map>
#include <string>
#include <vector>

#include "test_support.h"

namespace vpdloadtest {

// Path of the built vpdload.
const char* vpdloadPath();

// Runs vpdload with the arguments. Trace records of the database go to a file in /tmp
// that nobody reads, so that a test never fills the system log.
testsupport::RunResult vpdload(const std::vector<std::string>& args,
                               const std::string* input = nullptr,
                               std::map<std::string, std::string> env = {});

// import FILE --data DIR, with the inventory text written to FILE first.
testsupport::RunResult importText(const std::string& data_dir, const std::string& json,
                                  const std::string& scratch_file);

// Every entry of a directory, hidden ones included: regular files as name -> bytes,
// folders as name + "/" -> "". For "nothing changed" comparisons.
std::map<std::string, std::string> snapshot(const std::string& dir);

// Compares two sets of files (as snapshot() and tables() give them) and names the files
// that differ with their sizes, instead of printing kilobytes of table bytes.
testing::AssertionResult sameFiles(const std::map<std::string, std::string>& actual,
                                   const std::map<std::string, std::string>& expected);

// The three table files of a directory, as name -> bytes ("" when missing).
std::map<std::string, std::string> tables(const std::string& dir);
std::map<std::string, std::string> oldTables(const std::string& dir);

// An inventory with `sma` SMA records (frame 1.., cage, chip), `chassis` switch chassis in
// frame 1 and `bpa` BPAs; `tag` (at most 4 characters) goes into every serial number so that
// two inventories of the same shape differ in every record.
std::string makeInventory(int sma, int chassis, int bpa, const std::string& tag);

// Starts a program with output discarded and returns its process id, without waiting.
pid_t spawnQuiet(const std::vector<std::string>& argv);
// Waits for a child; exit status, or 128 + signal number.
int waitChild(pid_t pid);

// Names in `dir` that begin with ".vpdload." and are folders: staging folders left behind.
std::vector<std::string> stagingLeftovers(const std::string& dir);

}  // namespace vpdloadtest

#endif  // TESTS_VPDLOAD_VPDLOAD_TEST_UTIL_H_
