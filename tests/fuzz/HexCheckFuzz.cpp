#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "firmware/hex/HexCheck.h"
#include "firmware/hex/HexImage.h"
#include "platform/RuntimeError.h"
#include "tests/fakes/FakeMessageBoxes.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

/// The input is a HEX file, for the check and for the reader of images, which makes none.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string text(data, data + size);
  const std::int16_t code = CheckHexText(text);
  Require(code == 1 || code == -1 || code == -3 || code == -4 || code == -5 || code == -6);
  Require((code == -1) == text.empty());
  if (code == HexCode::Good) {
    // What stands behind the end record is not looked at.
    Require(CheckHexText(text + "\n#") == HexCode::Good);
  }

  FirmwareImage image;
  FakeMessageBoxes boxes;
  try {
    const bool loaded = LoadHexImage(text, image, boxes);
    Require(boxes.Boxes.size() == (loaded ? 0U : 1U));
    Require(!loaded || (image.PageCount > 0 && image.RowCount > 0));
  } catch (const RuntimeError& error) {
    Require(error.Number() == 6 || error.Number() == 9);
  }
  return 0;
}
