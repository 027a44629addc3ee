#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <ostream>
#include <span>
#include <vector>

#include "sim/baseunit/BaseUnitAnswer.h"
#include "sim/line/Device.h"

namespace sim {

struct BaseUnitSettings {
  BaseUnitAnswer Answer{};  ///< sent for every request: the unit keeps a game's scores until the next game
  /// Called at each request, on the unit's thread; returns the answer from then on if the next game has
  /// ended.
  std::function<std::optional<BaseUnitAnswer>()> NextAnswer = {};
  Pace LinePace = Pace::AsWired;
  int Requests = 0;                       ///< how many to serve before the line ends; 0: any number
  std::ostream* Log = nullptr;            ///< receives the traffic in both directions
  std::ostream* Frames = nullptr;         ///< receives the frames, byte for byte as sent
  std::function<void()> OnFinished = {};  ///< called on the unit's thread once it has stopped serving
};

/// The traffic of one request.
struct BaseUnitExchange {
  std::vector<std::uint8_t> Sent;                 ///< all bytes, from the noise or count byte on
  std::vector<std::vector<std::uint8_t>> Frames;  ///< as sent; the last may be cut short
  std::vector<std::uint8_t> Replies;              ///< 170 accepted, 0 rejected
};

/// The unit that collects the guns' scores after a game and passes them on over a 19200 baud line. It serves
/// from construction until it has answered `Requests` requests, its line is pulled out, or it is destroyed.
/// While waiting for a reply it also accepts a new request and starts over, since a host that gave up asks
/// again.
class BaseUnit : public Device {
 public:
  /// Throws std::system_error when the system grants no pseudo terminal. The streams must outlive the unit.
  explicit BaseUnit(BaseUnitSettings settings);

  /// The traffic of the latest request.
  BaseUnitExchange LatestExchange() const;

  /// Waits until `requests` answers have ended, complete or not; false if `limit` passes first.
  bool WaitUntilServed(int requests, std::chrono::milliseconds limit) const;

 private:
  enum class Ending { Complete, AskedAnew, LineGone };
  enum class Heard { Reply, Request, Nothing };

  struct Record {
    int RequestsServed = 0;
    BaseUnitExchange Latest;
  };

  void Run();
  bool AwaitRequest();
  Heard AwaitReply();
  Ending Serve();
  Ending EndOfCutAnswer();
  bool Send(std::span<const std::uint8_t> bytes, bool isFrame);

  BaseUnitSettings settings_;
  std::size_t bytesUntilCut_ = 0;
  TrafficRecord<Record> record_;
  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
