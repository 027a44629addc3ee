#include "core/line/LoggedPort.h"

#include <utility>

namespace {

std::string TextOf(const RuntimeError& fault) {
  return std::to_string(fault.Number()) + ' ' + fault.what();
}

}  // namespace

LoggedPort::LoggedPort(SerialPort& port, const Parts& parts, std::string instrument,
                       Transcript::Repeats repeats)
    : port_(port),
      parts_(parts),
      repeats_(repeats),
      nextInstrument_(std::move(instrument)),
      log_(&TranscriptOf(nextInstrument_)) {}

Transcript& LoggedPort::TranscriptOf(const std::string& instrument) {
  const LogRing ring(parts_.Disk, parts_.Folder, instrument, Transcript::FileBytes);
  return transcripts_.try_emplace(instrument, ring, instrument, parts_.Elapsed, repeats_).first->second;
}

template <typename Operation>
auto LoggedPort::Logged(const Operation& operation) {
  try {
    return operation();
  } catch (const RuntimeError& fault) {
    NoteFault(fault);
    throw;
  }
}

void LoggedPort::NoteFault(const RuntimeError& fault) {
  if (std::exchange(latestFault_, fault.Number()) == fault.Number()) {
    return;
  }
  log_->Note("fault " + TextOf(fault));
  if (!port_.PortOpen()) {
    log_->End();
  }
  if (fault.Number() == Fault::PortLost && parts_.OnLost) {
    parts_.OnLost();
  }
}

void LoggedPort::Open(const std::string& device, const std::string& settings) {
  const bool wasOpen = port_.PortOpen();
  if (!wasOpen) {
    log_ = &TranscriptOf(nextInstrument_);
    latestFault_ = 0;
  }
  const std::string line = device + ' ' + settings;
  try {
    port_.Open(device, settings);
    log_->Note("opened " + line, parts_.Time.Now());
    TellOpening(device, settings, 0);
  } catch (const RuntimeError& fault) {
    log_->Note("not opened " + line + ": " + TextOf(fault), parts_.Time.Now());
    TellOpening(device, settings, fault.Number());
    if (!wasOpen) {
      log_->End();
    }
    throw;
  }
}

void LoggedPort::TellOpening(const std::string& device, const std::string& settings, int fault) const {
  if (parts_.OnOpening) {
    parts_.OnOpening(device, settings, fault);
  }
}

void LoggedPort::Close() {
  if (!port_.PortOpen()) {
    port_.Close();
    return;
  }
  LogUnread();
  port_.Close();
  log_->Note("closed");
  log_->End();
}

void LoggedPort::SetSettings(const std::string& settings) {
  Logged([&] { port_.SetSettings(settings); });
  log_->Note("settings " + settings);
}

std::size_t LoggedPort::InBufferCount() {
  return Logged([&] { return port_.InBufferCount(); });
}

std::uint8_t LoggedPort::Input() {
  const std::uint8_t byte = Logged([&] { return port_.Input(); });
  log_->ToHost(byte);
  return byte;
}

void LoggedPort::Output(std::uint8_t byte) {
  Logged([&] { port_.Output(byte); });
  log_->FromHost(byte);
}

void LoggedPort::Drain() {
  Logged([&] { port_.Drain(); });
}

void LoggedPort::ClearInput() {
  LogUnread();
  Logged([&] { port_.ClearInput(); });
}

/// Logs the bytes that will never be read: they can show what went wrong just as well as others.
void LoggedPort::LogUnread() {
  log_->EndRow();
  try {
    for (std::size_t left = port_.InBufferCount(); left > 0; --left) {
      log_->ToHost(port_.Input());
    }
  } catch (const RuntimeError&) {
    log_->EndRow();  // lost or closed, so nothing is left; the line's user will find out
  }
  log_->EndRow("dropped");
}
