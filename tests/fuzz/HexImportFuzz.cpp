#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "firmware/hex/ImageComparison.h"
#include "platform/RuntimeError.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

/// The input is a HEX file that is imported and compared.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FakeFiles files;
  FakeMessageBoxes boxes;
  const ImagePaths images{"/p", "/e", "/c"};
  files.Put("/hex", std::string(data, data + size));
  try {
    const std::int16_t code = ImportHexFile(files, boxes, "/hex", images);
    Require(boxes.Boxes.size() == (code < 0 ? 1U : 0U));
    Require(files.FileExists(images.ProgMem) == (code == 1));
    if (code != 1) {
      return 0;
    }
  } catch (const RuntimeError&) {
    Require(files.Contents().size() == 1);  // no image is left
    return 0;
  }
  const std::string program = files.Read(images.ProgMem);
  Require(std::count(program.begin(), program.end(), '\n') % 16 == 0);
  std::uint64_t end = 0;
  for (const LostStretch& stretch : CompareImages(files, "/hex", images)) {
    Require(stretch.Count > 0 && stretch.Address >= end);
    end = std::uint64_t{stretch.Address} + stretch.Count;
    Require(end <= std::uint64_t{1} << 32U);
  }
  return 0;
}
