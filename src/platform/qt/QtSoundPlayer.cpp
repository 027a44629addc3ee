#include "platform/qt/QtSoundPlayer.h"

#include <QAudioDevice>
#include <QAudioSink>
#include <QBuffer>
#include <QByteArray>
#include <QElapsedTimer>
#include <QMediaDevices>
#include <algorithm>

#include "platform/RuntimeError.h"

using std::chrono::microseconds;
using std::chrono::milliseconds;

namespace {

constexpr std::uint8_t Silence = 128;

QAudioFormat FormatOf(int samplesPerSecond) {
  QAudioFormat format;
  format.setSampleFormat(QAudioFormat::Int16);  // which every device takes
  format.setChannelCount(1);
  format.setSampleRate(samplesPerSecond);
  return format;
}

QByteArray Widened(const std::vector<std::uint8_t>& samples) {
  QByteArray bytes;
  bytes.reserve(static_cast<qsizetype>(samples.size()) * qsizetype{sizeof(qint16)});
  for (const std::uint8_t sample : samples) {
    const auto wide = static_cast<qint16>((sample - Silence) * 256);
    bytes.append(reinterpret_cast<const char*>(&wide), sizeof wide);
  }
  return bytes;
}

}  // namespace

/// A sound with the device that plays it.
class QtSoundPlayer::Sound {
 public:
  Sound(const QAudioDevice& device, const std::vector<std::uint8_t>& samples, int samplesPerSecond)
      : length_(static_cast<std::int64_t>(samples.size()) * 1'000'000 / samplesPerSecond),
        bytes_(Widened(samples)),
        sink_(device, FormatOf(samplesPerSecond)) {
    source_.setBuffer(&bytes_);
    source_.open(QIODevice::ReadOnly);
    QObject::connect(&sink_, &QAudioSink::stateChanged, &source_,
                     [this](QAudio::State state) { Follow(state); });
    sink_.start(&source_);
    since_.start();
    if (sink_.error() != QAudio::NoError && sink_.error() != QAudio::UnderrunError) {
      throw RuntimeError(Fault::DeviceUnavailable);
    }
  }

  ~Sound() {
    sink_.disconnect();
    sink_.reset();
  }
  Sound(const Sound&) = delete;
  Sound& operator=(const Sound&) = delete;

  /// A device that stalls must not keep anyone waiting for the end.
  bool Ended() const {
    constexpr milliseconds patience(3000);
    return ended_ || milliseconds(since_.elapsed()) > length_ + patience;
  }

  milliseconds Position() const {
    const microseconds heard = Ended() ? length_ : std::min(microseconds(sink_.processedUSecs()), length_);
    return std::chrono::duration_cast<milliseconds>(heard);
  }

 private:
  void Follow(QAudio::State state) {
    // Idle also comes when the device has to wait for more.
    const bool heardOut = state == QAudio::IdleState && source_.atEnd();
    if (!ended_ && (heardOut || state == QAudio::StoppedState)) {
      ended_ = true;
      // The device is free for others, but not in the middle of its own signal.
      QMetaObject::invokeMethod(
          &source_, [this] { sink_.stop(); }, Qt::QueuedConnection);
    }
  }

  const microseconds length_;
  QByteArray bytes_;
  QBuffer source_;
  QAudioSink sink_;
  QElapsedTimer since_;
  bool ended_ = false;
};

QtSoundPlayer::QtSoundPlayer() = default;

QtSoundPlayer::~QtSoundPlayer() = default;

void QtSoundPlayer::Play(std::vector<std::uint8_t> samples, int samplesPerSecond) {
  Stop();
  const QAudioDevice device = QMediaDevices::defaultAudioOutput();
  if (device.isNull() || !device.isFormatSupported(FormatOf(samplesPerSecond))) {
    throw RuntimeError(Fault::DeviceUnavailable);
  }
  sound_ = std::make_unique<Sound>(device, samples, samplesPerSecond);
}

void QtSoundPlayer::Stop() {
  sound_.reset();
}

bool QtSoundPlayer::Playing() const {
  return sound_ && !sound_->Ended();
}

milliseconds QtSoundPlayer::Position() const {
  return sound_ ? sound_->Position() : milliseconds(0);
}
