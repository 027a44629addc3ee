#include "devices/charging/ButtonCharger.h"

#include <exception>

#include "core/game/DallasId.h"

namespace {

/// Family of the reader's own identity device.
constexpr std::uint8_t ReaderFamily = 0x81;

/// A block that was not read well is read again up to twice.
constexpr int MostReadings = 3;

/// A button that leaves while it is read gives ones from then on, and one such block in 256 has the right
/// check byte.
bool MayBeCutShort(const ChargeBlock& block) {
  return block.back() == 0xFF;
}

}  // namespace

void ButtonCharger::Tick() {
  try {
    const bool began = poll_.Begin();
    if (began) {
      parts_.Display.SetReader(true);
      Step();
    } else if (MissReader() && !parts_.Display.Closing()) {
      parts_.Boxes.Show("Error loading button driver", "Button Error", BoxIcon::None);
    }
    poll_.End();
    readerMissing_ = !began;  // not before: a driver may begin each session and then fail
  } catch (const std::exception&) {
    poll_.EndFailed();
    if (MissReader()) {
      throw;
    }
  }
}

bool ButtonCharger::MissReader() {
  const bool first = !readerMissing_;
  readerMissing_ = true;
  parts_.Display.SetReader(false);
  return first;
}

void ButtonCharger::Step() {
  switch (poll_.Next()) {
    case BusStep::End:
      if (deviceCount_ == 1) {
        parts_.Display.SetStatus({});
        lastRom_ = {};
      }
      if (!metButton_) {
        parts_.Display.ButtonsLeft();
      }
      deviceCount_ = 0;
      metButton_ = false;
      break;
    case BusStep::BadRead:
      deviceCount_ = 0;
      metButton_ = false;
      break;
    case BusStep::Device:
      ++deviceCount_;
      TakeDevice();
      break;
  }
}

void ButtonCharger::TakeDevice() {
  currentRom_ = poll_.Rom();
  if (currentRom_.front() == ReaderFamily) {
    return;
  }
  metButton_ = true;
  if (currentRom_ == lastRom_) {
    return;
  }
  parts_.Display.SetStatus({});
  if (ChargeButton()) {
    lastRom_ = currentRom_;
  }
}

bool ButtonCharger::ChargeButton() {
  ChargeBlock block{};
  const Reading reading = ReadWell(block);
  if (parts_.Display.Closing()) {
    return false;
  }
  if (reading == Reading::Failed) {
    Note(ChargeResult::NotRead);
    return false;
  }
  parts_.Display.BeginButton();
  if (reading == Reading::Invalid) {
    const BoxAnswer answer =
        parts_.Boxes.Show("Was this an Ammo Mag iButton?", "iButton Invalid - Recovering",
                          BoxIcon::Exclamation, BoxButtons::YesNo);
    if (parts_.Display.Closing()) {
      return false;
    }
    Recover(block, answer == BoxAnswer::Yes);
  }
  if (!Charge(block)) {
    Note(ChargeResult::Unknown, block[0]);
    return true;
  }
  memory_.WriteBlock(block);
  parts_.Display.SetStatus(block[0] == ButtonKind::AmmoMag ? "Charged Mag OK" : "Charged Bandage OK");
  Note(ReadBack(block), block[0]);
  return true;
}

// A button that has left reads as ones, which no driver can tell from an invalid block while another device
// is on the bus: so it is looked for before it is judged.
ButtonCharger::Reading ButtonCharger::ReadWell(ChargeBlock& block) {
  bool read = false;
  for (int i = 0; i < MostReadings; ++i) {
    const ChargeBlock before = block;
    const bool wasRead = read;
    read = memory_.ReadBlock(block);
    const bool confirmed = !MayBeCutShort(block) || (wasRead && block == before);
    if (read && CheckHolds(block) && confirmed) {
      return Reading::Good;
    }
  }
  if (!read || !poll_.IsOnBus(currentRom_)) {
    return Reading::Failed;
  }
  return CheckHolds(block) ? Reading::Good : Reading::Invalid;
}

ChargeResult ButtonCharger::ReadBack(const ChargeBlock& written) {
  ChargeBlock block{};
  bool read = false;
  for (int i = 0; i < MostReadings; ++i) {
    read = memory_.ReadBlock(block);
    if (read && block == written) {
      return ChargeResult::Charged;
    }
  }
  return read && poll_.IsOnBus(currentRom_) ? ChargeResult::Different : ChargeResult::NotReadBack;
}

void ButtonCharger::Note(ChargeResult result, std::optional<std::uint8_t> kind) {
  const std::string time = parts_.Time.Now();
  parts_.Display.Note({time.substr(time.find(' ') + 1), kind, DallasIdOf(currentRom_), result});
}
