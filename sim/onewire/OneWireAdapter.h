#pragma once

#include <cstddef>
#include <cstdint>
#include <mutex>
#include <optional>
#include <ostream>
#include <span>
#include <vector>

#include "sim/line/Device.h"
#include "sim/onewire/ButtonContent.h"
#include "sim/onewire/Ds2480b.h"
#include "sim/onewire/OneWireBus.h"
#include "sim/onewire/OneWireFailure.h"

namespace sim {

struct OneWireAdapterSettings {
  OneWireFailure Failure = OneWireFailure::None;
  std::size_t FailurePlace = 1;  ///< byte (from 1) or bit (1 to 64) that the failure concerns
  Pace LinePace = Pace::AsWired;
  std::ostream* Log = nullptr;  ///< receives the traffic in both directions
};

/// The reader of buttons at the operator's desk: a DS2480B on a serial line that starts at 9600
/// baud, with an identity device of its own on the bus. It is powered up once, at construction: a host that
/// goes away and comes back finds the chip as it left it. It serves until its line is pulled out or it is
/// destroyed. It receives and sends in turn, so a block takes up to twice as long as on a real line.
class OneWireAdapter : public Device {
 public:
  /// Throws std::invalid_argument when the failure has no such place, std::system_error when the system
  /// grants no pseudo terminal. The log must outlive the adapter.
  explicit OneWireAdapter(OneWireAdapterSettings settings);

  /// Holds a button to the reader until it leaves. No effect on one that is there already.
  void Touch(const RomId& rom);
  /// False when no such button is at the reader.
  bool Leave(const RomId& rom);
  void LeaveAll();

  /// Gives a button, at the reader or not, new content. Throws std::invalid_argument, with a text for the
  /// user, if buttons of its family have no memory.
  void Fill(const RomId& rom, ButtonContent content);
  /// What lies at ChargeBlockAddress in the button's memory; throws like Fill.
  ChargeBlock BlockOf(const RomId& rom);

 private:
  void Run();
  std::optional<std::uint8_t> AnswerTo(std::uint8_t byte);
  bool Send(std::uint8_t answer);
  bool Fails(OneWireFailure failure) const { return settings_.Failure == failure; }
  std::vector<RomId> OnTheBus(const RomId& rom) const;
  std::span<std::uint8_t> BlockIn(const RomId& rom);

  OneWireAdapterSettings settings_;
  std::size_t answers_ = 0;

  std::mutex busMutex_;
  OneWireBus bus_;
  Ds2480b chip_;

  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
