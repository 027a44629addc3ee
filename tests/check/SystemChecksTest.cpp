#include "check/SystemChecks.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/check/CheckedSite.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class LookedAt : public testing::Test {
 protected:
  std::vector<CheckItem> All(CheckSubject subject) {
    return site.Checks().Look(subject, [] { return true; });
  }
  CheckItem One(CheckSubject subject) {
    const std::vector<CheckItem> items = All(subject);
    EXPECT_EQ(items.size(), 1u);
    return items.empty() ? CheckItem() : items.front();
  }
  static CheckItem Fine(CheckSubject subject, const std::string& text) { return {subject, true, text}; }
  static CheckItem ToDo(CheckSubject subject, const std::string& text) { return {subject, false, text}; }

  CheckedSite site;
};

TEST_F(LookedAt, ThePortsAreFineOneByOne) {
  EXPECT_THAT(All(CheckSubject::Ports), ElementsAre(Fine(CheckSubject::Ports, "/dev/ttyS0"),
                                                    Fine(CheckSubject::Ports, "/dev/ttyUSB0")));
}

TEST_F(LookedAt, APortThatMayNotBeUsedSaysWhatToDo) {
  site.Computer.Forbidden = {"/dev/ttyUSB0"};
  EXPECT_EQ(All(CheckSubject::Ports).at(1),
            ToDo(CheckSubject::Ports,
                 "/dev/ttyUSB0 may not be used by you: log in at this computer itself, then unplug "
                 "the adapter and plug it in again; an adapter of another maker also needs a line in "
                 "/etc/tessarine/serial-ports."));
}

TEST_F(LookedAt, APortInUseNamesItsPrograms) {
  site.Computer.Users = {{"/dev/ttyUSB0", "minicom"}, {"/dev/ttyUSB0", "cat"}};
  EXPECT_EQ(All(CheckSubject::Ports).at(0), Fine(CheckSubject::Ports, "/dev/ttyS0"));
  EXPECT_EQ(All(CheckSubject::Ports).at(1),
            ToDo(CheckSubject::Ports, "/dev/ttyUSB0 is in use by minicom, cat: end that program."));
}

TEST_F(LookedAt, WithoutAPortAnAdapterIsAskedFor) {
  site.Devices.Ports.clear();
  EXPECT_EQ(One(CheckSubject::Ports),
            ToDo(CheckSubject::Ports, "There is no serial port: plug the adapter in."));
}

TEST_F(LookedAt, ThePortsOfTheSettingsCountToo) {
  site.Devices.Ports.clear();
  site.Devices.Others = {"/dev/serial/by-id/usb-1"};
  site.Ini.WriteIni("ports", "com1", "/dev/serial/by-id/usb-1");
  site.Ini.WriteIni("ports", "com2", "/dev/gone");
  EXPECT_EQ(One(CheckSubject::Ports), Fine(CheckSubject::Ports, "/dev/serial/by-id/usb-1"));
}

TEST_F(LookedAt, ThePortOfTheBaseUnitIsThatOfTheSettings) {
  site.Ini.WriteIni("comm", "commport", "2");
  EXPECT_EQ(One(CheckSubject::BaseUnit), Fine(CheckSubject::BaseUnit, "Port 2 is /dev/ttyUSB0"));
  site.Ini.WriteIni("comm", "commport", "3");
  EXPECT_EQ(One(CheckSubject::BaseUnit),
            ToDo(CheckSubject::BaseUnit,
                 "Port 3 is not there: plug the adapter in, or choose another port in Settings."));
  site.Ini.WriteIni("comm", "commport", "x");
  EXPECT_EQ(One(CheckSubject::BaseUnit),
            ToDo(CheckSubject::BaseUnit, "This could not be found out: Type mismatch"));
}

TEST_F(LookedAt, TheReaderHasItsOwnPort) {
  EXPECT_EQ(One(CheckSubject::Reader), Fine(CheckSubject::Reader, "Port 2 is /dev/ttyUSB0"));
  site.ReaderPort = 7;
  EXPECT_FALSE(One(CheckSubject::Reader).Fine);
}

TEST_F(LookedAt, AReaderThatIsNotSetUpSaysWhatToDo) {
  site.ReaderPort.reset();
  EXPECT_EQ(One(CheckSubject::Reader), ToDo(CheckSubject::Reader,
                                            "No reader is set up: if you have one, write its port into "
                                            "tessarine.ini, in the section [onewire] (see the manual)."));
}

