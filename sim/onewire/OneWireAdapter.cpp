#include "sim/onewire/OneWireAdapter.h"

#include <algorithm>
#include <array>
#include <stdexcept>
#include <utility>

namespace sim {
namespace {

constexpr int PowerUpBaud = 9600;
constexpr std::uint8_t IdentityFamily = 0x81;
constexpr std::uint64_t IdentitySerial = 0x0000001E5A37;

OneWireAdapterSettings Checked(OneWireAdapterSettings settings) {
  for (const OneWireFailureInfo& info : OneWireFailures) {
    const bool isBit = info.Place == FailurePlace::Bit;
    if (info.Failure == settings.Failure && info.Place != FailurePlace::None &&
        (settings.FailurePlace == 0 || (isBit && settings.FailurePlace > 64))) {
      throw std::invalid_argument("There is no " + std::string(isBit ? "bit " : "byte ") +
                                  std::to_string(settings.FailurePlace));
    }
  }
  return settings;
}

MemoryTroubleSettings TroubleOf(const OneWireAdapterSettings& settings) {
  using Kind = MemoryTroubleSettings::Kind;
  constexpr std::array<std::pair<OneWireFailure, Kind>, 6> kinds{{
      {OneWireFailure::RemovedInRead, Kind::RemovedInRead},
      {OneWireFailure::RemovedInWrite, Kind::RemovedInWrite},
      {OneWireFailure::TornCopy, Kind::TornCopy},
      {OneWireFailure::DisturbedRead, Kind::DisturbedRead},
      {OneWireFailure::DisturbedWrite, Kind::DisturbedWrite},
      {OneWireFailure::WriteProtected, Kind::WriteProtected},
  }};
  const auto* found = std::find_if(kinds.begin(), kinds.end(),
                                   [&](const auto& kind) { return kind.first == settings.Failure; });
  return {.What = found == kinds.end() ? Kind::None : found->second, .Place = settings.FailurePlace};
}

OneWireBusSettings BusOf(const OneWireAdapterSettings& settings,
                         std::function<void(const std::string&)> tell) {
  OneWireBusSettings bus;
  bus.Trouble = TroubleOf(settings);
  bus.Tell = std::move(tell);
  if (settings.Failure != OneWireFailure::NoOwnDevice) {
    bus.OwnDevice = MakeRomId(IdentityFamily, IdentitySerial);
  }
  bus.Shorted = settings.Failure == OneWireFailure::ShortCircuit;
  if (settings.Failure == OneWireFailure::ContactLost) {
    bus.ContactLostAfterBits = settings.FailurePlace;
  }
  return bus;
}

// A button of the same family whose serial number differs in one bit, as in a box of new ones.
RomId CompanionOf(const RomId& rom) {
  std::uint64_t serial = 0;
  for (std::size_t i = 6; i > 0; --i) {
    serial = serial << 8U | rom[i];
  }
  return MakeRomId(rom[0], serial ^ 1U);
}

}  // namespace

OneWireAdapter::OneWireAdapter(OneWireAdapterSettings settings)
    : Device({.LogName = "1-wire",
              .Understood = {{.Baud = PowerUpBaud}},
              .LinePace = settings.LinePace,
              .Log = settings.Log}),
      settings_(Checked(settings)),
      bus_(BusOf(settings_, [this](const std::string& what) { Log().Note(what); })),
      chip_(bus_) {}

void OneWireAdapter::Touch(const RomId& rom) {
  const std::scoped_lock lock(busMutex_);
  for (const RomId& device : OnTheBus(rom)) {
    bus_.Touch(device);
  }
}

bool OneWireAdapter::Leave(const RomId& rom) {
  const std::scoped_lock lock(busMutex_);
  bool left = false;
  for (const RomId& device : OnTheBus(rom)) {
    left = bus_.Leave(device) || left;
  }
  return left;
}

void OneWireAdapter::LeaveAll() {
  const std::scoped_lock lock(busMutex_);
  bus_.LeaveAll();
}

void OneWireAdapter::Fill(const RomId& rom, ButtonContent content) {
  const std::scoped_lock lock(busMutex_);
  const ChargeBlock block = MakeChargeBlock(content, rom);
  std::copy(block.begin(), block.end(), BlockIn(rom).begin());
}

ChargeBlock OneWireAdapter::BlockOf(const RomId& rom) {
  const std::scoped_lock lock(busMutex_);
  const std::span<const std::uint8_t> bytes = BlockIn(rom);
  ChargeBlock block{};
  std::copy(bytes.begin(), bytes.end(), block.begin());
  return block;
}

std::span<std::uint8_t> OneWireAdapter::BlockIn(const RomId& rom) {
  MemoryButton* memory = bus_.MemoryOf(rom);
  if (memory == nullptr) {
    throw std::invalid_argument("A button of another family than 06 and 08 has no memory: " + RomIdText(rom));
  }
  return std::span(memory->Memory()).subspan(ChargeBlockAddress, ChargeBlock().size());
}

void OneWireAdapter::Run() {
  while (const std::optional<std::uint8_t> byte = Line().ReadByte()) {
    Log().FromHost(*byte);
    const std::optional<std::uint8_t> answer = AnswerTo(*byte);
    if (chip_.Baud() != Line().Current().Baud) {
      Line().SetBaud(chip_.Baud());
    }
    if (answer && !Send(*answer)) {
      break;
    }
  }
}

std::optional<std::uint8_t> OneWireAdapter::AnswerTo(std::uint8_t byte) {
  const bool configures = chip_.ExpectsCommand() && byte < 0x80;
  const std::scoped_lock lock(busMutex_);
  const std::optional<std::uint8_t> answer = chip_.Receive(byte);
  return configures && Fails(OneWireFailure::NoDetection) ? std::nullopt : answer;
}

// False when the line is gone.
bool OneWireAdapter::Send(std::uint8_t answer) {
  constexpr std::uint8_t noise = 0xF8;
  ++answers_;
  if (Fails(OneWireFailure::Silence) && answers_ >= settings_.FailurePlace) {
    return true;
  }
  if (Fails(OneWireFailure::HangUp) && answers_ == settings_.FailurePlace) {
    Log().Note("adapter pulled out");
    Line().HangUp();
    return false;
  }
  std::vector<std::uint8_t> bytes{answer};
  if (Fails(OneWireFailure::NoiseByte) && answers_ == settings_.FailurePlace) {
    bytes.insert(bytes.begin(), noise);
  }
  const std::size_t sent = Fails(OneWireFailure::TornWrites) ? Line().WriteTorn(bytes) : Line().Write(bytes);
  Log().ToHost(bytes);
  return sent == bytes.size();
}

// The buttons on the bus while `rom` is held to the reader.
std::vector<RomId> OneWireAdapter::OnTheBus(const RomId& rom) const {
  if (Fails(OneWireFailure::WrongCrc)) {
    RomId wrong = rom;
    wrong[7] ^= 0x80U;
    return {wrong};
  }
  if (Fails(OneWireFailure::TwoButtons)) {
    return {rom, CompanionOf(rom)};
  }
  return {rom};
}

}  // namespace sim
