#include "ui/StatusLine.h"

#include <gmock/gmock.h>

#include <QAccessible>
#include <QLabel>
#include <QToolButton>
#include <QVBoxLayout>

#include "tests/support/Announcements.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

QString Q(const char* text) {
  return QString::fromUtf8(text);
}

class StatusLines : public testing::Test {
 protected:
  StatusLines() {
    auto* column = new QVBoxLayout(&window);
    column->addWidget(line = new StatusLine);
    column->addStretch(1);
    window.resize(600, 200);
    ::Show(window);
  }

  /// The texts in view, from left to right and from the top.
  std::vector<std::string> Shown() const {
    QCoreApplication::processEvents();
    std::map<std::pair<int, int>, std::string> texts;
    for (const QWidget* control : line->findChildren<QWidget*>()) {
      if (control->isVisible()) {
        texts[{control->y(), control->x()}] = control->property("text").toString().toStdString();
      }
    }
    std::vector<std::string> shown;
    for (const auto& [place, text] : texts) {
      shown.push_back(text);
    }
    return shown;
  }

  QWidget window;
  StatusLine* line = nullptr;
};

TEST_F(StatusLines, ShowTheirEntriesInTheirOrder) {
  line->Show({{Q("A"), Q("first")}, {Q("B"), Q("second"), [] {}}});
  EXPECT_THAT(Shown(), ElementsAre("first", "second"));
  line->Show({{Q("C"), Q("before")}, {Q("B"), Q("then")}, {Q("A"), Q("last")}});
  EXPECT_THAT(Shown(), ElementsAre("before", "then", "last"));
  line->Show({{Q("A"), Q("")}});
  EXPECT_THAT(Shown(), IsEmpty());
  EXPECT_EQ(Find<QLabel>(*line, "A").text(), QString());
}

TEST_F(StatusLines, DoWhatALinkSaysByMouseAndKey) {
  int acts = 0;
  line->Show({{Q("A"), Q("first"), [&acts] { ++acts; }, Q("counts")}});
  QCoreApplication::processEvents();
  auto& link = Find<QToolButton>(*line, "ALink");
  EXPECT_EQ(link.toolTip(), Q("first\ncounts"));
  QTest::mouseClick(&link, Qt::LeftButton);
  EXPECT_EQ(acts, 1);
  QTest::keyClick(&link, Qt::Key_Space);
  EXPECT_EQ(acts, 2);
}

TEST_F(StatusLines, SurviveALinkThatChangesThem) {
  line->Show({{Q("A"), Q("first"), [this] { line->Show({{Q("B"), Q("other")}}); }}});
  QCoreApplication::processEvents();
  QTest::mouseClick(&Find<QToolButton>(*line, "ALink"), Qt::LeftButton);
  EXPECT_THAT(Shown(), ElementsAre("other"));
}

TEST_F(StatusLines, BeginANewLineWhereTheWindowIsNarrow) {
  line->Show({{Q("A"), Q("a text of some length")}, {Q("B"), Q("another text of some length")}});
  QCoreApplication::processEvents();
  const int oneLine = line->height();
  window.resize(220, 200);
  EXPECT_THAT(Shown(), ElementsAre("a text of some length", "another text of some length"));
  EXPECT_GT(line->height(), oneLine);
  EXPECT_GT(Find<QLabel>(*line, "B").y(), Find<QLabel>(*line, "A").y());
}

TEST_F(StatusLines, DoNotWidenTheirWindow) {
  line->Show({{Q("A"), QString(500, u'x')}});
  QCoreApplication::processEvents();
  EXPECT_LT(window.minimumSizeHint().width(), 200);
  EXPECT_LE(Find<QLabel>(*line, "A").width(), line->width());
}

TEST_F(StatusLines, HaveTextsAndLinksAtOneHeight) {
  line->Show({{Q("A"), Q("first")}, {Q("B"), Q("second"), [] {}}});
  QCoreApplication::processEvents();
  const auto middle = [this](const char* name) { return Find<QWidget>(*line, name).geometry().center().y(); };
  EXPECT_EQ(middle("A"), middle("BLink"));
}

TEST_F(StatusLines, KeepWhatBelongsTogetherOnOneLine) {
  const StatusLine::Entry first{Q("A"), Q("a text of some length")};
  const StatusLine::Entry second{Q("B"), Q("another text")};
  StatusLine::Entry joined{Q("C"), Q("its link"), [] {}};
  joined.Joins = true;
  line->Show({first, second, joined});
  QCoreApplication::processEvents();
  const auto& a = Find<QWidget>(*line, "A");
  const auto& b = Find<QWidget>(*line, "B");
  const auto& link = Find<QWidget>(*line, "CLink");
  const int apart = b.x() - a.geometry().right();
  EXPECT_LT(link.x() - b.geometry().right(), apart);
  window.resize(window.width() - line->width() + link.geometry().right(), 200);  // some pixels too narrow
  QCoreApplication::processEvents();
  EXPECT_GT(b.y(), a.geometry().bottom());
  EXPECT_GT(link.geometry().bottom(), b.y());
  EXPECT_GT(link.x(), b.x());
  joined.Joins = false;
  line->Show({first, second, joined});
  QCoreApplication::processEvents();
  EXPECT_LT(b.y(), a.geometry().bottom());
  EXPECT_GT(link.y(), b.geometry().bottom());
}

TEST_F(StatusLines, ShowTheEndOfATextThatIsTooLong) {
  const auto end = [this](const char* control) {
    QCoreApplication::processEvents();
    auto& widget = Find<QWidget>(*line, control);
    EXPECT_LT(widget.width(), widget.sizeHint().width());
    return widget.grab(QRect(widget.width() / 2, 0, widget.width() / 2, widget.height())).toImage();
  };
  for (const bool isLink : {false, true}) {
    const auto show = [&](const char* tail) {
      const QString text = QString(300, u'x') + Q(tail);
      line->Show({{Q("A"), text, isLink ? [] {} : std::function<void()>()}});
      return end(isLink ? "ALink" : "A");
    };
    EXPECT_NE(show("/first.xml"), show("/other.xml"));
  }
}

TEST_F(StatusLines, TakeNoAltLetterFromANameWithAnAmpersand) {
  int acts = 0;
  line->Show({{Q("A"), Q("Fish & Chips"), [&acts] { ++acts; }}});
  QCoreApplication::processEvents();
  auto& link = Find<QToolButton>(*line, "ALink");
  EXPECT_EQ(QAccessible::queryAccessibleInterface(&link)->text(QAccessible::Name), Q("Fish & Chips"));
  EXPECT_TRUE(link.shortcut().isEmpty());
}

TEST_F(StatusLines, AnnounceWhatIsNew) {
  const Announcements announced;
  line->Show({{Q("A"), Q("first")}, {Q("B"), Q("second")}});
  line->Show({{Q("A"), Q("first")}, {Q("B"), Q("changed"), [] {}}});
  EXPECT_THAT(announced.Heard(), ElementsAre(Q("A"), Q("B"), Q("BLink")));
}

}  // namespace