TEST_F(LookedAt, AReaderOnThePortOfTheBaseUnitNeedsItsOwn) {
  site.Ini.WriteIni("comm", "commport", "2");
  EXPECT_EQ(One(CheckSubject::Reader),
            ToDo(CheckSubject::Reader,
                 "Port 2 is the base unit's port too: give the reader one of its own in "
                 "tessarine.ini, in the section [onewire]."));
}

TEST_F(LookedAt, ThePortsOfBaseUnitAndReaderMustBeUsableToo) {
  site.Ini.WriteIni("comm", "commport", "1");
  site.Computer.Forbidden = {"/dev/ttyS0"};
  site.Computer.Users = {{"/dev/ttyUSB0", "minicom"}};
  EXPECT_EQ(One(CheckSubject::BaseUnit),
            ToDo(CheckSubject::BaseUnit,
                 "/dev/ttyS0 may not be used by you: log in at this computer itself, "
                 "or have yourself added to the group dialout."));
  EXPECT_EQ(One(CheckSubject::Reader),
            ToDo(CheckSubject::Reader, "/dev/ttyUSB0 is in use by minicom: end that program."));
}

TEST_F(LookedAt, DataThatMayNotBeWrittenIsToldBeforeTheSpace) {
  EXPECT_TRUE(One(CheckSubject::Disk).Fine);
  std::filesystem::create_directory(site.DataFile("backups"));
  site.Computer.Forbidden = {site.DataFile("backups"), site.DataFile("members.mdb"),
                             site.DataFile("games.mdb")};
  const std::vector<CheckItem> items = All(CheckSubject::Disk);
  ASSERT_EQ(items.size(), 3U);
  EXPECT_EQ(items[0], ToDo(CheckSubject::Disk, "You may not write to " + site.DataFile("backups") +
                                                   ", so nothing can be saved there: have its owner or "
                                                   "permissions corrected."));
  EXPECT_THAT(items[1].Text, HasSubstr("members.mdb"));
  EXPECT_TRUE(items[2].Fine);
}

TEST_F(LookedAt, AClockBehindTheReleaseIsWrong) {
  site.Release = "3.54 21-5-2013 (3.54+20261120.0003)";
  site.Time.DateAndTime = "2026-11-19 00:00:00";  // where it is earlier than in the release's time zone
  EXPECT_TRUE(One(CheckSubject::Clock).Fine);
  site.Time.DateAndTime = "2026-11-18 23:59:59";
  EXPECT_EQ(One(CheckSubject::Clock), ToDo(CheckSubject::Clock,
                                           "The clock shows 2026-11-18 23:59:59, but this version of the "
                                           "program is younger: set the date and time."));
  site.Release = "3.54 21-5-2013 (3.54+20260301.0003)";
  site.Time.DateAndTime = "2026-02-28 00:00:00";
  EXPECT_TRUE(One(CheckSubject::Clock).Fine);
  for (const char* release : {"+", "+2026", "+20261301.0003", "+2026112x.0003", "3.54"}) {
    site.Release = release;
    EXPECT_TRUE(One(CheckSubject::Clock).Fine) << release;
  }
}

TEST_F(LookedAt, TheDatabaseInUseIsLookedAtAndTheOnePutAsideIsTold) {
  std::filesystem::copy_file(site.DataFile("members.mdb"), site.DataFile("members-new.mdb"));
  site.ChangeDatabase("members-new.mdb", "INSERT INTO Members (FirstName) VALUES ('Ada'), ('Bob')");
  site.Members = "members-new.mdb";
  std::filesystem::create_directory(site.DataFile("backups"));
  WriteFile(site.DataFile("backups/members-new-2013-05-20-201500.mdb"), "");
  WriteFile(site.DataFile("members.mdb"), "no database");
  const std::vector<CheckItem> items = All(CheckSubject::Members);
  ASSERT_EQ(items.size(), 2U);
  EXPECT_EQ(items[0], Fine(CheckSubject::Members, "2 rows, last copy: 2013-05-20 20:15:00"));
  EXPECT_FALSE(items[1].Fine);
  EXPECT_THAT(items[1].Text, testing::StartsWith("members.mdb cannot be used (Unrecognized database format"));
  EXPECT_THAT(items[1].Text,
              testing::EndsWith("so members-new.mdb is in use: end Tessarine, keep members.mdb "
                                "elsewhere, and give members-new.mdb its name."));
  std::filesystem::remove(site.DataFile("members.mdb"));
  EXPECT_TRUE(One(CheckSubject::Members).Fine);
}

