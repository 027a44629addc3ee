// Game files that other starts of the program bring to the main window.

#include <gmock/gmock.h>

#include <QDialog>

#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class OpenedFile : public testing::Test {
 protected:
  OpenedFile() { WriteFile(File(), GameFile(PlayerOf(65), "Free For All")); }

  std::string File() const { return venue.Folder / "Friday.game.xml"; }

  /// Opens the file and gives the window the time that it needs.
  void Open() {
    venue.Window->Open(File());
    ASSERT_TRUE(QTest::qWaitFor([this] { return venue.Boxes.Boxes.size() > 0 || IsLoaded(); }, WaitLimit));
  }
  bool IsLoaded() const { return venue.Column("ScoreDisplay", 1) == std::vector<std::string>{"Yellow  0"}; }
  /// What the status line says about a file that waits.
  std::string Waiting() const {
    const auto* entry = venue.Window->findChild<QWidget*>(QStringLiteral("FileWaits"));
    return entry != nullptr && entry->isVisible() ? entry->property("text").toString().toStdString()
                                                  : std::string();
  }

  static constexpr int WaitLimit = 20'000;  ///< milliseconds
  Venue venue;
};

TEST_F(OpenedFile, IsLoadedAsLoadGameDoes) {
  venue.Start();
  Open();
  EXPECT_TRUE(IsLoaded());
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 1);
  EXPECT_THAT(venue.Dialog.Calls, IsEmpty());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  venue.Trigger("mnuSaveScores");
  EXPECT_EQ(venue.Dialog.Calls.back().Name, File());
}

TEST_F(OpenedFile, HasTheBoxesOfLoadGame) {
  venue.Start();
  WriteFile(File(), "<Other/>");
  Open();
  const std::vector<FakeMessageBoxes::Box> opened = venue.Boxes.Boxes;
  venue.Boxes.Boxes.clear();
  venue.LoadGame("<Other/>");
  EXPECT_EQ(opened, venue.Boxes.Boxes);
  EXPECT_EQ(opened.size(), 1u);
}

TEST_F(OpenedFile, ThatIsMissingIsReported) {
  venue.Start();
  std::filesystem::remove(File());
  Open();
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1u);
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "Unable to open Game file.");
}

TEST_F(OpenedFile, WaitsForTheWindowToBeShown) {
  venue.PutDefaultFiles();
  venue.MakeWindow().Open(File());
  venue.Window->FormLoad();
  QCoreApplication::processEvents();
  EXPECT_FALSE(IsLoaded());
  Show(*venue.Window);
  EXPECT_TRUE(QTest::qWaitFor([this] { return IsLoaded(); }, WaitLimit));
}

TEST_F(OpenedFile, WaitsWhileABoxIsOpen) {
  venue.Start();
  venue.Boxes.WhileOpen = [this](const auto& /*box*/) {
    venue.Window->Open(File());
    EXPECT_TRUE(QTest::qWaitFor([this] { return !Waiting().empty(); }, WaitLimit));
    EXPECT_EQ(Waiting(), "Friday.game.xml is loaded once the open window or command has ended");
    EXPECT_FALSE(IsLoaded());
  };
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Trigger("mnuClearScores");
  venue.Boxes.WhileOpen = nullptr;
  EXPECT_TRUE(QTest::qWaitFor([this] { return IsLoaded(); }, WaitLimit));
  EXPECT_EQ(Waiting(), "");
}

TEST_F(OpenedFile, WaitsWhileAWindowIsOpen) {
  venue.Start();
  const WhileModal<QDialog> settings([this](QDialog& window) {
    venue.Window->Open(File());
    EXPECT_TRUE(QTest::qWaitFor([this] { return !Waiting().empty(); }, WaitLimit));
    EXPECT_FALSE(IsLoaded());
    window.close();
  });
  venue.Trigger("mnuCommPort");
  EXPECT_EQ(settings.Runs(), 1);
  EXPECT_TRUE(QTest::qWaitFor([this] { return IsLoaded(); }, WaitLimit));
}

TEST_F(OpenedFile, ReplacesAGameThatIsKeptWithoutAQuestion) {
  venue.Start();
  venue.LoadGame(SmallGame());
  venue.ActiveMission().setCurrentIndex(1);
  Open();
  EXPECT_TRUE(IsLoaded());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(OpenedFile, ReplacesAGameThatIsNeitherSavedNorKeptOnlyWhenTheOperatorWantsIt) {
  venue.Start();
  std::filesystem::create_directory(venue.DataFile("games.mdb"));
  venue.LoadGame(SmallGame());
  venue.ActiveMission().setCurrentIndex(1);
  venue.Boxes.Answers = {BoxAnswer::Cancel, BoxAnswer::Ok};
  Open();
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
  const FakeMessageBoxes::Box question{
      "The game on the board is not saved. Replace it with the game in Friday.game.xml?", "Tessarine",
      BoxIcon::Question, BoxButtons::OkCancel};
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(question));
  venue.Window->Open(File());
  EXPECT_TRUE(QTest::qWaitFor([this] { return IsLoaded(); }, WaitLimit));
}

TEST_F(OpenedFile, IsTheLastOfSeveral) {
  venue.Start();
  venue.Window->Open(venue.Folder / "missing.game.xml");
  Open();
  EXPECT_TRUE(IsLoaded());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(OpenedFile, SaysWhichOfSeveralWasLeftOut) {
  venue.Start();
  const auto leftOut = [this] {
    const auto* line = venue.Window->findChild<QWidget*>(QStringLiteral("FileLeftOut"));
    return line == nullptr ? std::string() : line->property("text").toString().toStdString();
  };
  venue.Window->Open(venue.Folder / "Monday.game.xml");
  EXPECT_EQ(leftOut(), "");
  Open();
  EXPECT_EQ(leftOut(), "Monday.game.xml was not loaded, since another file came after it");
  Open();
  EXPECT_EQ(leftOut(), "") << "this one came alone";
}

TEST_F(OpenedFile, BringsAWindowInTheTaskBarBack) {
  venue.Start();
  venue.Window->setWindowState(Qt::WindowMinimized);
  venue.Window->ComeToFront("token");
  EXPECT_FALSE(venue.Window->isMinimized());
  EXPECT_TRUE(QTest::qWaitFor([this] { return venue.Window->isActiveWindow(); }, WaitLimit));
  EXPECT_FALSE(qEnvironmentVariableIsSet("XDG_ACTIVATION_TOKEN")) << "other programs would inherit it";
}

/// Notes the desktop's permission that the toolkit finds when a window is raised.
class TokenWhenRaised : public QObject {
 public:
  QByteArray Token;

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override {
    if (event->type() == QEvent::ZOrderChange) {
      Token = qgetenv("XDG_ACTIVATION_TOKEN");
    }
    return QObject::eventFilter(watched, event);
  }
};

TEST_F(OpenedFile, HandsTheDesktopsPermissionToTheToolkit) {
  venue.Start();
  TokenWhenRaised raised;
  venue.Window->installEventFilter(&raised);
  venue.Window->ComeToFront("token-7");
  EXPECT_EQ(raised.Token, "token-7");
}

}  // namespace
