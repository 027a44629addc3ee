#pragma once

#include <QSerialPort>
#include <chrono>
#include <deque>

#include "platform/SerialPort.h"

/// A serial line of this machine, or a pseudo terminal. Needs a running event loop to receive.
///
/// When the line is lost the device is closed at once, so that nothing spins on it, but the port counts as
/// open until Close(): Output() throws RuntimeError 8012, and so do InBufferCount() and Input() once all
/// received bytes have been read. A line that accepts no byte for 3 s is lost too. Parity is N, E or O, in
/// upper or lower case.
class QtSerialPort final : public SerialPort {
 public:
  QtSerialPort();
  ~QtSerialPort() override;

  void Open(const std::string& device, const std::string& settings) override;
  void Close() override;
  bool PortOpen() const override { return lost_ || port_.isOpen(); }
  void SetSettings(const std::string& settings) override;
  std::size_t InBufferCount() override;
  std::uint8_t Input() override;
  void Output(std::uint8_t byte) override;
  void Drain() override;
  void ClearInput() override;

 private:
  struct LineSettings {
    int Baud;
    QSerialPort::Parity Parity;
    int DataBits;
    int StopBits;

    std::chrono::nanoseconds TimeOfAByte() const;
  };

  static LineSettings Parse(const std::string& settings);
  bool Apply(const LineSettings& settings);
  void TakeExclusively();
  void NoteOutput();
  bool AwaitIdle() const;
  void TakeReceived();
  void OnError(QSerialPort::SerialPortError error);
  void Lose();

  QSerialPort port_;
  std::deque<std::uint8_t> input_;
  std::chrono::nanoseconds timeOfAByte_{0};
  std::chrono::steady_clock::time_point idleAt_;  ///< when all bytes sent will have left the line
  bool lost_ = false;
};
