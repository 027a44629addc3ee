#pragma once

#include <gmock/gmock.h>

#include <QComboBox>
#include <QLabel>
#include <QListWidget>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "sound/ISD_rec.h"
#include "sound/SoundListView.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeSoundConverter.h"
#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/sound/FakeRecorder.h"
#include "tests/sound/Waves.h"
#include "tests/support/Controls.h"

/// A product's definition file.
inline std::string Definition(const std::vector<std::string>& events) {
  std::string bytes = "<sound_defintions><sound_list_definition><sounds>";
  for (const std::string& event : events) {
    bytes += "<sound_entry><name>" + event + "</name></sound_entry>";
  }
  return bytes + "</sounds></sound_list_definition></sound_defintions>";
}

/// Serial ports that may fail to be listed.
class ListedDevices : public FakeSerialDevices {
 public:
  std::function<void()> OnNames = [] {};

  std::vector<std::string> Names() const override {
    OnNames();
    return FakeSerialDevices::Names();
  }
};

/// The window with hardware at the end of its line.
class SoundWindow : public testing::Test {
 protected:
  explicit SoundWindow(Language language = Language::English) : Strings(language) {
    Port.Pump = &Events;
    Devices.Ports = {"/dev/ttyS0", "/dev/ttyS1"};
    Disk.Put("/data/tessarine.ini", "[comm]\r\ncommport=2\r\n");
    Disk.Put("/program/sound_list_mainboard.xml", Definition({"Shot", "Hit", "Reload"}));
    Disk.Put("/program/sound_list_maltrone.xml", Definition({"Alarm", "Armed"}));
    Disk.Put("/sounds/300.wav", Wave(Samples(300)));
    Disk.Put("/sounds/400.raw", Samples(400));
  }

  ISD_rec& Open() {
    Window = std::make_unique<ISD_rec>(ISD_rec::Parts{.MSComm1 = Port,
                                                      .Ini = Ini,
                                                      .Devices = Devices,
                                                      .Events = Events,
                                                      .Elapsed = Events,
                                                      .Boxes = Boxes,
                                                      .CD = Dialog,
                                                      .Disk = Disk,
                                                      .Player = Player,
                                                      .Converter = Converter,
                                                      .Awake = Awake,
                                                      .Strings = Strings,
                                                      .ProgramFolder = "/program"},
                                       nullptr);
    Show(*Window);
    return *Window;
  }

  void Press(const char* button) { ::Press(*Window, button); }
  std::string TextOf(const char* label) const { return Find<QLabel>(*Window, label).text().toStdString(); }
  QComboBox& Combo(const char* name) const { return Find<QComboBox>(*Window, name); }
  SoundListView& List() const { return Find<SoundListView>(*Window, "SoundList"); }

  std::vector<std::string> Column(int column) const {
    std::vector<std::string> cells;
    for (int row = 0; row < List().model()->rowCount(); ++row) {
      cells.push_back(List().model()->index(row, column).data().toString().toStdString());
    }
    return cells;
  }
  std::vector<std::string> Paths() const { return Column(1); }

  std::vector<std::string> Notes() const {
    const auto& list = Find<QListWidget>(*Window, "Notes");
    std::vector<std::string> notes;
    for (int row = 0; row < list.count(); ++row) {
      notes.push_back(list.item(row)->text().toStdString());
    }
    return notes;
  }

  /// Gives a row its file by the button.
  void SetSound(int row, const std::string& path) {
    List().SelectRow(row);
    Dialog.Answers = {path};
    Press("SetSound");
  }

  std::vector<std::string> BoxTexts() const {
    std::vector<std::string> texts;
    for (const FakeMessageBoxes::Box& box : Boxes.Boxes) {
      texts.push_back(box.Text);
    }
    return texts;
  }

  StringTable Strings;
  FakeEventPump Events;
  FakeSerialPort Port;
  FakeRecorder Hardware{Port, Events};
  FakeMessageBoxes Boxes;
  FakeFileDialog Dialog;
  FakeFiles Disk;
  ListedDevices Devices;
  IniReader Ini{Disk, "/data/tessarine.ini"};
  FakeSoundPlayer Player{Events};
  FakeSoundConverter Converter;
  FakeWakeLock Awake;
  std::unique_ptr<ISD_rec> Window;
};
