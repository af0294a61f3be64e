// The test program's output in bytes as written: the C runtime would end each line
// with CR LF, and CTest would take the CR into the test names it lists.
#include <fcntl.h>
#include <io.h>
#include <stdio.h>

namespace {

const int kBinaryOutput = _setmode(_fileno(stdout), _O_BINARY);

} // namespace
