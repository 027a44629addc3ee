#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <ostream>
#include <set>
#include <string>
#include <vector>

#include "sim/line/Device.h"
#include "sim/line/PacedSender.h"
#include "sim/radio/GunRequest.h"
#include "sim/radio/RadioGun.h"
#include "sim/radio/RadioTrouble.h"
#include "sim/radio/TransmitRequest.h"

namespace sim {

struct RadioModemSettings {
  std::vector<RadioGun> Guns{};  ///< those in range; distinct player ids and addresses
  /// Called when a host begins to search, on the modem's thread; returns the guns from then on if the next
  /// game has ended.
  std::function<std::optional<std::vector<RadioGun>>()> NextGuns = {};
  RadioTroubleSettings Trouble{};
  Pace LinePace = Pace::AsWired;
  std::ostream* Log = nullptr;     ///< receives the traffic in both directions
  std::ostream* Frames = nullptr;  ///< receives a gun's scores, CRC included, when first closed
};

/// The traffic so far.
struct RadioModemTraffic {
  std::vector<GunRequest> Requests;  ///< in order of arrival, including those for guns that are not there
  std::vector<std::string> Faults;   ///< what the host must not send; none of it was answered
  std::size_t BytesFromHost = 0;
  std::size_t BytesToHost = 0;
};

/// The radio modem, in API mode without escaping on a 57600 baud line, and the guns in its range. Both
/// directions run at once: a gun answers when its answer time has passed since the last bit of the request,
/// or later if the line is still busy with another answer. The guns keep their scores, so a host may close a
/// transfer and fetch them again. What a host finds in a search and fetches behind it is one game: the next
/// one begins with a search after something else, or after a pause.
class RadioModem : public Device {
 public:
  /// Throws std::system_error when the system grants no pseudo terminal, and std::invalid_argument when there
  /// is no gun that the trouble could strike. The streams must outlive the modem.
  explicit RadioModem(RadioModemSettings settings);

  RadioModemTraffic Traffic() const { return traffic_.Copy(); }

  /// Waits until `count` requests and faults in total have come; false when `limit` passes first.
  bool WaitUntilAsked(std::size_t count, std::chrono::milliseconds limit) const;

 private:
  void Run();
  void Take(std::uint8_t byte);
  void Note(const HostFault& fault);
  void Serve(const GunRequest& request);
  bool BeginsASearch(const GunRequest& request, PseudoTerminal::Clock::time_point asked) const;
  void TakeNextGuns();
  const RadioGun* FindGun(std::uint8_t playerId) const;
  void CopyScores(const RadioGun& gun);
  void NoteSent(const LinePiece& piece);

  RadioModemSettings settings_;
  RadioTrouble trouble_;
  PacedSender sender_;
  TransmitRequestReader reader_;
  std::set<std::uint8_t> closed_;
  std::optional<GunCommand> latestCommand_;
  PseudoTerminal::Clock::time_point latestAsked_{};
  TrafficRecord<RadioModemTraffic> traffic_;
  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
