#include "exports/ExportGames.h"

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QComboBox>
#include <QDateEdit>
#include <QGroupBox>
#include <QLabel>
#include <QProgressBar>
#include <QRadioButton>

#include "tests/exports/CsvRows.h"
#include "tests/exports/FakeExportSource.h"
#include "tests/exports/SampleGame.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Captions.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ExportWindow : public testing::TestWithParam<Language> {
 protected:
  ExportWindow() { disk.AddFolder("/home/op"); }

  ExportGames& Open(bool hasGames = true) {
    window = std::make_unique<ExportGames>(
        ExportGames::Parts{.Game = hasGames ? ExportGames::ThisGame(sample.Games()) : nullptr,
                           .SuggestedName = "2026-11-21 2015 Courier",
                           .Past = past,
                           .Chosen = chosen,
                           .CommonDialog1 = dialog,
                           .Disk = disk,
                           .Boxes = boxes,
                           .Events = events,
                           .Time = clock,
                           .Strings = sample.Strings},
        nullptr);
    Show(*window);
    return *window;
  }

  void Choose(const char* format) const { Find<QRadioButton>(*window, format).click(); }
  void Tick(const char* box) const { Find<QCheckBox>(*window, box).click(); }

  /// Exports into this file.
  void ExportTo(const std::string& path) {
    dialog.Answers = {path};
    ::Press(*window, "ExportButton");
  }

  /// What the window says below its entries; empty without anything.
  std::string Outcome() const {
    const auto* label = window->findChild<QLabel*>(QStringLiteral("Outcome"));
    return label != nullptr && label->isVisible() ? label->text().toStdString() : std::string();
  }

  std::string In(const char* english, const char* chinese) const {
    return GetParam() == Language::English ? english : chinese;
  }

  std::string Bytes(const ExportChoice& choice) const {
    return ExportBytes(sample.Games(), choice, sample.Strings);
  }

  SampleGame sample{GetParam()};
  FakeExportSource past{GetParam()};
  std::vector<std::int64_t> chosen;
  FakeEventPump events;
  FakeClock clock;
  FakeFileDialog dialog;
  FakeFiles disk;
  FakeMessageBoxes boxes;
  std::unique_ptr<ExportGames> window;
};

TEST_P(ExportWindow, IsCaredForAndHasItsCaptions) {
  Open();
  ExpectCaredFor(*window);
  EXPECT_EQ(window->windowTitle().toStdString(), In("Export", "导出"));
  ExpectCaptions(
      *window,
      {{"WhichFrame", In("Which games", "导出哪些比赛")},
       {"WhichThis", In("The game on the board", "计分板上的比赛")},
       {"WhichPeriod", In("Past games of a period", "某段时间的历史比赛")},
       {"FormatFigures", In("Players with their main figures only, quick for many games (CSV)",
                            "仅含主要数据的玩家表格，适合大量比赛 (CSV)")},
       {"FormatFrame", In("What to export", "导出内容")},
       {"FormatPlayers", In("Players as a table (CSV)", "玩家表格 (CSV)")},
       {"FormatHits", In("Hits as a table (CSV)", "命中表格 (CSV)")},
       {"FormatJson",
        In("Players and hits for other programs (JSON)", "供其他程序使用的玩家和命中数据 (JSON)")},
       {"FormatPage", In("Web page to read or print (HTML)", "可阅读或打印的网页 (HTML)")},
       {"TableFrame", In("Table", "表格")},
       {"ByteOrderMark",
        In("Mark as UTF-8 for spreadsheets (byte-order mark)", "为电子表格标明 UTF-8 编码（字节顺序标记）")},
       {"PersonalFrame", In("Personal data", "个人信息")},
       {"PersonalNote", In("Players always appear by nickname or gun.", "玩家始终以昵称或枪号显示。")},
       {"PersonalTicks", In("Tick what is to be added this time:", "请勾选本次需要附加的内容：")},
       {"FullNames", In("First and last names", "姓名")},
       {"MemberNumbers", In("Member numbers", "会员编号")},
       {"Buttons", In("Numbers of membership buttons", "会员扣号码")},
       {"ExportButton", In("Export...", "导出……")},
       {"CloseButton", In("Close", "关闭")}});
  ExpectLabels(
      *window,
      {{"Separator", In("Separator", "分隔符")}, {"From", In("From", "从")}, {"To", In("to", "到")}});
  const auto& separators = Find<QComboBox>(*window, "Separator");
  EXPECT_EQ(separators.itemText(0).toStdString(), In("Comma", "逗号"));
  EXPECT_EQ(separators.itemText(1).toStdString(), In("Semicolon", "分号"));
  EXPECT_EQ(separators.itemText(2).toStdString(), In("Tab", "制表符"));
}

