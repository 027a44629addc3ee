#include "check/SystemCheck.h"

#include <gmock/gmock.h>

#include <QClipboard>
#include <QLabel>
#include <QPushButton>
#include <QTableWidget>

#include "platform/qt/QtEventPump.h"
#include "tests/check/CheckedSite.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"

namespace {

using testing::HasSubstr;
using testing::Not;

class WindowOfTheCheck : public testing::TestWithParam<Language> {
 protected:
  void Open() {
    window.emplace(SystemCheck::Parts{.Checks = checks,
                                      .Strings = site.Strings,
                                      .Boxes = site.Boxes,
                                      .Events = events,
                                      .Facts = {"Tessarine 3.54"}},
                   nullptr);
    Show(*window);
  }
  void WaitForTheEnd() {
    ASSERT_TRUE(
        QTest::qWaitFor([this] { return Find<QPushButton>(*window, "CopyReport").isEnabled(); }, 30'000));
  }
  std::vector<std::string> Column(int column) {
    auto& table = Find<QTableWidget>(*window, "CheckTable");
    std::vector<std::string> cells;
    for (int row = 0; row < table.rowCount(); ++row) {
      cells.push_back(table.item(row, column)->text().toStdString());
    }
    return cells;
  }

  CheckedSite site{GetParam()};
  const SystemChecks checks = site.Checks();
  QtEventPump events;
  std::optional<SystemCheck> window;
};

TEST_P(WindowOfTheCheck, TellsOfEachSubject) {
  Open();
  WaitForTheEnd();
  std::vector<std::string> names;
  for (int subject = 0; subject < CheckSubjectCount; ++subject) {
    names.push_back(NameOf(static_cast<CheckSubject>(subject), site.Strings));
  }
  names.insert(names.begin(), names.front());  // two ports
  EXPECT_EQ(Column(0), names);
  EXPECT_EQ(Column(1), std::vector<std::string>(names.size(), site.Strings.Text(OwnText::CheckFine)));
  EXPECT_TRUE(site.Boxes.Boxes.empty());
}

TEST_P(WindowOfTheCheck, CopiesAReportWithoutMembers) {
  site.ChangeDatabase("members.mdb",
                      "INSERT INTO Members (FirstName, LastName) VALUES ('Adaline', 'Byronette')");
  site.Computer.Users = {{"/dev/ttyUSB0", "minicom"}};
  Open();
  WaitForTheEnd();
  ::Press(*window, "CopyReport");
  const std::string report = QGuiApplication::clipboard()->text().toStdString();
  EXPECT_THAT(report, testing::StartsWith("Tessarine 3.54\n"));
  EXPECT_THAT(report, HasSubstr("minicom"));
  EXPECT_THAT(report, HasSubstr(site.Strings.Text(OwnText::CheckToDo)));
  EXPECT_THAT(report, Not(HasSubstr("Adaline")));
  EXPECT_EQ(Find<QLabel>(*window, "Status").text().toStdString(), site.Strings.Text(OwnText::CheckCopied));
}

TEST_P(WindowOfTheCheck, CanBeClosedBeforeItsEnd) {
  site.ChangeDatabase("members.mdb",
                      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 20000) "
                      "INSERT INTO Members (FirstName, LastName) SELECT 'Ada' || i, 'Byron' FROM n");
  Open();
  ASSERT_TRUE(QTest::qWaitFor([this] { return !Column(0).empty(); }, 30'000));
  window->close();
  EXPECT_TRUE(QTest::qWaitFor([this] { return !window->isVisible(); }, 30'000));
}

TEST_P(WindowOfTheCheck, IsCaredFor) {
  site.Computer.Forbidden = {"/dev/ttyS0", "/dev/ttyUSB0"};
  site.Screens.clear();
  Open();
  WaitForTheEnd();
  ExpectCaredFor(*window);
}

INSTANTIATE_TEST_SUITE_P(Languages, WindowOfTheCheck,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
