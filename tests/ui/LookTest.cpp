#include "ui/Look.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QHeaderView>
#include <QStyle>
#include <QTableWidget>

#include "tests/support/Contrast.h"

namespace {

QPalette Dark() {
  QPalette palette(QColor(50, 55, 60), QColor(45, 50, 55));
  palette.setColor(QPalette::PlaceholderText, Qt::black);
  return palette;
}

class Look : public testing::Test {
 protected:
  ~Look() override { QApplication::setPalette(before); }

  const QPalette before = QApplication::palette();
};

TEST_F(Look, OfListHeadersFollowsTheDesktop) {
  for (const auto& [palette, isDark] : {std::pair{before, false}, {Dark(), true}}) {
    QApplication::setPalette(palette);
    QTableWidget list(1, 1);
    list.setObjectName(QStringLiteral("DataList"));
    list.setHorizontalHeaderLabels({QString()});
    // The header was polished before the list had its name.
    list.style()->unpolish(list.horizontalHeader());
    list.style()->polish(list.horizontalHeader());
    const QImage header = list.horizontalHeader()->grab().toImage();
    EXPECT_EQ(header.pixelColor(header.width() / 4, 3).lightness() < 128, isDark);
  }
}

TEST_F(Look, KeepsPlaceholdersReadableOnADarkDesktop) {
  QApplication::setPalette(Dark());
  PrepareLook();
  EXPECT_GT(QApplication::palette().color(QPalette::PlaceholderText).lightness(), 128);
}

TEST_F(Look, KeepsPlaceholdersAndLinksReadableOnLightAndDarkDesktops) {
  for (const QPalette& desktop : {QPalette(QColor(0xef, 0xef, 0xef)), Dark()}) {
    QApplication::setPalette(desktop);
    PrepareLook();
    const QPalette palette = QApplication::palette();
    const QColor base = desktop.color(QPalette::Base);
    const QColor text = palette.color(QPalette::PlaceholderText);
    const double share = text.alphaF();
    const auto painted = [share](int over, int under) { return qRound(over * share + under * (1 - share)); };
    const QColor placeholder(painted(text.red(), base.red()), painted(text.green(), base.green()),
                             painted(text.blue(), base.blue()));
    EXPECT_GE(Contrast(placeholder.rgb(), base.rgb()), LeastContrast) << base.name().toStdString();
    EXPECT_GE(Contrast(palette.color(QPalette::Link).rgb(), base.rgb()), LeastContrast)
        << base.name().toStdString();
  }
}

}  // namespace