TEST_P(ExportWindow, WritesPlayersWithoutPersonalDataAtFirst) {
  Open();
  ExportTo("/home/op/players.csv");
  EXPECT_THAT(dialog.Calls, ElementsAre(FakeFileDialog::Call{
                                .Save = true,
                                .Filter = In("CSV files (*.csv)|*.csv", "CSV 文件 (*.csv)|*.csv"),
                                .Name = "2026-11-21 2015 Courier players.csv",
                                .Title = In("Export", "导出")}));
  EXPECT_EQ(disk.Contents().at("/home/op/players.csv"), Bytes({}));
  EXPECT_TRUE(disk.Contents().at("/home/op/players.csv").starts_with("\xEF\xBB\xBFgame,"));
  EXPECT_THAT(Outcome(), testing::StartsWith(In("Saved: ", "已保存：")));
  EXPECT_TRUE(window->isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_P(ExportWindow, WritesWhatIsChosen) {
  Open();
  Find<QComboBox>(*window, "Separator").setCurrentIndex(1);
  Tick("ByteOrderMark");
  for (const char* box : {"FullNames", "MemberNumbers", "Buttons"}) {
    Tick(box);
  }
  const std::pair<const char*, ExportFormat> formats[] = {{"FormatPlayers", ExportFormat::Players},
                                                          {"FormatHits", ExportFormat::Hits},
                                                          {"FormatJson", ExportFormat::Json},
                                                          {"FormatPage", ExportFormat::Page},
                                                          {"FormatFigures", ExportFormat::Figures}};
  for (const auto& [button, format] : formats) {
    Choose(button);
    ExportTo("/home/op/a");
    EXPECT_EQ(
        disk.Contents().at("/home/op/a"),
        Bytes({.Format = format, .Csv = {CsvSeparator::Semicolon, false}, .Personal = EverythingPersonal}))
        << button;
  }
}

TEST_P(ExportWindow, AddsOnlyWhatIsTicked) {
  const std::pair<const char*, PersonalData> ticks[] = {{"FullNames", {.FullNames = true}},
                                                        {"MemberNumbers", {.MemberNumbers = true}},
                                                        {"Buttons", {.Buttons = true}}};
  for (const auto& [box, personal] : ticks) {
    Open();
    Choose("FormatJson");
    Tick(box);
    ExportTo("/home/op/a");
    EXPECT_EQ(disk.Contents().at("/home/op/a"), Bytes({.Format = ExportFormat::Json, .Personal = personal}))
        << box;
  }
}

TEST_P(ExportWindow, KeepsAFileWithPersonalDataToTheUserAlone) {
  Open();
  Choose("FormatJson");
  ExportTo("/home/op/public");
  EXPECT_THAT(disk.Private, testing::IsEmpty());
  Tick("Buttons");
  ExportTo("/home/op/personal");
  EXPECT_THAT(disk.Private, testing::ElementsAre("/home/op/personal"));
}

TEST_P(ExportWindow, DoesNotRememberTheTicks) {
  Open();
  for (const char* box : {"FullNames", "MemberNumbers", "Buttons"}) {
    Tick(box);
  }
  window->close();
  Open();
  for (const char* box : {"FullNames", "MemberNumbers", "Buttons"}) {
    EXPECT_FALSE(Find<QCheckBox>(*window, box).isChecked()) << box;
  }
}

TEST_P(ExportWindow, EnablesWhatTheFormatHasUseFor) {
  Open();
  const auto enabled = [this] {
    return std::pair(Find<QGroupBox>(*window, "TableFrame").isEnabled(),
                     Find<QGroupBox>(*window, "PersonalFrame").isEnabled());
  };
  EXPECT_EQ(enabled(), std::pair(true, true));
  Choose("FormatFigures");
  EXPECT_EQ(enabled(), std::pair(true, true));
  Choose("FormatHits");
  EXPECT_EQ(enabled(), std::pair(true, false));
  Choose("FormatJson");
  EXPECT_EQ(enabled(), std::pair(false, true));
  Choose("FormatPage");
  EXPECT_EQ(enabled(), std::pair(false, true));
  Choose("FormatPlayers");
  EXPECT_EQ(enabled(), std::pair(true, true));
}

TEST_P(ExportWindow, WritesNothingWhenItsDialogIsCancelled) {
  Open();
  ExportTo("/home/op/a");
  dialog.Answers = {std::nullopt};
  ::Press(*window, "ExportButton");
  EXPECT_EQ(disk.Replaced.size(), 1U);
  EXPECT_EQ(Outcome(), "");
}

TEST_P(ExportWindow, AsksBeforeItReplacesAFile) {
  disk.Put("/home/op/a.csv", "mine");
  Open();
  boxes.Answers = {BoxAnswer::Cancel, BoxAnswer::Ok};
  ExportTo("/home/op/a.csv");
  EXPECT_EQ(disk.Contents().at("/home/op/a.csv"), "mine");
  EXPECT_EQ(Outcome(), "");
  ExportTo("/home/op/a.csv");
  EXPECT_EQ(disk.Contents().at("/home/op/a.csv"), Bytes({}));
  const FakeMessageBoxes::Box box{In("a.csv exists already. Replace it?", "a.csv 已存在。要替换吗？"),
                                  "Tessarine", BoxIcon::Question, BoxButtons::OkCancel};
  EXPECT_THAT(boxes.Boxes, ElementsAre(box, box));
}

TEST_P(ExportWindow, TellsWhenTheFileCannotBeWritten) {
  disk.FailReplace("/home/op/a.csv", RuntimeError(61, "Disk full: /home/op/a.csv"));
  Open();
  ExportTo("/home/op/a.csv");
  EXPECT_THAT(boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Run-time error '61': Disk full: /home/op/a.csv", "Tessarine",
                                                BoxIcon::Critical, BoxButtons::Ok}));
  EXPECT_EQ(Outcome(), "");
  EXPECT_TRUE(window->isVisible());
}

