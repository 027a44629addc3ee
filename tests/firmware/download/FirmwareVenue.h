#pragma once

#include <gmock/gmock.h>

#include <QLabel>
#include <QTimer>
#include <algorithm>
#include <array>
#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "firmware/download/FirmwareFlash.h"
#include "firmware/download/Lamp.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/bootcode/BootCode.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/support/Controls.h"
#include "tests/support/TemporaryFolder.h"

using Texts = std::vector<std::string>;

/// How a download may end: the texts of its boxes, none after a good one.
namespace End {

inline const Texts Lost = {"Error Occured, The device is not open", "8012"};
inline const Texts TimedOut = {
    "Timed out waiting for the device. You will likely experience unexpected program execution."};
inline const Texts NoLoadMode = {"The device did not enter load mode."};
inline const Texts NotFinished = {
    "The device did not finish loading. You are likely to experience unexpected program execution."};
inline const Texts WrongProduct = {"Wrong Product for this firmware file. Aborting."};
inline const Texts InvalidAddress = {
    "Invalid address in program, aborting. You will likely experience unexpected program execution."};
inline const Texts InvalidEraseAddress = {
    "Invalid (erase) address in program, aborting. You will likely experience unexpected program execution."};
inline const Texts InvalidReply = {"Invalid response received, aborting."};
inline const Texts InvalidEraseReply = {"Invalid response received (erase), aborting."};

}  // namespace End

inline constexpr std::size_t RowBytes = 192;
inline constexpr std::size_t PageBytes = 1536;
inline constexpr std::size_t FlashBytes = 512 * PageBytes;

/// The real event loop, with waits for a reply of a fifth of their length: the device here answers at once, a
/// little late or never.
class ShortWaits : public EventPump {
 public:
  void EndWaits() override { events_.EndWaits(); }
  void DoEvents() override { events_.DoEvents(); }
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override {
    return events_.WaitFor(condition, limit == std::chrono::seconds(10) ? std::chrono::seconds(2) : limit);
  }
  void Sleep(std::chrono::milliseconds time) override { events_.Sleep(time); }

 private:
  QtEventPump events_;
};

/// Bytes that are no pattern.
inline std::string Noise(std::size_t count) {
  std::string bytes(count, 0);
  std::uint32_t state = 1;
  for (char& byte : bytes) {
    state = state * 1664525U + 1013904223U;
    byte = static_cast<char>(state >> 24U);
  }
  return bytes;
}

inline std::string Digits(const std::string& bytes) {
  std::string digits;
  std::array<char, 4> pair{};
  for (const char byte : bytes) {
    std::snprintf(pair.data(), pair.size(), "%02X",
                  static_cast<unsigned int>(static_cast<unsigned char>(byte)));
    digits += pair.data();
  }
  return digits;
}

class FirmwareVenue {
 public:
  /// The file of a device of the second kind has one or two pages.
  FirmwareVenue(sim::BootProduct product, sim::Pace pace, int pages = 1)
      : Image(Noise(PageBytes) + (pages == 2 ? Noise(100) + std::string(PageBytes - 100, '\xFF') : "")),
        product_(product) {
    WriteFile(folder_ / "flash", product == sim::BootProduct::Qvm2 ? Before() : "");
    device_.emplace(sim::BootCodeSettings{
        .Product = product,
        .FlashFile = folder_ / "flash",
        .Times = 2,
        .Late = std::chrono::milliseconds(200),
        .Gap = std::chrono::seconds(1),  // a busy machine may rest in the midst of a buffer
        .LinePace = pace});
    devices_.Ports = {device_->DevicePath()};
    std::string page;
    for (std::size_t at = 0; at < PageBytes; at += 64) {
      page += Digits(Image.substr(at, 64)) + "\r\n";
    }
    WriteFile(folder_ / "gun.qvm2",
              pages == 1 ? "0\r\n0,1\r\n" + page : "0,1\r\n0,1,8\r\n" + page + Digits(Noise(100)) + "\r\n");
    WriteFile(folder_ / "gun.qvm", "; three buffers\r\n" + Buffers(3));
    OpenWindow();
  }

  void OpenWindow() {
    const std::string file = product_ == sim::BootProduct::Qvm2 ? "gun.qvm2" : "gun.qvm";
    WriteFile(folder_ / "tessarine.ini", "[Paths]\nfirmware_path=" + (folder_ / file) + "\n");
    window_ = std::make_unique<FirmwareFlash>(FirmwareFlash::Parts{.MSComm1 = port_,
                                                                   .Devices = devices_,
                                                                   .Ini = ini_,
                                                                   .Events = events_,
                                                                   .Boxes = boxes_,
                                                                   .Cd1 = dialog_,
                                                                   .Disk = files_,
                                                                   .Time = time_,
                                                                   .Elapsed = clock_,
                                                                   .Strings = strings_,
                                                                   .Awake = awake_,
                                                                   .LogFolder = folder_ / "logs"},
                                              nullptr);
    Show(*window_);
  }

