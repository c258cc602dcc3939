// A check inside a fuzz target: a failed one prints what broke and aborts, which libFuzzer
// (and the replay driver) report as a crash with the input that caused it.
#ifndef TESTS_FUZZ_FUZZ_CHECK_H_
#define TESTS_FUZZ_FUZZ_CHECK_H_

#include <cstdio>
#include <cstdlib>

#define FUZZ_CHECK(cond)                                                            \
  do {                                                                              \
    if (!(cond)) {                                                                  \
      std::fprintf(stderr, "%s:%d: check failed: %s\n", __FILE__, __LINE__, #cond); \
      std::abort();                                                                 \
    }                                                                               \
  } while (0)

#endif  // TESTS_FUZZ_FUZZ_CHECK_H_
