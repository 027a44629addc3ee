#include "sim/radio/RadioModem.h"

#include <algorithm>
#include <optional>
#include <utility>
#include <variant>

namespace sim {
namespace {

constexpr int LineBaud = 57600;
// Longer than any wait of a host between two guns that it searches.
constexpr std::chrono::seconds PauseBetweenSearches{1};

}  // namespace

RadioModem::RadioModem(RadioModemSettings settings)
    : Device({.LogName = "radio-modem",
              .Understood = {{.Baud = LineBaud}},
              .LinePace = settings.LinePace,
              .Log = settings.Log}),
      settings_(std::move(settings)),
      trouble_(settings_.Trouble, settings_.Guns),
      sender_(Line(), [this](const LinePiece& piece) { NoteSent(piece); }) {}

bool RadioModem::WaitUntilAsked(std::size_t count, std::chrono::milliseconds limit) const {
  return traffic_.WaitUntil(limit, [&](const RadioModemTraffic& traffic) {
    return traffic.Requests.size() + traffic.Faults.size() >= count;
  });
}

void RadioModem::Run() {
  while (Line().IsUp()) {
    if (const std::optional<std::uint8_t> byte = Line().ReadByte(sender_.UntilDue())) {
      Take(*byte);
    }
    sender_.SendDue();
  }
}

void RadioModem::Take(std::uint8_t byte) {
  const auto taken = reader_.Take(byte);
  traffic_.Note([](RadioModemTraffic& traffic) { ++traffic.BytesFromHost; });
  if (!taken) {
    return;
  }
  if (const auto* fault = std::get_if<HostFault>(&*taken)) {
    Note(*fault);
    return;
  }
  const auto read = ReadGunRequest(std::get<TransmitRequest>(*taken), settings_.Guns);
  if (const auto* fault = std::get_if<HostFault>(&read)) {
    Note(*fault);
    return;
  }
  Serve(std::get<GunRequest>(read));
}

void RadioModem::Note(const HostFault& fault) {
  const std::string what(fault.What);
  Log().FromHost(reader_.Bytes(), "fault: " + what);
  NoteHostFault("the host sent " + what);
  traffic_.Note([&](RadioModemTraffic& traffic) { traffic.Faults.push_back(what); });
}

void RadioModem::Serve(const GunRequest& request) {
  const PseudoTerminal::Clock::time_point asked = PseudoTerminal::Clock::now();
  Log().FromHost(reader_.Bytes(), Describe(request));
  if (BeginsASearch(request, asked)) {
    TakeNextGuns();
  }
  latestCommand_ = request.Command;
  latestAsked_ = asked;
  if (request.Command == GunCommand::Search) {
    for (LinePiece& piece : trouble_.KeptBack()) {
      sender_.Add(asked, std::move(piece));
    }
  }
  if (const RadioGun* gun = FindGun(request.PlayerId)) {
    if (request.Command == GunCommand::Close) {
      CopyScores(*gun);
    }
    for (LinePiece& piece : trouble_.Answer(*gun, request)) {
      sender_.Add(asked + gun->AnswerTime, std::move(piece));
    }
  }
  traffic_.Note([&](RadioModemTraffic& traffic) { traffic.Requests.push_back(request); });
}

bool RadioModem::BeginsASearch(const GunRequest& request, PseudoTerminal::Clock::time_point asked) const {
  return request.Command == GunCommand::Search &&
         (latestCommand_ != GunCommand::Search || asked - latestAsked_ >= PauseBetweenSearches);
}

void RadioModem::TakeNextGuns() {
  if (std::optional<std::vector<RadioGun>> next = settings_.NextGuns ? settings_.NextGuns() : std::nullopt) {
    settings_.Guns = std::move(*next);
    trouble_ = RadioTrouble(settings_.Trouble, settings_.Guns);
    closed_.clear();
  }
}

const RadioGun* RadioModem::FindGun(std::uint8_t playerId) const {
  const auto gun = std::find_if(settings_.Guns.begin(), settings_.Guns.end(),
                                [&](const RadioGun& candidate) { return candidate.PlayerId == playerId; });
  return gun == settings_.Guns.end() ? nullptr : &*gun;
}

void RadioModem::CopyScores(const RadioGun& gun) {
  if (settings_.Frames != nullptr && closed_.insert(gun.PlayerId).second) {
    *settings_.Frames << std::string(gun.Frame.begin(), gun.Frame.end()) << std::flush;
  }
}

void RadioModem::NoteSent(const LinePiece& piece) {
  Log().ToHost(piece.Bytes);
  if (piece.LineEndsBehind) {
    Log().Note("line pulled out");
  }
  traffic_.Note([&](RadioModemTraffic& traffic) { traffic.BytesToHost += piece.Bytes.size(); });
}

}  // namespace sim
