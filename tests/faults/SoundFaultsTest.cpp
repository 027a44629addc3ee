#include "sound/ISD_rec.h"
#include "sound/SoundListView.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeSoundConverter.h"
#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/faults/WindowFaults.h"
#include "tests/support/Controls.h"
#include "tests/support/DataSite.h"

namespace {

bool IsErrorReport(const FakeMessageBoxes::Box& box) {
  return box.Text.starts_with("Run-time error '") && box.Icon == BoxIcon::Critical;
}

/// The sound recorder with play lists on a disk that fails. The sounds lie on another.
class PlaylistsUnderFaults : public testing::Test, protected DataSite {
 protected:
  PlaylistsUnderFaults() {
    for (int i = 0; i < 3; ++i) {
      WriteFile(SoundOf(i), std::string(300, 's'));
    }
    Show(window);
  }

  std::string SoundOf(int number) const { return sounds / std::to_string(number) + ".raw"; }

  void SetSound(int row, const std::string& path) {
    Find<SoundListView>(window, "SoundList").SelectRow(row);
    Dialog.Answers = {path};
    Press(window, "SetSound");
  }
  std::string FileOf(int row) const {
    return Find<SoundListView>(window, "SoundList").model()->index(row, 1).data().toString().toStdString();
  }
  void Use(const char* button) {
    Dialog.Answers = {list};
    Press(window, button);
  }

  const TemporaryFolder sounds;
  const std::string list = Folder / "list.txt";
  FakeEventPump events;
  FakeSerialPort port;
  FakeSerialDevices devices;
  IniReader ini{Disk, sounds / "tessarine.ini"};
  FakeSoundPlayer player{events};
  FakeSoundConverter converter;
  FakeWakeLock awake;
  ISD_rec window{{.MSComm1 = port,
                  .Ini = ini,
                  .Devices = devices,
                  .Events = events,
                  .Elapsed = events,
                  .Boxes = Boxes,
                  .CD = Dialog,
                  .Disk = Disk,
                  .Player = player,
                  .Converter = converter,
                  .Awake = awake,
                  .Strings = Strings,
                  .ProgramFolder = TESSARINE_PROGRAM_FOLDER},
                 nullptr};
};

TEST_F(PlaylistsUnderFaults, AreSavedOrToldNotToBe) {
  int tries = 0;
  const int rows = Find<SoundListView>(window, "SoundList").model()->rowCount();
  const auto wanted = [&] {
    std::string bytes = "\"" + SoundOf(tries % 3) + "\"\r\n";
    for (int row = 1; row < rows; ++row) {
      bytes += "\"\"\r\n";
    }
    return bytes;
  };
  WriteFile(list, "an older list");
  const int failures = FailAtEveryCallInWindow({.Folder = Folder.Path(),
                                                .Boxes = Boxes,
                                                .Save = [this] { Use("SaveList"); },
                                                .Stored = [this] { return ReadFile(list); },
                                                .Wanted = wanted,
                                                .Tells = IsErrorReport,
                                                .CanFailWhenDone = true},
                                               [&] { SetSound(0, SoundOf(++tries % 3)); });
  EXPECT_GT(failures, 15);
  EXPECT_TRUE(window.isVisible());
}

TEST_F(PlaylistsUnderFaults, AreTakenWholeOrNotAtAll) {
  WriteFile(list, "\"" + SoundOf(1) + "\"\r\n\"" + SoundOf(2) + "\"\r\n");
  const int failures = FailAtEveryCallInWindow({.Folder = Folder.Path(),
                                                .Boxes = Boxes,
                                                .Save = [this] { Use("OpenList"); },
                                                .Stored = [this] { return FileOf(0) + " " + FileOf(1); },
                                                .Wanted = [this] { return SoundOf(1) + " " + SoundOf(2); },
                                                .Tells = IsErrorReport},
                                               [this] {
                                                 SetSound(0, SoundOf(0));
                                                 SetSound(1, SoundOf(0));
                                               });
  EXPECT_GT(failures, 2);
  EXPECT_TRUE(window.isVisible());
}

}  // namespace
