#include "platform/qt/QtSerialPort.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/file.h>
#include <termios.h>
#include <unistd.h>

#include <QSerialPortInfo>
#include <QStringList>
#include <cerrno>

#include "platform/RuntimeError.h"

namespace {

constexpr int invalidPropertyValue = 380;

/// A full output buffer of the system (4096 bytes) takes 2.1 s at 19200 baud.
constexpr int longestOutputMilliseconds = 3000;

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
  throw RuntimeError(invalidPropertyValue, "Invalid property value");
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

void QtSerialPort::ApplySettings(const std::string& settings) {
  const QStringList parts = QString::fromStdString(settings).toUpper().split(QLatin1Char(','));
  if (parts.size() != 4) {
    throw RuntimeError(invalidPropertyValue, "Invalid property value");
  }
  const int baud = parts[0].toInt();
  const int dataBits = parts[2].toInt();
  const int stopBits = parts[3].toInt();
  if (!QSerialPortInfo::standardBaudRates().contains(baud) || dataBits < 5 || dataBits > 8 || stopBits < 1 ||
      stopBits > 2) {
    throw RuntimeError(invalidPropertyValue, "Invalid property value");
  }
  port_.setParity(ParityOf(parts[1]));
  port_.setBaudRate(baud);
  port_.setDataBits(static_cast<QSerialPort::DataBits>(dataBits));
  port_.setStopBits(stopBits == 1 ? QSerialPort::OneStop : QSerialPort::TwoStop);
  port_.setFlowControl(QSerialPort::NoFlowControl);
}

void QtSerialPort::Open(const std::string& device, const std::string& settings) {
  if (PortOpen()) {
    throw RuntimeError(8005);
  }
  ApplySettings(settings);
  port_.setPortName(QString::fromStdString(device));
  if (!port_.open(QIODevice::ReadWrite)) {
    // "Permission" means both a device in use and one that this user may not touch.
    const bool inUse = port_.error() == QSerialPort::PermissionError &&
                       ::faccessat(AT_FDCWD, device.c_str(), R_OK | W_OK, AT_EACCESS) == 0;
    throw RuntimeError(inUse ? 8005 : 8002);
  }
  TakeExclusively();
  ClearInput();
}

// The toolkit's lock file goes stale after half a minute and knows one name of a device only, and the
// system's exclusive mode does not hold for root.
void QtSerialPort::TakeExclusively() {
  if (::flock(port_.handle(), LOCK_EX | LOCK_NB) != 0) {
    port_.close();
    throw RuntimeError(8005);
  }
}

void QtSerialPort::Close() {
  if (port_.isOpen()) {
    ::tcdrain(port_.handle());
    port_.close();
  }
  lost_ = false;
}

std::size_t QtSerialPort::InBufferCount() {
  if (!PortOpen()) {
    throw RuntimeError(8018);
  }
  if (lost_ && input_.empty()) {
    throw RuntimeError(8012);
  }
  return input_.size();
}

std::uint8_t QtSerialPort::Input() {
  if (InBufferCount() == 0) {
    throw RuntimeError(62);
  }
  const std::uint8_t byte = input_.front();
  input_.pop_front();
  return byte;
}

// Written past the toolkit's buffer, which would hold a byte back until the event loop runs.
void QtSerialPort::Output(std::uint8_t byte) {
  if (!PortOpen()) {
    throw RuntimeError(8018);
  }
  while (!lost_) {
    const auto written = ::write(port_.handle(), &byte, 1);
    if (written == 1) {
      return;
    }
    const bool full = written == 0 || errno == EAGAIN;
    pollfd line{port_.handle(), POLLOUT, 0};
    if (!full || ::poll(&line, 1, longestOutputMilliseconds) == 0) {
      Lose();
    }
  }
  throw RuntimeError(8012);
}

void QtSerialPort::ClearInput() {
  if (!PortOpen()) {
    throw RuntimeError(8018);
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
  // Input that was announced and then cleared reads as an error, after which the toolkit does not listen
  // until it is read from.
  TakeReceived();
}

void QtSerialPort::Lose() {
  port_.close();
  lost_ = true;
}
