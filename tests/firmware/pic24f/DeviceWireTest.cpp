#include <gmock/gmock.h>

#include <algorithm>
#include <numeric>
#include <optional>

#include "firmware/pic24f/tool/DeviceSession.h"
#include "platform/RuntimeError.h"
#include "tests/firmware/pic24f/WireSite.h"

// The commands of tessarine-pic24f on a real line with a simulated boot loader at its end.

namespace {

using sim::Pic24fFailure;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr std::int32_t LineLost = -999;

class DeviceOnTheWire : public testing::Test, protected WireSite {
 protected:
  DeviceOnTheWire() { WriteFile(Folder / "new.hex", Records(0, program) + HexFile::End()); }

  void Plug(const sim::Pic24fLoaderSettings& settings) { loader.emplace(settings); }

  /// Runs a command; its code.
  std::int32_t Run(std::vector<std::string> words) {
    words.insert(words.end(), {"--port", loader->DevicePath()});
    const ToolOptions options = ParseToolOptions(words);
    testing::internal::CaptureStderr();
    std::int32_t code = LineLost;
    DeviceSession session(parts, options);
    try {
      code = session.Run();
    } catch (const RuntimeError& error) {
      EXPECT_EQ(error.Number(), 8012);
    }
    session.TellState(code);
    said = testing::internal::GetCapturedStderr();
    return code;
  }
  std::int32_t Write() { return Run({"write", Folder / "new.hex"}); }

  const Bytes& Held() {
    traffic = loader->Traffic();
    return traffic.Memory.Program();
  }

