#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "platform/linux/InstanceLine.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

/// A line as another start of the program may send it.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string line(data, data + size);
  const std::optional<InstanceRequest> request = ReadInstanceLine(line);
  if (request) {
    Require(request->Path.empty() || request->Path.front() == '/');
    Require(InstanceLine(*request) == line + '\n');
  }
  return 0;
}
