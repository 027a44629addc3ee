#pragma once

#include <gmock/gmock.h>

#include <array>
#include <chrono>
#include <cstdio>
#include <string>
#include <vector>

#include "firmware/download/FirmwareDownload.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/firmware/download/BootCode.h"

/// What a window would show.
class ShownDownload : public FirmwareDisplay {
 public:
  std::string Status = "Idle";
  std::string Download = "Idle";
  std::string Buffer = "Buffer Empty";
  std::string Digits;
  double Bar = 0;
  std::string Lamps = "none";  ///< "red red", "green red", "green green"
  std::string BreakCaption = "&Abort";
  bool Running = false;
  int Busy = 0;
  std::string Advice;
  std::uint64_t Sent = 0;
  std::uint64_t All = 0;

  std::vector<std::string> Statuses;  ///< all so far
  std::vector<double> Bars;
  int TimesBusy = 0;

  void SetStatus(const std::string& text) override { Statuses.push_back(Status = text); }
  void SetDownload(const std::string& text) override { Download = text; }
  void SetCurrentBuffer(const std::string& text) override { Buffer = text; }
  void SetDigits(const std::string& text) override { Digits = text; }
  void SetBar(double share) override { Bars.push_back(Bar = share); }
  void SetLamps(bool connected, bool complete) override {
    Lamps = std::string(connected ? "green" : "red") + (complete ? " green" : " red");
  }
  void SetBreakCaption(const std::string& caption) override { BreakCaption = caption; }
  void EnableButtons(bool running) override { Running = running; }
  void SetBusy(bool busy) override {
    Busy += busy ? 1 : -1;
    TimesBusy += busy ? 1 : 0;
  }
  void SetSent(std::uint64_t sent, std::uint64_t all) override {
    Sent = sent;
    All = all;
  }
  void SetAdvice(const std::string& text) override { Advice = text; }
};

inline constexpr const char* LoadModeText = "The device did not enter load mode.";
inline constexpr const char* TimeOutText =
    "Timed out waiting for the device. You will likely experience unexpected program execution.";

/// A download between a fake device and fake files.
class DownloadSite : public testing::Test {
 protected:
  using Milliseconds = std::chrono::milliseconds;

  static constexpr const char* QvmName = "/fw/gun.qvm";
  static constexpr const char* Qvm2Name = "/fw/gun.qvm2";

  DownloadSite() { Disk.AddFolder("/data"); }

  void Run(const std::string& name) {
    download.Run(name, [this] { return device; });
  }

  /// Runs a download of these lines, with the device switched on after 100 ms.
  void RunQvm(const std::string& contents) {
    boot.Product = 'p';
    Disk.Put(QvmName, contents);
    boot.SwitchOnAt(Milliseconds(100));
    Run(QvmName);
  }

  void RunQvm2(const std::string& contents) {
    boot.Product = 'd';
    Disk.Put(Qvm2Name, contents);
    boot.SwitchOnAt(Milliseconds(100));
    Run(Qvm2Name);
  }

  /// The only box, an exclamation with one button.
  void ExpectBox(const std::string& text) {
    EXPECT_THAT(Boxes.Boxes, testing::ElementsAre(FakeMessageBoxes::Box{
                                 text, "Tessarine", BoxIcon::Exclamation, BoxButtons::Ok}));
  }

  /// The window is back to idle, as after most failures; the port stays open.
  void ExpectReset() {
    EXPECT_EQ(shown.Status, "Idle");
    EXPECT_EQ(shown.Download, "Idle");
    EXPECT_FALSE(shown.Running);
    EXPECT_TRUE(Port.PortOpen());
    EXPECT_EQ(Awake.Held, 0);
  }

  /// Only the Close button helps now.
  void ExpectNoReset() {
    EXPECT_EQ(shown.Download, "Running...");
    EXPECT_TRUE(shown.Running);
    EXPECT_TRUE(Port.PortOpen());
    EXPECT_EQ(Awake.Held, 0);
  }

  /// The two boxes and the state of a run-time failure.
  void ExpectRunTimeFailure(int number, const std::string& text) {
    EXPECT_THAT(Boxes.Boxes, testing::ElementsAre(FakeMessageBoxes::Box{"Error Occured, " + text, "Tessarine",
                                                                        BoxIcon::Exclamation, BoxButtons::Ok},
                                                  FakeMessageBoxes::Box{std::to_string(number), "Tessarine",
                                                                        BoxIcon::None, BoxButtons::Ok}));
    EXPECT_EQ(shown.Status, "Error");
    EXPECT_EQ(shown.Buffer, "Buffer Empty");
    EXPECT_EQ(shown.Download, "Idle");
    EXPECT_FALSE(shown.Running);
    EXPECT_FALSE(Port.PortOpen());
    EXPECT_EQ(Awake.Held, 0);
  }

  void ExpectComplete() {
    EXPECT_THAT(Boxes.Boxes, testing::IsEmpty());
    EXPECT_EQ(shown.Download, "Download Complete!");
    EXPECT_EQ(shown.Lamps, "green green");
    EXPECT_FALSE(shown.Running);
    EXPECT_FALSE(Port.PortOpen());
    EXPECT_EQ(shown.Advice, "");
    EXPECT_EQ(Awake.Held, 0);
  }

  std::string Text(OwnText text) const { return strings.Text(text); }

  FakeFiles Disk;
  FakeEventPump Events;
  FakeClock Time;
  FakeMessageBoxes Boxes;
  FakeSerialPort Port;
  FakeWakeLock Awake;
  BootCode boot{Port, Events};
  ShownDownload shown;
  std::string device = "/dev/ttyS0";
  StringTable strings{Language::English};
  FirmwareDownload download{
      {.MSComm1 = Port,
       .Events = Events,
       .Boxes = Boxes,
       .Strings = strings,
       .Awake = Awake,
       .Record = {.Disk = Disk, .Folder = "/data/logs", .Elapsed = Events, .Time = Time}},
      shown};
};