TEST_P(ExportWindow, SaysThatThereIsNoGame) {
  Open(false);
  EXPECT_FALSE(Find<QPushButton>(*window, "ExportButton").isEnabled());
  EXPECT_EQ(Outcome(), In("There is no game on the board.", "计分板上没有比赛。"));
}

TEST_P(ExportWindow, IsUsedByKeys) {
  Open();
  dialog.Answers = {"/home/op/a.csv"};
  Type(*window, Qt::Key_Return);
  EXPECT_EQ(disk.Replaced.size(), 1U);
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
}

TEST_P(ExportWindow, ExportsTheGamesThatWereChosenBefore) {
  chosen = {4, 9};
  Open();
  const auto& button = Find<QRadioButton>(*window, "WhichChosen");
  EXPECT_TRUE(button.isVisible());
  EXPECT_TRUE(button.isChecked());
  EXPECT_EQ(button.text().toStdString(), In("Chosen past games: 2", "选中的历史比赛：2 场"));
  ExportTo("/home/op/a.csv");
  EXPECT_EQ(dialog.Calls[0].Name, "games players.csv");
  EXPECT_THAT(past.Asked, ElementsAre(4, 9));
  const auto rows = CsvRecords(disk.Contents().at("/home/op/a.csv"));
  EXPECT_EQ(rows.size(), 6U);
  EXPECT_EQ(rows.back().at("mission"), "Game 9");
  EXPECT_EQ(Outcome(), In("Saved 2 games: /home/op/a.csv", "已保存 2 场比赛：/home/op/a.csv"));
}

