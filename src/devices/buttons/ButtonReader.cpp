#include "devices/buttons/ButtonReader.h"

#include <exception>

namespace {

/// Family of the reader's own identity device, which is never a member's button.
constexpr std::uint8_t ReaderFamily = 0x81;

}  // namespace

void ButtonReader::Activate() {
  finished_ = false;
  dallasId_ = NoDallasId;
}

bool ButtonReader::Tick() {
  try {
    Poll();
  } catch (const std::exception&) {
    finished_ = true;
    poll_.EndFailed();
    boxes_.Show("Error loading membership driver. Please ensure it has been installed.", "Driver Error",
                BoxIcon::Exclamation);
  }
  return !finished_;
}

void ButtonReader::Poll() {
  if (!poll_.Begin()) {
    boxes_.Show("Error loading Membership button driver", "Memberbership Error", BoxIcon::Exclamation);
    finished_ = true;
  } else if (poll_.Next() == BusStep::Device) {
    TakeDevice();
  }
  poll_.End();
}

void ButtonReader::TakeDevice() {
  const auto rom = poll_.Rom();
  if (rom.front() == ReaderFamily) {
    return;
  }
  dallasId_ = DallasIdOf(rom);
  finished_ = true;
  boxes_.Show("Membership button read sucessfully, code = " + dallasId_, "Membership Button Status",
              BoxIcon::Information);
}
