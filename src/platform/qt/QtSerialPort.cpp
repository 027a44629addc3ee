#include "platform/qt/QtSerialPort.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/file.h>
#include <sys/ioctl.h>
#include <termios.h>
#include <unistd.h>

#include <QSerialPortInfo>
#include <QStringList>
#include <algorithm>
#include <cerrno>
#include <thread>

#include "platform/RuntimeError.h"

namespace {

using LineClock = std::chrono::steady_clock;

/// Size of the system's output buffer. If more bytes than that were written, the first ones have already been
/// sent.
constexpr int OutputBufferBytes = 4096;

/// A full output buffer takes 2.1 s at 19200 baud.
constexpr int LongestOutputMilliseconds = 3000;

/// Checks a device for another program's exclusive mode before the toolkit opens it: the system does not
/// enforce that mode for root, and the toolkit then enters it itself. Kept until the toolkit has opened the
/// device, since closing the only descriptor drops the control signals that power adapters.
class Probe {
 public:
  explicit Probe(const std::string& device)
      : descriptor_(::open(device.c_str(), O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC)) {}
  ~Probe() {
    if (descriptor_ >= 0) {
      ::close(descriptor_);
    }
  }
  Probe(const Probe&) = delete;
  Probe& operator=(const Probe&) = delete;

  bool IsExclusive() const {
    int exclusive = 0;
    return descriptor_ >= 0 && ::ioctl(descriptor_, TIOCGEXCL, &exclusive) == 0 && exclusive != 0;
  }

 private:
  int descriptor_;
};

bool IsHungUp(int descriptor) {
  pollfd line{descriptor, POLLIN, 0};
  return ::poll(&line, 1, 0) < 0 || (line.revents & (POLLERR | POLLHUP | POLLNVAL)) != 0;
}

QSerialPort::Parity ParityOf(const QString& text) {
  if (text == QStringLiteral("N")) {
    return QSerialPort::NoParity;
  }
  if (text == QStringLiteral("E")) {
    return QSerialPort::EvenParity;
  }
  if (text == QStringLiteral("O")) {
    return QSerialPort::OddParity;
  }
  throw RuntimeError(Fault::InvalidPropertyValue);
}

}  // namespace

QtSerialPort::QtSerialPort() {
  QObject::connect(&port_, &QSerialPort::readyRead, &port_, [this] { TakeReceived(); });
  QObject::connect(&port_, &QSerialPort::errorOccurred, &port_,
                   [this](QSerialPort::SerialPortError error) { OnError(error); });
}

QtSerialPort::~QtSerialPort() {
  Close();
}

std::chrono::nanoseconds QtSerialPort::LineSettings::TimeOfAByte() const {
  const int parityBits = Parity == QSerialPort::NoParity ? 0 : 1;
  return std::chrono::nanoseconds(std::chrono::seconds(1 + DataBits + parityBits + StopBits)) / Baud;
}

QtSerialPort::LineSettings QtSerialPort::Parse(const std::string& settings) {
  const QStringList parts = QString::fromStdString(settings).toUpper().split(QLatin1Char(','));
  if (parts.size() != 4) {
    throw RuntimeError(Fault::InvalidPropertyValue);
  }
  const LineSettings parsed{parts[0].toInt(), ParityOf(parts[1]), parts[2].toInt(), parts[3].toInt()};
  if (!QSerialPortInfo::standardBaudRates().contains(parsed.Baud) || parsed.DataBits < 5 ||
      parsed.DataBits > 8 || parsed.StopBits < 1 || parsed.StopBits > 2) {
    throw RuntimeError(Fault::InvalidPropertyValue);
  }
  return parsed;
}

bool QtSerialPort::Apply(const LineSettings& settings) {
  timeOfAByte_ = settings.TimeOfAByte();
  return port_.setParity(settings.Parity) && port_.setBaudRate(settings.Baud) &&
         port_.setDataBits(static_cast<QSerialPort::DataBits>(settings.DataBits)) &&
         port_.setStopBits(settings.StopBits == 1 ? QSerialPort::OneStop : QSerialPort::TwoStop) &&
         port_.setFlowControl(QSerialPort::NoFlowControl);
}

