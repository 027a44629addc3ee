#pragma once

#include <chrono>
#include <cstddef>
#include <functional>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "devices/baseunit/BaseUnitDownload.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeDownloadProgress.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/support/Frames.h"

/// The boxes of a download.

inline FakeMessageBoxes::Box BoxOf(const std::string& text, BoxIcon icon) {
  return {text, "Tessarine", icon, BoxButtons::Ok};
}

inline const FakeMessageBoxes::Box TimedOutBox =
    BoxOf("Timed out waiting for Data. Please try again.", BoxIcon::Exclamation);
inline const FakeMessageBoxes::Box ReceiveErrorBox =
    BoxOf("Error occured receiving data. Please try again.", BoxIcon::Exclamation);
inline const FakeMessageBoxes::Box SendErrorBox =
    BoxOf("Error occured sending data. Please try again.", BoxIcon::Exclamation);
inline const FakeMessageBoxes::Box ChecksumBox = BoxOf("Checksum failed", BoxIcon::Critical);
inline const FakeMessageBoxes::Box NoScoresBox = BoxOf("Kesh has no score data.", BoxIcon::Information);

/// A download with everything it uses. At the far end of its line is a unit that answers each request with
/// the same frames, at once.
struct DownloadStage {
  static constexpr std::size_t Never = std::numeric_limits<std::size_t>::max();

  std::vector<Bytes> Frames;          ///< with their check bytes
  std::optional<std::uint8_t> Count;  ///< the count that the unit sends, if not the number of frames
  std::size_t SilentFrom = Never;     ///< how many bytes of an answer come before it falls silent
  std::function<void()> ShowSettings = [] {};

  FakeFiles Store;
  FakeSerialDevices Devices;
  FakeSerialPort Port;
  FakeMessageBoxes Boxes;
  FakeEventPump Events;
  FakeClock Time;
  FakeDownloadProgress Progress;
  StringTable Strings{Language::English};
  Game Scores{Strings};
  DownloadedGuns Guns{Scores};
  IniReader Ini{Store, "/tessarine.ini"};
  CommPort Line{Port, Ini, Devices, Boxes, Strings, [this] { ShowSettings(); }};

  DownloadStage() {
    Devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"};
    Port.OnOutput = [this](std::uint8_t byte) { Answer(byte); };
  }
  DownloadStage(const DownloadStage&) = delete;
  DownloadStage& operator=(const DownloadStage&) = delete;

  DownloadResult GetScores() { return GetScores(Progress); }

  /// For a second download during the first.
  DownloadResult GetScores(DownloadProgress& progress) {
    return BaseUnitDownload(Port, Line, Events, Boxes, Time, progress, Guns).GetScores();
  }

  /// Writes bytes sent, pauses and boxes into the log of the progress window.
  void LogAll() {
    Port.OnOutput = [this](std::uint8_t byte) {
      Progress.Log.push_back("Output " + std::to_string(byte));
      Answer(byte);
    };
    Events.OnSleep = [this](std::chrono::milliseconds time) {
      Progress.Log.push_back("Sleep " + std::to_string(time.count()));
    };
    Boxes.WhileOpen = [this](const FakeMessageBoxes::Box& box) { Progress.Log.push_back("Box " + box.Text); };
  }

 private:
  /// 1 and then 0 request the count and the first frame; each reply brings the next frame.
  void Answer(std::uint8_t byte) {
    if (byte == 1) {
      asked_ = true;
      return;
    }
    if (asked_) {
      asked_ = false;
      next_ = 0;
      sent_ = 0;
      Send({Count.value_or(static_cast<std::uint8_t>(Frames.size()))});
    }
    if (next_ < Frames.size()) {
      Send(Frames[next_++]);
    }
  }

  void Send(const Bytes& bytes) {
    for (const std::uint8_t byte : bytes) {
      if (sent_++ < SilentFrom) {
        Port.Receive({byte});
      }
    }
  }

  bool asked_ = false;
  std::size_t next_ = 0;
  std::size_t sent_ = 0;
};
