#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <string>

#include "core/text/StringTable.h"
#include "firmware/files/CrLfLines.h"
#include "firmware/files/FirmwareDescription.h"
#include "firmware/files/FirmwareImage.h"
#include "firmware/files/QvmLines.h"
#include "platform/RuntimeError.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

/// A good file can be loaded after any other.
void RequireLoadable(FirmwareImage& image) {
  Require(image.LoadQvm2File("1\r\n8\r\n0a0B\r\n"));
  Require(image.PageCount == 2 && image.RowCount == 2 && image.BytesLoaded == 2);
  Require(image.ImageBuffer[0] == 10 && image.ImageBuffer[1] == 11 && image.ImageBuffer[2] == 255);
}

void LoadQvm2(const std::string& bytes) {
  static const auto image = std::make_unique<FirmwareImage>();
  try {
    Require(image->LoadQvm2File(bytes));
    Require(image->PageUsed[0] && image->RowUsed[0]);
    Require(image->PageCount >= 1 && image->PageCount <= 512);
    Require(image->RowCount >= 1 && image->RowCount <= 4096);
    Require(image->BytesLoaded <= image->ImageBuffer.size() && 2 * image->BytesLoaded <= bytes.size());
    for (std::size_t at = image->BytesLoaded; at + 1 < image->ImageBuffer.size(); at += 97) {
      Require(image->ImageBuffer[at] == 255);
    }
  } catch (const RuntimeError& error) {
    Require(error.Number() == 6 || error.Number() == 9 || error.Number() == 62);
  }
  RequireLoadable(*image);
}

/// Both readers agree on what the data lines are.
void LoadQvm(const std::string& bytes) {
  const QvmLines file(bytes);
  std::size_t next = 0;
  CrLfLines lines(bytes);
  while (const auto line = lines.Next()) {
    if (QvmLines::IsData(*line)) {
      Require(next < file.BufferLines().size() && file.BufferLines()[next++] == *line);
    }
  }
  Require(next == file.BufferLines().size());
  Require(Describe("a.qvm", bytes).Lines == next);
}

}  // namespace

/// Whatever the bytes, a file loads or fails with a known number, and is described.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const StringTable strings(Language::English);
  const std::string bytes(data, data + size);
  LoadQvm(bytes);
  LoadQvm2(bytes);
  for (const char* name : {"a.qvm", "a.qvm2", "a.QVM"}) {
    Require(!DescriptionText(Describe(name, bytes), strings).empty());
  }
  return 0;
}
