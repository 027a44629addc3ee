#pragma once

#include <string>
#include <vector>

#include "check/SystemChecks.h"
#include "tests/fakes/FakeComputer.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/support/DataSite.h"
#include "tests/support/TimeOfChange.h"

/// A computer that has everything, to be looked at.
class CheckedSite : public DataSite {
 public:
  explicit CheckedSite(Language language = Language::English) : DataSite(language) {
    PutDefaultFiles();
    for (const char* file : {"members.mdb", "scenarios.mdb"}) {
      SetTimeOfChange(DataFile(file), "2013-05-20 10:00:00");
    }
    Devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"};
  }

  SystemChecks Checks() {
    return SystemChecks({.Strings = Strings,
                         .Time = Time,
                         .Computer = Computer,
                         .Devices = Devices,
                         .Ini = Ini,
                         .Disk = Disk,
                         .Databases = Databases,
                         .UserDataFolder = DataFolder(),
                         .WordProcessor = [this] { return Word; },
                         .ChineseLetters = [this] { return Letters; },
                         .Screens = [this] { return Screens; },
                         .ReaderPort = [this] { return ReaderPort; },
                         .PathInUse =
                             [this](CheckSubject subject) {
                               return DataFile(subject == CheckSubject::Members ? Members : Missions);
                             },
                         .Release = Release});
  }

  FakeComputer Computer;
  FakeSerialDevices Devices;
  IniReader Ini{Disk, DataFolder() + "/tessarine.ini"};
  WordFinding Word = WordFinding::Ready;
  std::string Letters = "Noto Sans CJK SC";
  std::vector<std::string> Screens = {"Screen 1920 x 1080, scale 1", "Screen 1280 x 720, scale 1"};
  std::optional<std::int16_t> ReaderPort = 2;
  std::string Members = "members.mdb";
  std::string Missions = "scenarios.mdb";
  std::string Release = "3.54 21-5-2013";
};
