#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "firmware/hex/ImagePadding.h"
#include "platform/RuntimeError.h"
#include "tests/fakes/FakeFiles.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

/// The input is the text of a program image.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FakeFiles files;
  const std::string before(data, data + size);
  files.Put("/image", before);
  try {
    PadProgramImage(files, "/image");
  } catch (const RuntimeError& error) {
    Require(error.Number() == 9 || error.Number() == 13 || error.Number() == 62);
    Require(files.Read("/image") == before);
    return 0;
  }
  const std::string after = files.Read("/image");
  Require(std::count(after.begin(), after.end(), '\n') % 16 == 0);
  return 0;
}
