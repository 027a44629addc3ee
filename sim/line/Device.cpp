#include "sim/line/Device.h"

#include <utility>

namespace sim {

Device::Device(DeviceLine line)
    : line_(std::move(line.Understood), line.LinePace), log_(line.Log, std::move(line.LogName)) {
  line_.OnForeignBytes([this](const LineSettings& host, std::span<const std::uint8_t> bytes, bool begin) {
    NoteForeignBytes(host, bytes, begin);
  });
}

bool Device::WaitUntilHostFaults(std::size_t count, std::chrono::milliseconds limit) const {
  return faults_.WaitUntil(limit, [&](const auto& faults) { return faults.size() >= count; });
}

void Device::NoteHostFault(std::string fault) {
  faults_.Note([&](auto& faults) { faults.push_back(std::move(fault)); });
}

void Device::NoteForeignBytes(const LineSettings& host, std::span<const std::uint8_t> bytes, bool begin) {
  const std::string fault = "the host speaks " + Text(host) + " instead of " + Text(line_.Understood());
  log_.FromHost(bytes, "fault: " + fault);
  if (begin) {
    NoteHostFault(fault);
  }
}

Device::Serving::Serving(Device& device, std::function<void()> conversation)
    : line_(device.line_), thread_(std::move(conversation)) {}

Device::Serving::~Serving() {
  line_.Interrupt();
  thread_.join();
}

}  // namespace sim
