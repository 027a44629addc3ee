#include "core/line/SerialJob.h"

#include <utility>

namespace {

using std::chrono::milliseconds;

/// A pause this long is one that the device needs; a shorter one only paces the bytes.
constexpr milliseconds ShortestDrainedPause{10};

/// The longest that windows may go unpainted.
constexpr milliseconds LongestBlockingPause{50};

}  // namespace

SerialJob::SerialJob(SerialPort& port, EventPump& events, std::string instrument,
                     std::function<bool()> stopped)
    : port_(port), events_(events), instrument_(std::move(instrument)), stopped_(std::move(stopped)) {
  port_.SetInstrument(instrument_);
}

SerialJob::~SerialJob() {
  if (fault_ || !leaveOpen_) {
    Close();
  }
}

void SerialJob::Open(const std::string& device, const std::string& settings) {
  Close();
  fault_.reset();
  faultTold_ = false;
  port_.SetInstrument(instrument_);
  port_.Open(device, settings);
}

void SerialJob::Close() {
  if (port_.PortOpen()) {
    port_.Close();
  }
}

template <typename Operation>
bool SerialJob::Run(bool sending, const Operation& operation) {
  if (Over()) {
    return false;
  }
  try {
    operation();
    return true;
  } catch (const RuntimeError& error) {
    fault_ = LineFault{sending, error};
    return false;
  }
}

bool SerialJob::SetSettings(const std::string& settings) {
  return Run(true, [&] { port_.SetSettings(settings); });
}

bool SerialJob::Send(std::uint8_t byte) {
  return Run(true, [&] { port_.Output(byte); });
}

void SerialJob::ClearInput() {
  Run(false, [&] { port_.ClearInput(); });
}

void SerialJob::Pause(milliseconds time) {
  if (time >= ShortestDrainedPause) {
    Run(true, [&] { port_.Drain(); });
  }
  if (Over()) {
    return;
  }
  if (time <= LongestBlockingPause) {
    events_.Sleep(time);
  } else {
    WaitUntil([] { return false; }, time);
  }
}

std::optional<std::uint8_t> SerialJob::Take() {
  std::optional<std::uint8_t> byte;
  Run(false, [&] {
    if (port_.InBufferCount() > 0) {
      byte = port_.Input();
    }
  });
  return byte;
}

LineWait SerialJob::WaitUntil(const std::function<bool()>& condition, milliseconds limit) {
  bool met = false;
  const WaitResult result = events_.WaitFor(
      [&] {
        met = !Over() && condition();
        return met || Over();
      },
      limit);
  programCloses_ = programCloses_ || result == WaitResult::Ended;
  if (met) {
    return LineWait::Met;
  }
  if (Stopped()) {
    return LineWait::Stopped;
  }
  return fault_ ? LineWait::Fault : LineWait::TimedOut;
}

SerialJob::ReceivedByte SerialJob::WaitForByte(milliseconds limit) {
  std::optional<std::uint8_t> byte;
  const LineWait wait = WaitUntil(
      [&] {
        byte = Take();
        return byte.has_value();
      },
      limit);
  return {wait, byte.value_or(0)};
}

std::optional<LineFault> SerialJob::FaultToTell() {
  if (!fault_ || Stopped() || std::exchange(faultTold_, true)) {
    return std::nullopt;
  }
  return fault_;
}
