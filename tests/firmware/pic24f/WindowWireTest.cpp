#include <gmock/gmock.h>

#include <QLabel>
#include <QTimer>
#include <optional>

#include "firmware/pic24f/SerialPicBoot.h"
#include "firmware/pic24f/frmBootload.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakePrograms.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/firmware/pic24f/WireSite.h"
#include "tests/support/Controls.h"

// The window on a real line with a simulated boot loader at its end.

namespace {

using sim::Pic24fFailure;
using testing::IsEmpty;
using testing::StartsWith;

class AnySelector : public DeviceSelector {
 public:
  void Open() override {}
  void ClearConfigBytes() override {}
  void AddConfigByte(const std::string& /*name*/, std::uint32_t /*address*/) override {}
};

class WindowOnTheWire : public testing::Test, protected WireSite {
 protected:
  /// Opens the window, imports a file and connects.
  void Connect(const sim::Pic24fLoaderSettings& settings) {
    loader.emplace(settings);
    window = std::make_unique<frmBootload>(
        frmBootload::Parts{.MakeLibrary =
                               [this](std::function<bool()> stopped) {
                                 return std::make_unique<SerialPicBoot>(SerialPicBoot::Parts{
                                     .Port = Port,
                                     .Events = Events,
                                     .DeviceOf = [this](const std::string&) { return loader->DevicePath(); },
                                     .Stopped = std::move(stopped)});
                               },
                           .Disk = Disk,
                           .Events = Events,
                           .CommonDialog1 = dialog,
                           .Boxes = Boxes,
                           .OtherPrograms = started,
                           .Ini = tessarineIni,
                           .Devices = devices,
                           .Strings = strings,
                           .Folder = {Folder.Path(), Folder.Path()},
                           .Selector = &selector},
        nullptr);
    window->show();
    WriteFile(Folder / "new.hex", Records(0, program) + HexFile::End());
    dialog.Answers = {Folder / "new.hex"};
    Press(*window, "cmdBrowse");
    Act("Run");
    Act("Connect");
  }

  void Act(const char* name) { Find<QAction>(*window, name).trigger(); }
  std::string Status() const { return Find<QLabel>(*window, "StatusPanel1").text().toStdString(); }
  Bytes Held() const { return loader->Traffic().Memory.Program(); }
  Bytes HoldingRows(std::size_t rows) const {
    return Holding(22'016, {{0, Bytes(program.begin(), program.begin() + static_cast<int>(256 * rows))}});
  }

  const Bytes program = ProgramBytes(0, 0x300);
  const StringTable strings{Language::English};
  FakeFileDialog dialog;
  FakeMessageBoxes Boxes;
  FakePrograms started;
  FakeSerialDevices devices;
  AnySelector selector;
  const IniReader tessarineIni{Disk, Folder / "tessarine.ini"};
  std::optional<sim::Pic24fLoader> loader;
  std::unique_ptr<frmBootload> window;
};

TEST_F(WindowOnTheWire, LoadsADevice) {
  Connect(Listed(Pic24fFailure::None, 1));
  EXPECT_EQ(Status(), "Device found...");
  EXPECT_EQ(Find<QLabel>(*window, "StatusPanel2").text().toStdString(), "PIC24FJ64GA002");
  EXPECT_EQ(Find<QLabel>(*window, "StatusPanel3").text().toStdString(), "v1.2");
  Boxes.Answers = {BoxAnswer::Yes};
  Act("Erase");
  EXPECT_EQ(Status(), "Finished operation...");
  Act("Write");
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_EQ(Held(), HoldingRows(3));
  EXPECT_TRUE(loader->Traffic().IsVerified);
  const std::size_t asked = loader->Traffic().Requests.size();
  Act("Run");
  EXPECT_EQ(Status(), "Run mode is set...");
  EXPECT_TRUE(loader->WaitUntilAsked(asked + 1, std::chrono::seconds(10)));
  EXPECT_TRUE(loader->Traffic().Runs);
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(loader->HostFaults(), IsEmpty());
}

TEST_F(WindowOnTheWire, ErasesAllButThePageOfTheConfigurationWords) {
  Connect(Listed(Pic24fFailure::None, 1));
  Boxes.Answers = {BoxAnswer::No};
  Act("Erase");
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_EQ(loader->Traffic().Requests.back(),
            (sim::Pic24fRequest{.Command = sim::Pic24fCommand::EraseProgram, .Count = 42}));
}

TEST_F(WindowOnTheWire, StartsTheEditorAfterADifference) {
  Connect(Listed(Pic24fFailure::LostRow, 2));
  Act("Write");
  EXPECT_EQ(Status(), "Verify error received...");
  ASSERT_EQ(started.Started.size(), 1U);
  EXPECT_EQ(started.Started[0], (std::vector<std::string>{"xdg-open", Folder / "verify.log"}));
  EXPECT_THAT(ReadFile(Folder / "verify.log"), StartsWith("Verify Error at 0x80 should be: 0x"));
  EXPECT_FALSE(loader->Traffic().IsVerified);
}

// Answers to a connection: version, identity and reset vector; those to a write come behind them.

TEST_F(WindowOnTheWire, TellsADeviceThatFallsSilentDuringAWrite) {
  Connect(Listed(Pic24fFailure::Silence, 5));
  Act("Write");
  EXPECT_EQ(Status(), "Failed to write device...");
  EXPECT_EQ(Held(), HoldingRows(1));
  EXPECT_FALSE(loader->Traffic().IsVerified);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(WindowOnTheWire, ReportsALostLineOnce) {
  Connect(Listed(Pic24fFailure::UnpluggedInAnswer, 5));
  Act("Write");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Boxes.Boxes[0].Text, StartsWith("Run-time error '8012'"));
  EXPECT_EQ(Held(), HoldingRows(1));
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(WindowOnTheWire, ConnectsToADeviceThatItDoesNotKnow) {
  Connect(Listed(Pic24fFailure::UnknownIdentity, 1));
  EXPECT_EQ(Status(), "Device found...");
  EXPECT_EQ(Find<QLabel>(*window, "StatusPanel2").text().toStdString(), "");
}

TEST_F(WindowOnTheWire, StopsAWriteWhenItIsClosed) {
  sim::Pic24fLoaderSettings slow = Listed(Pic24fFailure::None, 1);
  slow.RowTime = std::chrono::milliseconds(300);
  Connect(slow);
  // The acknowledgement of the first row takes its time.
  QTimer::singleShot(100, window.get(), [this] { window->close(); });
  Act("Write");
  EXPECT_FALSE(window->isVisible());
  EXPECT_LE(loader->Traffic().Requests.size(), 4U);
  EXPECT_FALSE(loader->Traffic().IsVerified);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  window.reset();
  EXPECT_FALSE(Port.PortOpen());
}

}  // namespace
