// Runs a program with a time limit: a run that has not ended when the limit passes is
// killed (with everything it started) and reported as hung.
#ifndef TESTS_HARDENING_BOUNDED_RUN_H_
#define TESTS_HARDENING_BOUNDED_RUN_H_

#include <map>
#include <string>
#include <vector>

namespace hardening {

struct BoundedResult {
  int status = -1;         // exit status, or 128 + signal number
  bool timed_out = false;  // killed at the limit
  std::string out, err;
};

// argv[0] is the program's path. The environment is this process's with `env` applied.
// Standard input is /dev/null.
BoundedResult runBounded(const std::vector<std::string>& argv,
                         const std::map<std::string, std::string>& env, int limit_seconds);

}  // namespace hardening

#endif  // TESTS_HARDENING_BOUNDED_RUN_H_
