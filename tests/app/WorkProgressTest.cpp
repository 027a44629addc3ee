#include "app/WorkProgress.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QPushButton>

#include "tests/fakes/FakeEventPump.h"
#include "tests/support/Controls.h"

namespace {

class ProgressOfWork : public testing::TestWithParam<Language> {
 protected:
  static const QProgressDialog* Shown() {
    for (const QWidget* window : QApplication::topLevelWidgets()) {
      const auto* progress = qobject_cast<const QProgressDialog*>(window);
      if (progress != nullptr && progress->isVisible()) {
        return progress;
      }
    }
    return nullptr;
  }

  QWidget main;
  FakeEventPump events;
  StringTable strings{GetParam()};
  WorkProgress::Parts parts{.Window = main, .Events = events, .Strings = strings};
};

TEST_P(ProgressOfWork, IsNotShownForAMoment) {
  WorkProgress progress(parts, OwnText::CuttingNumbers, std::chrono::hours(1));
  EXPECT_TRUE(progress.GoOn(0.5));
  EXPECT_EQ(Shown(), nullptr);
}

TEST_P(ProgressOfWork, TellsWhatIsDoneAndHowFarItIs) {
  {
    WorkProgress progress(parts, OwnText::CuttingNumbers, std::chrono::milliseconds(0));
    EXPECT_TRUE(progress.GoOn(0.25));
    const QProgressDialog* window = Shown();
    ASSERT_NE(window, nullptr);
    EXPECT_EQ(window->value(), 250);
    EXPECT_TRUE(window->labelText().contains(QString::fromStdString(strings.Text(OwnText::CuttingNumbers))));
  }
  EXPECT_EQ(Shown(), nullptr);
}

TEST_P(ProgressOfWork, EndsWithStop) {
  WorkProgress progress(parts, OwnText::CuttingNumbers, std::chrono::milliseconds(0));
  EXPECT_TRUE(progress.GoOn(0.25));
  auto* stop = Shown()->findChild<QPushButton*>();
  ASSERT_NE(stop, nullptr);
  EXPECT_EQ(stop->text().toStdString(), strings.Text(OwnText::Stop));
  stop->click();
  EXPECT_FALSE(progress.GoOn(0.5));
}

INSTANTIATE_TEST_SUITE_P(BothLanguages, ProgressOfWork,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
