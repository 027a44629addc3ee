#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <ostream>
#include <span>
#include <vector>

#include "sim/baseunit/BaseUnitAnswer.h"
#include "sim/line/Device.h"

namespace sim {

struct BaseUnitSettings {
  BaseUnitAnswer Answer{};  ///< to every request: the unit keeps a game's scores until the next game
  Pace LinePace = Pace::AsWired;
  int Requests = 0;                       ///< how many to serve before the line ends; 0: any number
  std::ostream* Log = nullptr;            ///< gets both directions of the line
  std::ostream* Frames = nullptr;         ///< gets the frames, byte for byte as they were put on the line
  std::function<void()> OnFinished = {};  ///< called on the unit's thread when it serves no more
};

/// What has passed the line for one request.
struct BaseUnitExchange {
  std::vector<std::uint8_t> Sent;                 ///< all bytes, from the noise or count byte on
  std::vector<std::vector<std::uint8_t>> Frames;  ///< as sent; the last may be cut short
  std::vector<std::uint8_t> Replies;              ///< 170 accepted, 0 rejected
};

/// The unit that collects the guns' scores after a game and hands them over a line of 19200 baud. It serves
/// from its construction until it has answered `Requests` requests, its line has been pulled out, or its
/// destruction. While it waits for a reply it also takes a new request and begins again, since a host that
/// gave up asks anew.
class BaseUnit : public Device {
 public:
  /// Throws std::system_error when the system grants no pseudo terminal. The streams must outlive the unit.
  explicit BaseUnit(BaseUnitSettings settings);

  /// What passed the line for the latest request.
  BaseUnitExchange LatestExchange() const;

  /// Waits until `requests` requests have been answered to their end; false when `limit` passes first.
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
