// The command line of dorvex: options "y:f:c:r:t:h:p:a:m:n:", each with a value.
#ifndef DORVEX_OPTIONS_H_
#define DORVEX_OPTIONS_H_

#include <cstdio>

namespace dorvex {

// What the command line asks for.
enum class CommandLine {
  kRequest,      // the settings are read; processFlags decides the rest
  kTooFewWords,  // fewer than two words after the program name: nothing is read
  kHelp,         // "--help" as the only argument
  kVersion,      // "--version" as the only argument
};

// Reads the options into the settings (settings.h). An unknown option or a missing value
// writes the line "0" to the output stream and parsing goes on; getopt's own diagnostic
// goes to standard error. Words that are not options are passed over. Can be called more
// than once in a process: getopt is restarted each time.
CommandLine parseCommandLine(int argc, char** argv);

// Prints nothing and returns 0: the value written on the line of an unknown option.
int usage();

// The text of --help and of --version.
void printHelp(FILE* out);
void printVersion(FILE* out);

// The code of the first keyword of `keywords` (a null-terminated list, codes in `codes`)
// that `value` begins with; `current` when it begins with none.
int keywordCode(const char* value, const char* const* keywords, const int* codes, int current);

// strtol base 10, truncated to int: leading blanks and a sign accepted, stops at the first
// non-digit, 0 without digits, never an error.
int decimalValue(const char* text);

}  // namespace dorvex

#endif  // DORVEX_OPTIONS_H_
