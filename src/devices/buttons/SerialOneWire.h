#pragma once

#include <optional>

#include "core/data/IniReader.h"
#include "devices/buttons/Ds2480b.h"
#include "platform/OneWire.h"
#include "platform/SerialDevices.h"

/// The bus behind a serial adapter with a DS2480B chip, adapter type 5. The adapter is powered from the
/// line's control signals, which are on while the port is open. It is configured by keys "port" and "type" of
/// section "onewire"; type 5 is the default.
class SerialOneWire : public OneWire {
 public:
  static constexpr std::int16_t SerialAdapter = 5;

  /// All must outlive this object. `port` is opened for each session.
  SerialOneWire(SerialPort& port, EventPump& events, const IniReader& ini, const SerialDevices& devices)
      : port_(port), events_(events), ini_(ini), devices_(devices) {}

  std::int16_t TMReadDefaultPort(std::int16_t& port, std::int16_t& type) override;
  std::int32_t TMExtendedStartSession(std::int16_t port, std::int16_t type, std::int32_t reserved) override;
  std::int16_t TMSetup(std::int32_t handle) override;
  std::int16_t TMNext(std::int32_t handle, OneWireState& state) override;
  std::int16_t TMRom(std::int32_t handle, OneWireState& state, OneWireRom& rom) override;
  std::int16_t TMAccess(std::int32_t handle, OneWireState& state) override;
  std::int16_t TMTouchByte(std::int32_t handle, std::uint8_t byte) override;
  std::int16_t TMBlockStream(std::int32_t handle, std::span<std::uint8_t> bytes) override;
  std::int16_t TMEndSession(std::int32_t handle) override;

 private:
  bool IsOpen(std::int32_t handle) const { return chip_ && handle == handle_; }
  std::int16_t FindNext(OneWireState& state);
  std::int16_t ConfirmEnd(const OneWireState& last);
  bool Select(const OneWireState& state);

  SerialPort& port_;
  EventPump& events_;
  const IniReader& ini_;
  const SerialDevices& devices_;
  std::int32_t handle_ = 0;      ///< of the last session
  std::optional<Ds2480b> chip_;  ///< while a session is open
};