TEST_F(LookedAt, WhatIsInstalledIsNamedAndWhatIsMissingToo) {
  EXPECT_EQ(One(CheckSubject::WordProcessor), Fine(CheckSubject::WordProcessor, "LibreOffice Writer"));
  EXPECT_EQ(One(CheckSubject::Chinese), Fine(CheckSubject::Chinese, "Noto Sans CJK SC"));
  site.Word = WordFinding::Missing;
  site.Letters.clear();
  EXPECT_THAT(One(CheckSubject::WordProcessor).Text, HasSubstr("install the package libreoffice-writer"));
  EXPECT_THAT(One(CheckSubject::Chinese).Text, HasSubstr("install the package fonts-noto-cjk"));
  EXPECT_FALSE(One(CheckSubject::WordProcessor).Fine || One(CheckSubject::Chinese).Fine);
}

TEST_F(LookedAt, PrintersAreNamed) {
  EXPECT_EQ(One(CheckSubject::Printer), Fine(CheckSubject::Printer, "Office"));
  site.Computer.AllPrinters.clear();
  EXPECT_THAT(One(CheckSubject::Printer).Text, HasSubstr("No printer is set up"));
}

TEST_F(LookedAt, APrintingSystemThatDoesNotRunIsToldWithWhatToDo) {
  site.Computer.PrinterFailure = RuntimeError(Fault::DeviceUnavailable, "scheduler is not running");
  EXPECT_EQ(
      One(CheckSubject::Printer),
      ToDo(CheckSubject::Printer,
           "The printing system does not answer (scheduler is not running): restart the computer, and if "
           "that does not help, have the service cups checked."));
}

TEST_F(LookedAt, TheWordProcessorIsFineOnlyOnceItHasBeenTried) {
  site.Word = WordFinding::Untried;
  EXPECT_EQ(One(CheckSubject::WordProcessor),
            ToDo(CheckSubject::WordProcessor,
                 "LibreOffice Writer is still being started: run System Check again in a few seconds."));
  site.Word = WordFinding::Ended;
  EXPECT_EQ(One(CheckSubject::WordProcessor),
            ToDo(CheckSubject::WordProcessor,
                 "LibreOffice Writer has ended: print a score sheet, which starts it again."));
}

TEST_F(LookedAt, ASecondScreenIsAskedFor) {
  EXPECT_EQ(One(CheckSubject::Screens),
            Fine(CheckSubject::Screens, "Screen 1920 x 1080, scale 1, Screen 1280 x 720, scale 1"));
  site.Screens.pop_back();
  EXPECT_THAT(One(CheckSubject::Screens).Text, HasSubstr("only one screen"));
}

TEST_F(LookedAt, TheClockMayNotBeBehindTheCopies) {
  EXPECT_EQ(One(CheckSubject::Clock), Fine(CheckSubject::Clock, "2013-05-21 14:30:05"));
  std::filesystem::create_directory(site.DataFile("backups"));
  WriteFile(site.DataFile("backups/members-2013-05-21-143005.mdb"), "");
  EXPECT_TRUE(One(CheckSubject::Clock).Fine);
  WriteFile(site.DataFile("backups/members-2013-05-21-153005.mdb"), "");
  EXPECT_TRUE(One(CheckSubject::Clock).Fine) << "the hour that clocks are put back by";
  WriteFile(site.DataFile("backups/members-2013-05-21-153006.mdb"), "");
  EXPECT_THAT(One(CheckSubject::Clock).Text, HasSubstr("set the date and time"));
}

TEST_F(LookedAt, TheClockMayNotBeBehindTheData) {
  for (const char* file : {"members.mdb", "scenarios.mdb", "games.mdb"}) {
    if (!site.Disk.FileExists(site.DataFile(file))) {
      WriteFile(site.DataFile(file), "");
    }
    SetTimeOfChange(site.DataFile(file), "2013-05-21 15:30:05");
    EXPECT_TRUE(One(CheckSubject::Clock).Fine) << file;
    SetTimeOfChange(site.DataFile(file), "2013-05-22 00:00:00");
    EXPECT_EQ(One(CheckSubject::Clock), ToDo(CheckSubject::Clock,
                                             "The clock shows 2013-05-21 14:30:05, but the program's data is "
                                             "younger: set the date and time."))
        << file;
    SetTimeOfChange(site.DataFile(file), "2013-05-20 10:00:00");
  }
}