  /// What the device holds after its first rows were written.
  Bytes HoldingRows(std::size_t rows) const {
    return Holding(22'016, {{0, Bytes(program.begin(), program.begin() + static_cast<int>(256 * rows))}});
  }

  const Bytes program = ProgramBytes(0, 0x300);
  const StringTable strings{Language::English};
  const DeviceSession::Parts parts{.Tool = {Disk, strings},
                                   .Line = Port,
                                   .Events = Events,
                                   .Folder = {Folder.Path(), Folder.Path()},
                                   .DeviceOf = [](const std::string& name) { return name; },
                                   .StopRequests = [] { return 0; }};
  std::optional<sim::Pic24fLoader> loader;
  sim::Pic24fTraffic traffic;
  std::string said;
};

struct ListedDevice {
  std::uint16_t Identity;
  std::uint32_t Instructions;
};

class ListedDeviceOnTheWire : public DeviceOnTheWire, public testing::WithParamInterface<ListedDevice> {};

TEST_P(ListedDeviceOnTheWire, HoldsTheFileAfterwards) {
  const std::uint32_t instructions = GetParam().Instructions;
  Plug({.Device = {.Identity = GetParam().Identity, .Instructions = instructions},
        .LinePace = sim::Pace::Fast});
  const Bytes start = ProgramBytes(0, 0x800);
  const std::uint32_t last = instructions * 4 - 0x400;
  const Bytes end = ProgramBytes(last, 0x400);
  const std::string file = Folder / "whole.hex";
  WriteFile(file, Records(0, start) + Records(last, end) + HexFile::End());
  EXPECT_EQ(Run({"identify"}), GetParam().Identity);
  EXPECT_EQ(Run({"verify", file}), -101);
  EXPECT_EQ(Run({"erase"}), 1);
  EXPECT_EQ(Run({"write", file}), 1);
  EXPECT_EQ(said, "");
  EXPECT_EQ(Held(), Holding(instructions, {{0, start}, {last, end}}));
  EXPECT_TRUE(traffic.IsVerified);
  EXPECT_EQ(Run({"verify", file}), 1);
  EXPECT_EQ(Run({"erase"}), 1);
  EXPECT_EQ(Held(), Holding(instructions, {}));
  EXPECT_EQ(Run({"run"}), 1);
  EXPECT_TRUE(loader->WaitUntilAsked(traffic.Requests.size() + 1, std::chrono::seconds(10)));
  EXPECT_TRUE(loader->Traffic().Runs);
  EXPECT_THAT(loader->HostFaults(), IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(Every, ListedDeviceOnTheWire,
                         testing::Values(ListedDevice{1095, 22'016}, ListedDevice{1103, 22'016},
                                         ListedDevice{1037, 44'032}),
                         [](const auto& device) { return std::to_string(device.param.Identity); });

TEST_F(DeviceOnTheWire, GetsItsEepromWhereTheChipHasIt) {
  Plug(
      {.Device = {.Identity = 1003, .Instructions = 5'632, .EepromBytes = 512}, .LinePace = sim::Pace::Fast});
  Bytes eeprom(48);
  std::iota(eeprom.begin(), eeprom.end(), std::uint8_t{1});
  const std::string file = Folder / "eeprom.hex";
  WriteFile(file, Records(0, program) + Records(0xFFFC00, eeprom) + HexFile::End());
  EXPECT_EQ(Run({"write", file, "--device", "WITH EEPROM"}), 1);
  EXPECT_EQ(Held(), Holding(5'632, {{0, program}}));
  EXPECT_EQ(traffic.Memory.ReadEeprom(0xFFFC00, 24), eeprom);
  EXPECT_EQ(traffic.Memory.ReadEeprom(0xFFFC30, 1), (Bytes{0xFF, 0xFF}));
  EXPECT_TRUE(traffic.IsVerified);
  EXPECT_EQ(Run({"verify", file, "--device", "WITH EEPROM"}), 1);
  EXPECT_THAT(loader->HostFaults(), IsEmpty());
}

TEST_F(DeviceOnTheWire, TellsAnEepromThatTheDeviceHasElsewhere) {
  Plug(
      {.Device = {.Identity = 1003, .Instructions = 5'632, .EepromBytes = 512}, .LinePace = sim::Pace::Fast});
  const std::string file = Folder / "eeprom.hex";
  WriteFile(file, Records(0, program) + Records(0xFE0000, Bytes(16, 1)) + HexFile::End());
  EXPECT_EQ(Run({"write", file, "--device", "WITH EEPROM"}), -2);
  EXPECT_FALSE(loader->Traffic().IsVerified);
  EXPECT_THAT(said, HasSubstr("holds no whole program"));
}

/// Answers and requests of a write: the identity first, then a row and its comparison in turn.
struct Trouble {
  sim::Pic24fFailure Failure;
  std::size_t Place;
};

class WriteInTrouble : public DeviceOnTheWire, public testing::WithParamInterface<Trouble> {
 protected:
  WriteInTrouble() { Plug(Listed(GetParam().Failure, GetParam().Place)); }

  void ExpectWhole() {
    EXPECT_EQ(Write(), 1);
    EXPECT_EQ(said, "");
    EXPECT_EQ(Held(), HoldingRows(3));
    EXPECT_TRUE(traffic.IsVerified);
  }

  void ExpectBroken(std::int32_t code, const Bytes& held) {
    EXPECT_EQ(Write(), code);
    EXPECT_EQ(Held(), held);
    EXPECT_FALSE(traffic.IsVerified);
    EXPECT_THAT(said, HasSubstr("holds no whole program"));
    EXPECT_FALSE(Port.PortOpen());
  }

  /// Row 2 is not as the file has it: the write goes on, but does not confirm.
  void ExpectDifference(std::size_t from, const Bytes& bytes) {
    Bytes held = HoldingRows(3);
    std::copy(bytes.begin(), bytes.end(), held.begin() + static_cast<std::ptrdiff_t>(from));
    ExpectBroken(-101, held);
    EXPECT_THAT(said, HasSubstr("Verify Error at 0x"));
  }
};

TEST_P(WriteInTrouble, EndsAsTheDeviceIsLeft) {
  switch (GetParam().Failure) {
    case Pic24fFailure::Silence:
      ExpectBroken(-2, HoldingRows(1));
      break;
    case Pic24fFailure::BadCells:
      ExpectDifference(0x180, {0, 0, 0, 0});
      break;
    case Pic24fFailure::LostRow:
      ExpectDifference(0x100, Erased(256));
      break;
    case Pic24fFailure::RefusedErase:
      EXPECT_EQ(Write(), 1);
      EXPECT_EQ(Run({"erase", "--device", "ONE PAGE"}), -2);
      EXPECT_EQ(Held(), HoldingRows(3));
      EXPECT_THAT(said, HasSubstr("may be erased in part"));
      break;
    case Pic24fFailure::UnknownIdentity:
      EXPECT_EQ(Run({"identify"}), 32766);
      EXPECT_EQ(Write(), 0);
      EXPECT_EQ(Held(), HoldingRows(0));
      EXPECT_THAT(said, HasSubstr("is as it was"));
      break;
    case Pic24fFailure::UnpluggedInAnswer:
      ExpectBroken(LineLost, HoldingRows(1));
      break;
    case Pic24fFailure::UnpluggedInWrite: {
      Bytes held = HoldingRows(1);
      std::copy(program.begin() + 0x100, program.begin() + 0x180, held.begin() + 0x100);
      ExpectBroken(LineLost, held);
      break;
    }
    default:
      ExpectWhole();
  }
  EXPECT_THAT(loader->HostFaults(), IsEmpty());
}

std::vector<Trouble> EachFailureOnce() {
  std::vector<Trouble> troubles;
  for (const sim::Pic24fFailureInfo& info : sim::Pic24fFailures) {
    troubles.push_back({info.Failure, info.Place == sim::FailurePlace::Row ? 2U : 3U});
  }
  return troubles;
}

std::string NameOf(const testing::TestParamInfo<Trouble>& trouble) {
  std::string name(sim::Pic24fFailures.at(static_cast<std::size_t>(trouble.param.Failure)).Name);
  std::replace(name.begin(), name.end(), '-', '_');
  return name;
}

INSTANTIATE_TEST_SUITE_P(Every, WriteInTrouble, testing::ValuesIn(EachFailureOnce()), NameOf);

INSTANTIATE_TEST_SUITE_P(AtAnAcknowledgement, WriteInTrouble,
                         testing::Values(Trouble{Pic24fFailure::LostAnswer, 2},
                                         Trouble{Pic24fFailure::LateAnswer, 2},
                                         Trouble{Pic24fFailure::CutAnswer, 2},
                                         Trouble{Pic24fFailure::DoubleAnswer, 2}),
                         NameOf);

}  // namespace
