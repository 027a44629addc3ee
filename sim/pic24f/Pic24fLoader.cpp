#include "sim/pic24f/Pic24fLoader.h"

#include <algorithm>
#include <thread>
#include <variant>

namespace sim {
namespace {

constexpr std::uint8_t VersionMinor = 2;
constexpr std::uint8_t VersionMajor = 1;

Pic24fLoaderSettings Adjusted(Pic24fLoaderSettings settings) {
  constexpr std::uint16_t unknownIdentity = 32766;
  if (settings.Failure == Pic24fFailure::UnknownIdentity) {
    settings.Device.Identity = unknownIdentity;
  }
  return settings;
}

bool IsRead(Pic24fCommand command) {
  return command == Pic24fCommand::ReadProgram || command == Pic24fCommand::ReadEeprom ||
         command == Pic24fCommand::ReadConfiguration;
}

}  // namespace

Pic24fLoader::Pic24fLoader(Pic24fLoaderSettings settings)
    : Device({.LogName = "pic24f",
              .Understood = {{.Baud = 115200},
                             {.Baud = 57600},
                             {.Baud = 38400},
                             {.Baud = 19200},
                             {.Baud = 9600},
                             {.Baud = 4800},
                             {.Baud = 2400},
                             {.Baud = 1200}},
              .LinePace = settings.LinePace,
              .Log = settings.Log}),
      settings_(Adjusted(settings)),
      trouble_(settings_.Failure, settings_.FailurePlace) {
  traffic_.Note([&](Pic24fTraffic& traffic) { traffic.Memory = Pic24fMemory(settings_.Device); });
}

bool Pic24fLoader::WaitUntilAsked(std::size_t count, std::chrono::milliseconds limit) const {
  return traffic_.WaitUntil(limit,
                            [&](const Pic24fTraffic& traffic) { return traffic.Requests.size() >= count; });
}

void Pic24fLoader::Reset() {
  traffic_.Note([](Pic24fTraffic& traffic) { traffic.Runs = false; });
}

void Pic24fLoader::Run() {
  while (const std::optional<std::uint8_t> byte = Read()) {
    if (traffic_.Ask([](const Pic24fTraffic& traffic) { return traffic.Runs; })) {
      Log().FromHost(*byte, "not for the application");
      continue;
    }
    const auto taken = reader_.Take(*byte);
    if (!taken) {
      continue;
    }
    if (const auto* fault = std::get_if<BadPacket>(&*taken)) {
      Fault(fault->What);
    } else {
      Take(std::get<Pic24fPacket>(*taken));
    }
  }
}

// None when the line has ended.
std::optional<std::uint8_t> Pic24fLoader::Read() {
  if (reader_.IsWithinPacket()) {
    const std::optional<std::uint8_t> byte = Line().ReadByte(settings_.Patience);
    if (byte || !Line().IsUp()) {
      return byte;
    }
    Fault("a packet cut short");
    reader_.Reset();
  }
  return Line().ReadByte();
}

void Pic24fLoader::Take(const Pic24fPacket& packet) {
  if (trouble_.LosesRequest()) {
    Log().FromHost(reader_.Bytes(), "lost on the line");
    return;
  }
  const auto read = ReadPic24fRequest(packet.Data);
  if (const auto* fault = std::get_if<BadPacket>(&read)) {
    Fault(fault->What);
    return;
  }
  const auto& request = std::get<Pic24fRequest>(read);
  Log().FromHost(reader_.Bytes(), Describe(request));
  const std::optional<Bytes> answer = CarryOut(request);
  traffic_.Note([&](Pic24fTraffic& traffic) { traffic.Requests.push_back(request); });
  if (answer) {
    Send(trouble_.Answer(*answer));
  }
}

std::optional<Pic24fLoader::Bytes> Pic24fLoader::CarryOut(const Pic24fRequest& request) {
  const Bytes echo{static_cast<std::uint8_t>(request.Command)};
  if (request.Command == Pic24fCommand::Version && request.Count == 0) {
    RunApplication();
    return std::nullopt;
  }
  if (request.Command == Pic24fCommand::Version) {
    return Bytes{0, 2, VersionMinor, VersionMajor};
  }
  if (request.Command == Pic24fCommand::VerifyOk) {
    traffic_.Note([](Pic24fTraffic& traffic) { traffic.IsVerified = true; });
    return echo;
  }
  std::optional<Bytes> answer;
  if (IsRead(request.Command)) {
    answer = AnswerToRead(request);
  } else if (request.Command == Pic24fCommand::EraseProgram && trouble_.RefusesErase()) {
    return std::nullopt;
  } else if (Change(request)) {
    answer = echo;
  }
  if (!answer) {
    NoteHostFault("the host asked for what the device does not have: " + Describe(request));
    Log().Note("fault: no such memory");
  }
  return Line().IsUp() ? answer : std::nullopt;
}

std::optional<Pic24fLoader::Bytes> Pic24fLoader::AnswerToRead(const Pic24fRequest& request) const {
  std::optional<Bytes> bytes = traffic_.Ask([&](const Pic24fTraffic& traffic) {
    if (request.Command == Pic24fCommand::ReadProgram) {
      return traffic.Memory.Read(request.Address, request.Count);
    }
    if (request.Command == Pic24fCommand::ReadEeprom) {
      return traffic.Memory.ReadEeprom(request.Address, request.Count);
    }
    return traffic.Memory.ReadConfiguration(request.Address, request.Count);
  });
  if (bytes) {
    const Bytes header = HeaderOf(request);
    bytes->insert(bytes->begin(), header.begin(), header.end());
  }
  return bytes;
}

// False if the device has no such memory.
bool Pic24fLoader::Change(const Pic24fRequest& request) {
  bool changed = false;
  if (request.Command == Pic24fCommand::WriteProgram) {
    changed = WriteProgram(request);
  } else {
    traffic_.Note([&](Pic24fTraffic& traffic) {
      Pic24fMemory& memory = traffic.Memory;
      if (request.Command == Pic24fCommand::EraseProgram) {
        changed = memory.ErasePages(request.Address, request.Count);
      } else if (request.Command == Pic24fCommand::WriteEeprom) {
        changed = memory.WriteEeprom(request.Address, request.Data);
      } else {
        changed = memory.WriteConfiguration(request.Address, request.Data);
      }
    });
  }
  if (changed) {
    traffic_.Note([](Pic24fTraffic& traffic) { traffic.IsVerified = false; });
  }
  if (changed && request.Command == Pic24fCommand::EraseProgram) {
    Wait(settings_.PageTime * request.Count);
  }
  return changed;
}

bool Pic24fLoader::WriteProgram(const Pic24fRequest& request) {
  constexpr std::uint32_t rowAddresses = 2 * RowInstructions;
  for (std::size_t row = 0; row < request.Count; ++row) {
    const auto address = static_cast<std::uint32_t>(request.Address + row * rowAddresses);
    Bytes bytes(request.Data.begin() + static_cast<std::ptrdiff_t>(row * RowBytes),
                request.Data.begin() + static_cast<std::ptrdiff_t>((row + 1) * RowBytes));
    const Pic24fTrouble::RowFate fate = trouble_.NextRow();
    if (fate == Pic24fTrouble::RowFate::Lost) {
      // What is programmed with ones stays as it is.
      std::fill(bytes.begin(), bytes.end(), std::uint8_t{0xFF});
    } else if (fate == Pic24fTrouble::RowFate::BadCells) {
      std::fill_n(bytes.begin() + RowBytes / 2, InstructionBytes, std::uint8_t{0});
    } else if (fate == Pic24fTrouble::RowFate::LineEnds) {
      std::fill(bytes.begin() + RowBytes / 2, bytes.end(), std::uint8_t{0xFF});
    }
    bool written = false;
    traffic_.Note([&](Pic24fTraffic& traffic) { written = traffic.Memory.WriteRows(address, bytes); });
    if (!written) {
      return false;
    }
    if (fate == Pic24fTrouble::RowFate::LineEnds) {
      Log().Note("line pulled out");
      Line().HangUp();
      return true;
    }
    Wait(settings_.RowTime);
  }
  return true;
}

void Pic24fLoader::RunApplication() {
  traffic_.Note([](Pic24fTraffic& traffic) { traffic.Runs = true; });
  Log().Note("the application runs");
}

void Pic24fLoader::Send(const Pic24fReply& reply) {
  if (reply.Bytes.empty()) {
    Log().Note("no answer");
    return;
  }
  if (reply.Late) {
    Wait(settings_.Lateness);
  }
  if (reply.Torn) {
    Line().WriteTorn(reply.Bytes);
  } else {
    Line().Write(reply.Bytes);
  }
  Log().ToHost(reply.Bytes);
  if (reply.LineEndsBehind) {
    Log().Note("line pulled out");
    Line().HangUp();
  }
}

// Ends early with the line.
void Pic24fLoader::Wait(std::chrono::microseconds duration) {
  constexpr std::chrono::milliseconds slice{10};
  const auto end = PseudoTerminal::Clock::now() + duration;
  while (Line().IsUp() && PseudoTerminal::Clock::now() < end) {
    std::this_thread::sleep_until(std::min(end, PseudoTerminal::Clock::now() + slice));
  }
}

void Pic24fLoader::Fault(std::string_view what) {
  Log().FromHost(reader_.Bytes(), "fault: " + std::string(what));
  NoteHostFault("the host sent " + std::string(what));
}

}  // namespace sim
