#pragma once

#include <functional>
#include <map>
#include <string>

#include "core/line/Transcript.h"
#include "platform/Clock.h"
#include "platform/Files.h"
#include "platform/MonotonicClock.h"
#include "platform/RuntimeError.h"
#include "platform/SerialPort.h"

/// A serial line that keeps a transcript for each instrument at its far end: bytes in both directions,
/// openings, changes of the settings, closings and faults. Behaves exactly like the wrapped port, even if the
/// transcript fails.
class LoggedPort final : public SerialPort {
 public:
  /// What transcripts are written with; all must outlive the port.
  struct Parts {
    Files& Disk;
    std::string Folder;  ///< of the logs; created when needed, but not its parent
    const MonotonicClock& Elapsed;
    const Clock& Time;
    /// Called after each attempt to open the line; `fault` is 0 or the error number. May be empty.
    std::function<void(const std::string& device, const std::string& settings, int fault)> OnOpening = {};
    /// Called when the open line is lost: once, until it is opened again. May be empty.
    std::function<void()> OnLost = {};
  };

  /// `port` must outlive this object. `instrument` is at its far end until SetInstrument names another.
  LoggedPort(SerialPort& port, const Parts& parts, std::string instrument,
             Transcript::Repeats repeats = Transcript::Repeats::Written);

  void Open(const std::string& device, const std::string& settings) override;
  void Close() override;
  bool PortOpen() const override { return port_.PortOpen(); }
  void SetSettings(const std::string& settings) override;
  std::size_t InBufferCount() override;
  std::uint8_t Input() override;
  void Output(std::uint8_t byte) override;
  void Drain() override;
  void ClearInput() override;
  void SetInstrument(const std::string& name) override { nextInstrument_ = name; }

 private:
  template <typename Operation>
  auto Logged(const Operation& operation);
  Transcript& TranscriptOf(const std::string& instrument);
  void NoteFault(const RuntimeError& fault);
  void TellOpening(const std::string& device, const std::string& settings, int fault) const;
  void LogUnread();

  SerialPort& port_;
  const Parts parts_;
  const Transcript::Repeats repeats_;
  std::map<std::string, Transcript> transcripts_;
  std::string nextInstrument_;
  Transcript* log_;  ///< transcript of the instrument in use
  int latestFault_ =
      0;  ///< number of the fault that was noted last, since a lost line gives it for each byte
};
