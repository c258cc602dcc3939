// The stream every writer of dorvex writes to: standard output, unless a test points the
// writers elsewhere. Lines are not flushed one by one; main flushes before the process ends.
#ifndef DORVEX_OUTPUT_STREAM_H_
#define DORVEX_OUTPUT_STREAM_H_

#include <cstdio>
#include <string>

namespace dorvex {

// The current output stream (stdout by default). Not owned.
FILE* outStream();
// Points the writers at `stream`; nullptr goes back to stdout. The caller keeps ownership.
void setOutStream(FILE* stream);

// Writes the text as it stands (it may hold any byte but NUL) followed by a newline.
inline void writeLine(const std::string& text) {
  FILE* out = outStream();
  std::fwrite(text.data(), 1, text.size(), out);
  std::fputc('\n', out);
}

}  // namespace dorvex

#endif  // DORVEX_OUTPUT_STREAM_H_
