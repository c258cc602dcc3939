// The stream every writer of dorvex writes to: standard output, unless a test points the
// writers elsewhere. Lines are not flushed one by one; main flushes before the process ends.
//
// Writers put a line together piece by piece straight into the stream, without building
// it in a string first. dorvex writes from one thread, so the pieces skip the stream's lock.
#ifndef DORVEX_OUTPUT_STREAM_H_
#define DORVEX_OUTPUT_STREAM_H_

#include <cstdio>
#include <cstring>
#include <string>

namespace dorvex {

// The current output stream (stdout by default). Not owned.
FILE* outStream();
// Points the writers at `stream`; nullptr goes back to stdout. The caller keeps ownership.
void setOutStream(FILE* stream);

// The pieces are short (a field, a keyword, a riser number), so they go into the stream's
// buffer byte by byte: putc_unlocked is an inline store there, where a call of fwrite or
// fputs would cost more than the copy.
inline void putChar(FILE* out, char c) { putc_unlocked(c, out); }
inline void putBytes(FILE* out, const char* bytes, std::size_t n) {
  for (std::size_t i = 0; i < n; ++i) putc_unlocked(bytes[i], out);
}
// A NUL-terminated text.
inline void putText(FILE* out, const char* text) {
  for (; *text != '\0'; ++text) putc_unlocked(*text, out);
}

// The text of a fixed-width field of a record: its bytes up to the first NUL, never more
// than `significant`, so a field without a terminator is safe. Every field a writer shows
// goes through here.
inline void putField(FILE* out, const char* field, std::size_t significant) {
  for (std::size_t i = 0; i < significant && field[i] != '\0'; ++i) putc_unlocked(field[i], out);
}

// Writes the text as it stands (it may hold any byte but NUL) followed by a newline.
inline void writeLine(const std::string& text) {
  FILE* out = outStream();
  putBytes(out, text.data(), text.size());
  putChar(out, '\n');
}

}  // namespace dorvex

#endif  // DORVEX_OUTPUT_STREAM_H_
