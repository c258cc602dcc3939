#include "output_stream.h"

namespace dorvex {
namespace {
FILE* g_out = nullptr;
}  // namespace

FILE* outStream() { return g_out != nullptr ? g_out : stdout; }

void setOutStream(FILE* stream) { g_out = stream; }

}  // namespace dorvex