void QtSerialPort::Open(const std::string& device, const std::string& settings) {
  if (PortOpen()) {
    throw RuntimeError(Fault::PortAlreadyOpen);
  }
  Apply(Parse(settings));
  port_.setPortName(QString::fromStdString(device));
  const Probe probe(device);
  if (probe.IsExclusive()) {
    throw RuntimeError(Fault::PortAlreadyOpen);
  }
  if (!port_.open(QIODevice::ReadWrite)) {
    // A permission error means that the device is in use or locked, or that this user may not open it.
    throw RuntimeError(port_.error() == QSerialPort::PermissionError ? Fault::PortAlreadyOpen
                                                                     : Fault::InvalidPortNumber);
  }
  TakeExclusively();
  idleAt_ = LineClock::now();
  ClearInput();
}

void QtSerialPort::SetSettings(const std::string& settings) {
  const LineSettings wanted = Parse(settings);
  Drain();
  const LineSettings old{port_.baudRate(), port_.parity(), port_.dataBits(),
                         port_.stopBits() == QSerialPort::OneStop ? 1 : 2};
  if (!Apply(wanted)) {
    if (lost_) {
      throw RuntimeError(Fault::PortLost);
    }
    Apply(old);
    throw RuntimeError(Fault::InvalidPropertyValue);
  }
}

// The toolkit's lock file goes stale after half a minute and covers only one name of a device, and the
// system's exclusive mode does not apply to root.
void QtSerialPort::TakeExclusively() {
  if (::flock(port_.handle(), LOCK_EX | LOCK_NB) != 0) {
    port_.close();
    throw RuntimeError(Fault::PortAlreadyOpen);
  }
}

void QtSerialPort::Close() {
  if (port_.isOpen()) {
    AwaitIdle();
    port_.close();
  }
  lost_ = false;
}

void QtSerialPort::Drain() {
  if (!PortOpen()) {
    throw RuntimeError(Fault::PortNotOpen);
  }
  if (!lost_ && !AwaitIdle()) {
    Lose();
  }
  if (lost_) {
    throw RuntimeError(Fault::PortLost);
  }
}

/// False when the line was lost meanwhile.
bool QtSerialPort::AwaitIdle() const {
  int result = 0;
  do {
    result = ::tcdrain(port_.handle());
  } while (result != 0 && errno == EINTR);
  // tcdrain returns at once on a pseudo terminal, and early on adapters with a buffer of their own.
  std::this_thread::sleep_until(idleAt_);
  return result == 0;
}

void QtSerialPort::NoteOutput() {
  const auto now = LineClock::now();
  idleAt_ = std::min(std::max(idleAt_, now) + timeOfAByte_, now + OutputBufferBytes * timeOfAByte_);
}

std::size_t QtSerialPort::InBufferCount() {
  if (!PortOpen()) {
    throw RuntimeError(Fault::PortNotOpen);
  }
  if (lost_ && input_.empty()) {
    throw RuntimeError(Fault::PortLost);
  }
  return input_.size();
}

std::uint8_t QtSerialPort::Input() {
  if (InBufferCount() == 0) {
    throw RuntimeError(Fault::PastEndOfFile);
  }
  const std::uint8_t byte = input_.front();
  input_.pop_front();
  return byte;
}

// Bypasses the toolkit's buffer, which would hold a byte back until the event loop runs.
void QtSerialPort::Output(std::uint8_t byte) {
  if (!PortOpen()) {
    throw RuntimeError(Fault::PortNotOpen);
  }
  while (!lost_) {
    const auto written = ::write(port_.handle(), &byte, 1);
    if (written == 1) {
      NoteOutput();
      return;
    }
    const bool full = written == 0 || errno == EAGAIN;
    pollfd line{port_.handle(), POLLOUT, 0};
    if (!full || ::poll(&line, 1, LongestOutputMilliseconds) == 0) {
      Lose();
    }
  }
  throw RuntimeError(Fault::PortLost);
}

void QtSerialPort::ClearInput() {
  if (!PortOpen()) {
    throw RuntimeError(Fault::PortNotOpen);
  }
  if (!lost_) {
    port_.clear(QSerialPort::Input);
  }
  input_.clear();
}

void QtSerialPort::TakeReceived() {
  const QByteArray bytes = port_.readAll();
  input_.insert(input_.end(), bytes.begin(), bytes.end());
}

void QtSerialPort::OnError(QSerialPort::SerialPortError error) {
  if (error == QSerialPort::NoError || !port_.isOpen()) {
    return;
  }
  if (IsHungUp(port_.handle())) {
    Lose();
    return;
  }
  // Input that was announced and then cleared shows up as an error, after which the toolkit reports no input
  // until it is read from.
  TakeReceived();
}

void QtSerialPort::Lose() {
  port_.close();
  lost_ = true;
}
