// Helpers shared by the test suite: temporary folders, files, and running a built program.
#ifndef TESTS_SUPPORT_TEST_SUPPORT_H_
#define TESTS_SUPPORT_TEST_SUPPORT_H_

#include <map>
#include <string>
#include <vector>

namespace testsupport {

// A fresh folder under $TMPDIR (or /tmp), removed with everything in it on destruction.
class TempDir {
 public:
  TempDir();
  ~TempDir();
  TempDir(const TempDir&) = delete;
  TempDir& operator=(const TempDir&) = delete;
  const std::string& path() const { return path_; }
  // path() + "/" + relative
  std::string operator/(const std::string& relative) const { return path_ + "/" + relative; }

 private:
  std::string path_;
};

// Whole-file helpers; they fail the current test (ADD_FAILURE) on an I/O error.
std::string readFile(const std::string& path);
void writeFile(const std::string& path, const std::string& bytes, int mode = 0644);
bool fileExists(const std::string& path);
// Creates the folder and its parents.
void makeDirs(const std::string& path);
long fileSize(const std::string& path);

// What a finished child process left.
struct RunResult {
  int status = -1;  // exit status, or 128 + signal number
  std::string out;  // everything written to standard output
  std::string err;  // everything written to standard error
};

// Runs argv[0] (a path) with the arguments, standard input from /dev/null unless `input`
// is given, and the environment of this process changed by `env` (a value of
// "\x01unset" removes the variable). Waits for the child.
RunResult run(const std::vector<std::string>& argv,
              const std::map<std::string, std::string>& env = {},
              const std::string* input = nullptr);

// Splits text into lines without their newlines.
std::vector<std::string> lines(const std::string& text);

}  // namespace testsupport

#endif  // TESTS_SUPPORT_TEST_SUPPORT_H_
