#include "tests/soak/operator/Field.h"

#include <array>
#include <fstream>

#include "core/data/IniReader.h"
#include "platform/linux/LinuxFiles.h"
#include "sim/baseunit/BaseUnit.h"
#include "sim/game/GameMaker.h"
#include "sim/radio/RadioModem.h"

namespace {

constexpr int InstrumentPort = 1;
constexpr int ReaderPort = 2;
/// All ports of the settings are named, so that no device of this machine is ever one of them.
constexpr int NamedPorts = 64;

std::filesystem::path LinkOf(const std::filesystem::path& folder, int port) {
  return folder / ("port" + std::to_string(port));
}

}  // namespace

Field::Field(std::filesystem::path folder, unsigned seed)
    : folder_(std::move(folder)), random_(seed), turn_(seed) {
  std::ofstream settings(folder_ / "tessarine.ini", std::ios::app);
  settings << "[ports]\n";
  for (int port = 1; port <= NamedPorts; ++port) {
    settings << "com" << port << "=" << LinkOf(folder_, port).string() << "\n";
  }
  settings << "[onewire]\nport=" << ReaderPort << "\ntype=5\n";
}

std::string Field::Change() {
  instrumentLink_.reset();
  readerLink_.reset();
  instrument_.reset();
  reader_.reset();
  touched_ = false;
  ChooseDevices();  // the operator may have chosen another port meanwhile

  std::string name;
  instrument_ = NextInstrument(name);
  instrumentLink_ =
      std::make_unique<sim::DeviceLink>(LinkOf(folder_, InstrumentPort), instrument_->DevicePath());
  const sim::OneWireFailureInfo& failure = sim::OneWireFailures[turn_ % sim::OneWireFailures.size()];
  reader_ = std::make_unique<sim::OneWireAdapter>(
      sim::OneWireAdapterSettings{.Failure = failure.Failure, .FailurePlace = 1 + random_() % 40});
  readerLink_ = std::make_unique<sim::DeviceLink>(LinkOf(folder_, ReaderPort), reader_->DevicePath());
  ++turn_;
  return name + ", reader " + std::string(failure.Name);
}

void Field::ChooseDevices() {
  LinuxFiles files;
  IniReader settings(files, folder_ / "tessarine.ini");
  settings.WriteIni("comm", "commport", std::to_string(InstrumentPort));
}

std::unique_ptr<sim::Device> Field::NextInstrument(std::string& name) {
  const int players = static_cast<int>(random_() % 13);
  const std::vector<sim::GunScores> game = sim::MakeGame(players + 2, static_cast<std::uint32_t>(random_()));
  const sim::Pace pace = random_() % 2 == 0 ? sim::Pace::AsWired : sim::Pace::Fast;
  const std::size_t index = turn_ % (sim::BaseUnitFailures.size() + sim::RadioFailures.size());
  if (index < sim::BaseUnitFailures.size()) {
    const sim::BaseUnitFailureInfo& failure = sim::BaseUnitFailures[index];
    name = "base unit " + std::string(failure.Name);
    return std::make_unique<sim::BaseUnit>(sim::BaseUnitSettings{
        .Answer = sim::MakeBaseUnitAnswer(game, failure.Failure, 1 + random_() % 2), .LinePace = pace});
  }
  const sim::RadioFailureInfo& failure = sim::RadioFailures[index - sim::BaseUnitFailures.size()];
  name = "radio " + std::string(failure.Name);
  return std::make_unique<sim::RadioModem>(sim::RadioModemSettings{
      .Guns = sim::MakeRadioGuns(game),
      .Trouble = {.Failure = failure.Failure, .Gun = random_() % 3, .Times = static_cast<int>(random_() % 3)},
      .LinePace = pace});
}

void Field::TouchOrLeave() {
  constexpr std::uint8_t identityButton = 0x01;
  if (!reader_) {
    return;
  }
  if (touched_) {
    reader_->LeaveAll();
  } else {
    reader_->Touch(sim::MakeRomId(identityButton, random_() % 8));
  }
  touched_ = !touched_;
}
