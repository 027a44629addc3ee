#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
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
  RadioTroubleSettings Trouble{};
  Pace LinePace = Pace::AsWired;
  std::ostream* Log = nullptr;     ///< gets both directions of the line
  std::ostream* Frames = nullptr;  ///< gets a gun's scores, CRC included, when they are first closed
};

/// What has passed the line.
struct RadioModemTraffic {
  std::vector<GunRequest> Requests;  ///< in the order of their coming, also those for guns that are not there
  std::vector<std::string> Faults;   ///< what the host must not have sent; none of it was answered
  std::size_t BytesFromHost = 0;
  std::size_t BytesToHost = 0;
};

/// The radio modem, in API mode without escaping on a line of 57600 baud, and the guns in its range. Both
/// directions run at once: a gun answers its time after the last bit of the request, or later while the line
/// is busy with another's answer. The guns keep their scores, so a host may close them and fetch them again.
class RadioModem : public Device {
 public:
  /// Throws std::system_error when the system grants no pseudo terminal, and std::invalid_argument when there
  /// is no gun that the trouble could strike. The streams must outlive the modem.
  explicit RadioModem(RadioModemSettings settings);

  RadioModemTraffic Traffic() const { return traffic_.Copy(); }

  /// Waits until `count` requests and faults have come; false when `limit` passes first.
  bool WaitUntilAsked(std::size_t count, std::chrono::milliseconds limit) const;

 private:
  void Run();
  void Take(std::uint8_t byte);
  void Note(const HostFault& fault);
  void Serve(const GunRequest& request);
  const RadioGun* FindGun(std::uint8_t playerId) const;
  void CopyScores(const RadioGun& gun);
  void NoteSent(const LinePiece& piece);

  RadioModemSettings settings_;
  RadioTrouble trouble_;
  PacedSender sender_;
  TransmitRequestReader reader_;
  std::set<std::uint8_t> closed_;
  TrafficRecord<RadioModemTraffic> traffic_;
  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