  /// A download with this trouble; the device is switched on once the line is open.
  void Download(sim::BootTrouble trouble = {}) {
    boxes_.Boxes.clear();
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, [&] {
      if (port_.PortOpen()) {
        timer.stop();
        device_->PowerOn(trouble);
      }
    });
    timer.start(1);
    Press("cmdDownload");
  }

  void Press(const char* button) { ::Press(*window_, button); }
  /// Presses a button some time after the device has sent so many replies.
  void PressAfter(std::size_t replies, const char* button) {
    auto* timer = new QTimer(window_.get());
    QObject::connect(timer, &QTimer::timeout, [this, timer, replies, button] {
      if (device_->Traffic().Replies >= replies) {
        timer->deleteLater();
        Press(button);
      }
    });
    timer->start(300);
  }

  std::string TextOf(const char* label) const { return Find<QLabel>(*window_, label).text().toStdString(); }
  bool IsEnabled(const char* control) const { return Find<QWidget>(*window_, control).isEnabled(); }
  Texts Boxes() const {
    Texts texts;
    for (const FakeMessageBoxes::Box& box : boxes_.Boxes) {
      texts.push_back(box.Text);
    }
    return texts;
  }
  bool WindowIsThere() const { return window_->isVisible(); }
  bool PortIsOpen() const { return port_.PortOpen(); }

  /// The download ended with these boxes and in the state that is told of them.
  void ExpectEnd(const Texts& boxes) {
    EXPECT_EQ(Boxes(), boxes);
    const bool complete = boxes.empty();
    const bool stuck = boxes == End::WrongProduct || boxes == End::InvalidEraseAddress ||
                       (boxes == End::InvalidAddress && product_ == sim::BootProduct::Qvm);
    EXPECT_EQ(IsEnabled("cmdDownload"), !stuck);
    EXPECT_EQ(IsEnabled("cmdBrowse"), !stuck);
    EXPECT_EQ(IsEnabled("cmdBreak"), stuck);
    EXPECT_EQ(PortIsOpen(), !complete && boxes != End::Lost);
    EXPECT_EQ(TextOf("lblDownload"), complete ? "Download Complete!" : stuck ? "Running..." : "Idle");
    EXPECT_EQ(Find<Lamp>(*window_, "sptConnect").IsGreen(), boxes != End::NoLoadMode);
    EXPECT_EQ(Find<Lamp>(*window_, "sptComplete").IsGreen(), complete);
    EXPECT_EQ(TextOf("lblAdvice").empty(), complete);
    EXPECT_EQ(awake_.Held, 0);
    if (boxes == End::Lost) {
      EXPECT_EQ(TextOf("lblStatus"), "Error");
    } else if (!complete && !stuck) {
      EXPECT_EQ(TextOf("lblStatus"), "Idle");
    }
    EXPECT_THAT(device_->HostFaults(), testing::IsEmpty());
  }

  /// The device has sent so many replies since it was switched on, so it has carried out what they answer.
  void AwaitReplies(std::size_t replies) {
    EXPECT_TRUE(device_->WaitUntil(std::chrono::seconds(20),
                                   [replies](const auto& traffic) { return traffic.Replies >= replies; }));
  }
  void AwaitDownloads(std::size_t downloads) {
    EXPECT_TRUE(device_->WaitUntil(std::chrono::seconds(20), [downloads](const auto& traffic) {
      return traffic.Downloads >= downloads;
    }));
  }

  std::string Flash() const { return ReadFile(folder_ / "flash"); }

  /// The memory of a device of the second kind before.
  static std::string Before() { return std::string(FlashBytes, 'Z'); }
  /// With page 0 erased and so many rows of it written.
  std::string RowsOfPage0(std::size_t rows) const {
    return Before()
        .replace(0, PageBytes, PageBytes, '\xFF')
        .replace(0, rows * RowBytes, Image, 0, rows * RowBytes);
  }
  /// With all pages of the file.
  std::string WholeImage() const { return Before().replace(0, Image.size(), Image); }
  /// What a device of the first kind keeps of so many lines.
  std::string Buffers(std::size_t count) const {
    std::string lines;
    for (std::size_t line = 0; line < count; ++line) {
      lines += ":" + Digits(Noise(1000).substr(line * 51, 51)) + "\r\n";
    }
    return lines;
  }

  /// What the file makes of the pages that it lists: all of page 0, and 100 bytes of page 1.
  const std::string Image;

 private:
  const sim::BootProduct product_;
  const TemporaryFolder folder_;
  std::optional<sim::BootCode> device_;
  FakeSerialDevices devices_;
  FakeMessageBoxes boxes_;
  FakeFileDialog dialog_;
  FakeWakeLock awake_;
  FakeClock time_;
  StringTable strings_{Language::English};
  LinuxFiles files_;
  IniReader ini_{files_, folder_ / "tessarine.ini"};
  QtEventPump clock_;
  ShortWaits events_;
  QtSerialPort port_;
  std::unique_ptr<FirmwareFlash> window_;
};