TEST_F(LookedAt, AClockThatNoServerSetsIsARemarkAndNoFault) {
  site.Computer.Synchronised = false;
  EXPECT_EQ(One(CheckSubject::Clock),
            Fine(CheckSubject::Clock,
                 "2013-05-21 14:30:05 (not synchronised with a time server: compare it with a watch now and "
                 "then)"));
  site.Computer.Synchronised.reset();
  EXPECT_EQ(One(CheckSubject::Clock), Fine(CheckSubject::Clock, "2013-05-21 14:30:05"));
}

TEST_F(LookedAt, AClockWithoutABatteryIsSeen) {
  site.Time.DateAndTime = "1970-01-01 00:03:00";
  EXPECT_THAT(One(CheckSubject::Clock).Text, HasSubstr("The clock shows 1970-01-01 00:03:00"));
}

TEST_F(LookedAt, DatabasesTellTheirRowsAndLastCopy) {
  site.ChangeDatabase("members.mdb", "INSERT INTO Members (FirstName, LastName) VALUES ('Ada', 'Byron')");
  EXPECT_EQ(One(CheckSubject::Members), Fine(CheckSubject::Members, "1 rows, last copy: none yet"));
  std::filesystem::create_directory(site.DataFile("backups"));
  WriteFile(site.DataFile("backups/members-2013-05-20-201500.mdb"), "");
  WriteFile(site.DataFile("backups/members-2013-05-19-201500.mdb"), "");
  WriteFile(site.DataFile("backups/scenarios-2013-05-21-101500.mdb"), "");
  EXPECT_EQ(One(CheckSubject::Members),
            Fine(CheckSubject::Members, "1 rows, last copy: 2013-05-20 20:15:00"));
  EXPECT_TRUE(One(CheckSubject::Missions).Fine);
}

TEST_F(LookedAt, PastGamesNeedNotBeThere) {
  EXPECT_EQ(One(CheckSubject::Games), Fine(CheckSubject::Games, "none yet"));
}

TEST_F(LookedAt, ADamagedDatabaseSaysWhatToDoWithoutTheUsersName) {
  site.Computer.Home = site.Folder.Path();
  std::string bytes = ReadFile(site.DataFile("members.mdb"));
  bytes.replace(1024, bytes.size() - 1024, bytes.size() - 1024, '\xA5');
  WriteFile(site.DataFile("members.mdb"), bytes);
  const CheckItem item = One(CheckSubject::Members);
  EXPECT_FALSE(item.Fine);
  EXPECT_THAT(item.Text, HasSubstr("Members is damaged ("));
  EXPECT_THAT(item.Text, HasSubstr("put a copy in its place with Tools, Backup Copies."));
  EXPECT_THAT(item.Text, Not(HasSubstr(site.Folder.Path())));
  std::filesystem::remove(site.DataFile("scenarios.mdb"));
  EXPECT_FALSE(One(CheckSubject::Missions).Fine);
}

TEST_F(LookedAt, NothingIsChanged) {
  const std::string before = ReadFile(site.DataFile("members.mdb"));
  for (int subject = 0; subject < CheckSubjectCount; ++subject) {
    EXPECT_THAT(All(static_cast<CheckSubject>(subject)), Not(IsEmpty()));
  }
  EXPECT_EQ(ReadFile(site.DataFile("members.mdb")), before);
  EXPECT_FALSE(std::filesystem::exists(site.DataFile("games.mdb")));
}

TEST_F(LookedAt, ALargeDatabaseIsLeftWhenThatIsWanted) {
  site.ChangeDatabase("members.mdb",
                      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 20000) "
                      "INSERT INTO Members (FirstName, LastName) SELECT 'Ada' || i, 'Byron' FROM n");
  int asked = 0;
  EXPECT_THAT(site.Checks().Look(CheckSubject::Members, [&asked] { return ++asked < 3; }), IsEmpty());
  EXPECT_EQ(asked, 3);
}

}  // namespace