TEST_P(ExportWindow, HidesTheChosenGamesWhereThereAreNone) {
  Open();
  EXPECT_FALSE(Find<QRadioButton>(*window, "WhichChosen").isVisible());
  EXPECT_TRUE(Find<QRadioButton>(*window, "WhichThis").isChecked());
}

TEST_P(ExportWindow, ExportsAPeriod) {
  past.Games = {1, 2, 3};
  Open(false);
  EXPECT_FALSE(Find<QDateEdit>(*window, "From").isEnabled());
  Choose("WhichPeriod");
  EXPECT_TRUE(Find<QDateEdit>(*window, "From").isEnabled());
  EXPECT_TRUE(Find<QPushButton>(*window, "ExportButton").isEnabled());
  EXPECT_EQ(Outcome(), "");
  Choose("FormatFigures");
  ExportTo("/home/op/a.csv");
  EXPECT_THAT(past.Periods, ElementsAre(std::pair("2013-05-01", "2013-05-21")));
  EXPECT_EQ(dialog.Calls[0].Name, "games 2013-05-01 2013-05-21 figures.csv");
  EXPECT_EQ(CsvRecords(disk.Contents().at("/home/op/a.csv")).size(), 9U);
  Find<QDateEdit>(*window, "To").setDate(QDate(2013, 5, 7));
  ExportTo("/home/op/a.csv");
  EXPECT_EQ(past.Periods.back(), std::pair(std::string("2013-05-01"), std::string("2013-05-07")));
}

TEST_P(ExportWindow, SaysThatAPeriodHasNoGames) {
  Open();
  Choose("WhichPeriod");
  ExportTo("/home/op/a.csv");
  EXPECT_THAT(dialog.Calls, IsEmpty());
  EXPECT_EQ(Outcome(), In("There are no games in this period.", "这段时间没有比赛。"));
}

TEST_P(ExportWindow, TellsHowManyGamesCouldNotBeRead) {
  chosen = {1, 2, 3};
  past.Damaged = {1, 3};
  Open();
  ExportTo("/home/op/a.csv");
  EXPECT_EQ(Outcome(),
            In("Saved 1 games: /home/op/a.csv  Games that cannot be read and are not in the file: 2",
               "已保存 1 场比赛：/home/op/a.csv  无法读取、未写入文件的比赛：2 场"));
}

TEST_P(ExportWindow, KeepsPastGamesWithPersonalDataToTheUserAlone) {
  chosen = {1};
  Open();
  Tick("MemberNumbers");
  ExportTo("/home/op/personal");
  EXPECT_THAT(disk.Private, ElementsAre("/home/op/personal"));
}

TEST_P(ExportWindow, StopsAndWritesNothing) {
  chosen.resize(100'000, 1);
  disk.Put("/home/op/a.csv", "mine");
  Open();
  boxes.Answers = {BoxAnswer::Ok};
  events.At(std::chrono::milliseconds(0), [&] {
    EXPECT_TRUE(Find<QProgressBar>(*window, "Progress").isVisible());
    EXPECT_FALSE(Find<QPushButton>(*window, "ExportButton").isEnabled());
    EXPECT_FALSE(Find<QGroupBox>(*window, "WhichFrame").isEnabled());
    ::Press(*window, "Stop");
  });
  ExportTo("/home/op/a.csv");
  EXPECT_EQ(disk.Contents().at("/home/op/a.csv"), "mine");
  EXPECT_EQ(Outcome(), In("Stopped. No file was written.", "已停止，没有写入文件。"));
  EXPECT_FALSE(Find<QPushButton>(*window, "Stop").isVisible());
  EXPECT_TRUE(Find<QPushButton>(*window, "ExportButton").isEnabled());
}

TEST_P(ExportWindow, ClosesInTheMiddleOfAnExport) {
  chosen.resize(100'000, 1);
  Open();
  events.At(std::chrono::milliseconds(0), [&] { window->close(); });
  ExportTo("/home/op/a.csv");
  EXPECT_FALSE(window->isVisible());
  EXPECT_FALSE(disk.FileExists("/home/op/a.csv"));
}

INSTANTIATE_TEST_SUITE_P(InBoth, ExportWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
