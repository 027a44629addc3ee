#include "sim/radio/RadioModem.h"

#include <algorithm>
#include <optional>
#include <utility>
#include <variant>

namespace sim {
namespace {

constexpr int lineBaud = 57600;

}  // namespace

RadioModem::RadioModem(RadioModemSettings settings)
    : settings_(std::move(settings)),
      trouble_(settings_.Trouble, settings_.Guns),
      terminal_(lineBaud, settings_.LinePace),
      sender_(terminal_, [this](const LinePiece& piece) { NoteSent(piece); }),
      log_(settings_.Log, "radio-modem"),
      thread_([this] { Run(); }) {}

RadioModem::~RadioModem() {
  terminal_.Interrupt();
  thread_.join();
}

RadioModemTraffic RadioModem::Traffic() const {
  const std::scoped_lock lock(mutex_);
  return traffic_;
}

bool RadioModem::WaitUntilAsked(std::size_t count, std::chrono::milliseconds limit) const {
  std::unique_lock lock(mutex_);
  return asked_.wait_for(lock, limit,
                         [&] { return traffic_.Requests.size() + traffic_.Faults.size() >= count; });
}

void RadioModem::Run() {
  while (terminal_.IsUp()) {
    if (const std::optional<std::uint8_t> byte = terminal_.ReadByte(sender_.UntilDue())) {
      Take(*byte);
    }
    sender_.SendDue();
  }
}

void RadioModem::Take(std::uint8_t byte) {
  const auto taken = reader_.Take(byte);
  {
    const std::scoped_lock lock(mutex_);
    ++traffic_.BytesFromHost;
  }
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
  log_.FromHost(reader_.Bytes(), "fault: " + what);
  {
    const std::scoped_lock lock(mutex_);
    traffic_.Faults.push_back(what);
  }
  asked_.notify_all();
}

void RadioModem::Serve(const GunRequest& request) {
  const PseudoTerminal::Clock::time_point asked = PseudoTerminal::Clock::now();
  log_.FromHost(reader_.Bytes(), Describe(request));
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
  {
    const std::scoped_lock lock(mutex_);
    traffic_.Requests.push_back(request);
  }
  asked_.notify_all();
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
  log_.ToHost(piece.Bytes);
  if (piece.LineEndsBehind) {
    log_.Note("line pulled out");
  }
  const std::scoped_lock lock(mutex_);
  traffic_.BytesToHost += piece.Bytes.size();
}

}  // namespace sim
