#include "demo/pictures/Props.h"

#include <QByteArray>
#include <QFile>
#include <QStringList>
#include <QtEndian>
#include <cmath>
#include <numbers>
#include <random>

namespace {

void Write(const QString& path, const QByteArray& bytes) {
  QFile file(path);
  if (!file.open(QIODevice::WriteOnly) || file.write(bytes) != bytes.size()) {
    qFatal("%s could not be written", qUtf8Printable(path));
  }
}

/// "0,1,2,...", hexadecimal.
QByteArray Numbers(int count) {
  QByteArrayList numbers;
  for (int number = 0; number < count; ++number) {
    numbers.append(QByteArray::number(number, 16).toUpper());
  }
  return numbers.join(',');
}

QByteArray Number(quint32 value, int bytes) {
  const quint32 little = qToLittleEndian(value);
  return QByteArray(reinterpret_cast<const char*>(&little), bytes);
}

/// A falling tone, mono, 8 bits, 22,050 samples a second.
QByteArray Tone(double seconds, double hertz) {
  constexpr int rate = 22050;
  const auto count = static_cast<int>(seconds * rate);
  QByteArray samples;
  double turn = 0;
  for (int at = 0; at < count; ++at) {
    const double left = 1.0 - static_cast<double>(at) / count;
    turn += 2 * std::numbers::pi * hertz * (0.5 + 0.5 * left) / rate;
    const double level = 118 * left * std::sin(turn) * (0.75 + 0.25 * std::sin(at / 400.0));
    samples.append(static_cast<char>(static_cast<unsigned char>(std::lround(128 + level))));
  }
  const auto bytes = static_cast<quint32>(samples.size());
  return "RIFF" + Number(36 + bytes, 4) + "WAVEfmt " + Number(16, 4) + Number(1, 2) + Number(1, 2) +
         Number(rate, 4) + Number(rate, 4) + Number(1, 2) + Number(8, 2) + "data" + Number(bytes, 4) +
         samples;
}

}  // namespace

QString MakeFirmware(const QDir& folder) {
  constexpr int pages = 20;
  constexpr int rowsOfAPage = 8;
  constexpr int linesOfARow = 6;
  constexpr int bytesOfALine = 32;
  constexpr quint32 lowestByte = 0xFF;
  QByteArray text = Numbers(pages) + "\r\n" + Numbers(pages * rowsOfAPage) + "\r\n";
  std::mt19937 bytes;
  for (int line = 0; line < pages * rowsOfAPage * linesOfARow; ++line) {
    QByteArray data;
    for (int at = 0; at < bytesOfALine; ++at) {
      data.append(static_cast<char>(bytes() & lowestByte));
    }
    text += data.toHex().toUpper() + "\r\n";
  }
  QString path = folder.absoluteFilePath(QStringLiteral("mainboard-3.2.qvm2"));
  Write(path, text);
  return path;
}

QString MakeSounds(const QDir& folder) {
  const std::pair<const char*, std::pair<double, double>> sounds[] = {
      {"power-on", {1.2, 520}},        {"power-off", {0.9, 390}},   {"low-battery", {1.5, 260}},
      {"battery-in", {0.6, 700}},      {"connected", {0.5, 880}},   {"countdown", {4.0, 440}},
      {"game-start", {2.0, 660}},      {"game-paused", {1.0, 330}}, {"game-resumed", {1.0, 495}},
      {"one-minute-left", {1.8, 600}}, {"game-over", {3.2, 300}},   {"shot", {0.4, 1400}},
      {"shot-burst", {0.7, 1200}}};
  QByteArray list;
  for (const auto& [name, tone] : sounds) {
    const QString path = folder.absoluteFilePath(QLatin1String(name) + QStringLiteral(".wav"));
    Write(path, Tone(tone.first, tone.second));
    list += '"' + path.toUtf8() + "\"\r\n";
  }
  QString path = folder.absoluteFilePath(QStringLiteral("venue-sounds.txt"));
  Write(path, list);
  return path;
}
