#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "sim/bootcode/BootDialect.h"
#include "sim/bootcode/BootFailure.h"
#include "sim/bootcode/BootSession.h"
#include "sim/line/Device.h"
#include "sim/line/OpenWatch.h"
#include "sim/line/PacedSender.h"

namespace sim {

enum class BootProduct { Qvm, Qvm2 };

/// What goes wrong between one switching on and the next.
struct BootTrouble {
  BootFailure Failure = BootFailure::None;
  std::size_t Place = 1;  ///< reply or packet, from 1
};

struct BootCodeSettings {
  BootProduct Product = BootProduct::Qvm2;
  std::optional<std::string> FlashFile{};  ///< keeps what was loaded
  BootTrouble Trouble{};
  std::size_t Runs = 0;   ///< how often the trouble comes when the device is switched on; 0: each time
  std::size_t Times = 1;  ///< how many packets are asked for again
  std::chrono::milliseconds Late{12'000};
  std::chrono::milliseconds Gap{50};  ///< quiet that ends a buffer of a QVM product
  /// The device is switched on by itself so long after a host has opened its line.
  std::optional<std::chrono::milliseconds> PowerOnAfterOpening{};
  Pace LinePace = Pace::AsWired;
  std::ostream* Log = nullptr;  ///< receives the traffic in both directions
};

struct BootCodeTraffic {
  std::size_t PowerOns = 0;
  std::size_t Replies = 0;    ///< sent since it was switched on last, BOOT included
  std::size_t Downloads = 0;  ///< complete
};

/// The boot code of a device on a 19200 baud line. It says "BOOT" whenever the device is switched on, takes
/// one download, and is gone until the device is switched on again. It is off at first.
class BootCode : public Device {
 public:
  /// Throws std::invalid_argument when the failure has no such place, std::runtime_error if the file cannot
  /// be used, and std::system_error when the system grants no pseudo terminal. The log must outlive the
  /// device.
  explicit BootCode(BootCodeSettings settings);

  /// Switches the device off, if it is on, and on; with this trouble, if given, instead of that of the
  /// settings. Throws std::invalid_argument like the constructor. May be called on any thread.
  void PowerOn(std::optional<BootTrouble> trouble = std::nullopt);

  BootCodeTraffic Traffic() const { return traffic_.Copy(); }
  /// Waits until `condition` holds for the traffic; false if `limit` passes first.
  template <class Condition>
  bool WaitUntil(std::chrono::milliseconds limit, Condition condition) const {
    return traffic_.WaitUntil(limit, condition);
  }

 private:
  using Clock = PseudoTerminal::Clock;

  void Run();
  std::optional<std::chrono::nanoseconds> UntilDue() const;
  void SwitchWhenDue();
  void Start(const BootTrouble& trouble);
  void Announce();
  void Take(std::uint8_t byte);
  void Deal(const BootStep& step);
  void Reply(std::uint8_t answer);
  void Send(LinePiece piece, std::chrono::milliseconds after = {});
  void HangUp();
  std::optional<std::uint8_t> SpoiltAnswer(std::size_t packet) const;
  bool Fails(BootFailure failure) const { return trouble_.Failure == failure; }
  bool Strikes(BootFailure failure) const { return Fails(failure) && replies_ == trouble_.Place; }

  BootCodeSettings settings_;
  std::unique_ptr<BootDialect> dialect_;
  BootSession session_;
  std::optional<OpenWatch> openings_;
  std::optional<PacedSender> sender_;  // a new one for each time that the device is on
  std::vector<std::uint8_t> heard_;    // since the step before
  Clock::time_point latest_;           // when the latest byte was seen
  std::optional<Clock::time_point> powerOnDue_;

  BootTrouble trouble_;
  std::size_t powerOns_ = 0;
  std::size_t replies_ = 0;

  std::mutex switchMutex_;
  bool switched_ = false;
  std::optional<BootTrouble> switchedWith_;

  TrafficRecord<BootCodeTraffic> traffic_;
  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
