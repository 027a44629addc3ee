#include "app/UploadProgress.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QProgressBar>

#include "tests/support/Controls.h"

namespace {

class UploadProgressWindow : public testing::Test {
 protected:
  std::string TextOf(const char* label) const { return Find<QLabel>(window, label).text().toStdString(); }

  /// Whether the animation's picture changes within a second.
  bool Moves() const {
    const auto& animation = Find<QWidget>(window, "Animation1");
    const QImage first = const_cast<QWidget&>(animation).grab().toImage();
    return QTest::qWaitFor([&] { return const_cast<QWidget&>(animation).grab().toImage() != first; }, 1000);
  }

  StringTable strings{Language::English};
  UploadProgress window{strings, nullptr};
  const QProgressBar& bar = Find<QProgressBar>(window, "Progress");
};

TEST_F(UploadProgressWindow, TakesItsCaptionFromTheStringTable) {
  EXPECT_EQ(window.windowTitle(), QStringLiteral("Upload Progress"));
  const StringTable chineseStrings(Language::SimplifiedChinese);
  const UploadProgress chinese(chineseStrings, nullptr);
  EXPECT_EQ(chinese.windowTitle(), QStringLiteral("上传进度"));
}

TEST_F(UploadProgressWindow, OpensAtTheStartOfItsRange) {
  window.Open();
  EXPECT_TRUE(window.isVisible());
  EXPECT_FALSE(window.isModal());
  EXPECT_EQ(bar.minimum(), 0);
  EXPECT_EQ(bar.maximum(), 224);
  EXPECT_EQ(bar.value(), 0);
  EXPECT_EQ(TextOf("UploadIndex"), "");
  int labels = 0;
  for (const QLabel* label : window.findChildren<QLabel*>()) {
    labels += label->buddy() == &bar && label->text() == QStringLiteral("Upload Progress:") ? 1 : 0;
  }
  EXPECT_EQ(labels, 1);
}

TEST_F(UploadProgressWindow, ShowsWhatItIsTold) {
  window.Open();
  window.SetMaximum(40);
  window.SetProgress(7);
  window.SetStatusText("Accepting Score Data...");
  EXPECT_EQ(bar.maximum(), 40);
  EXPECT_EQ(bar.value(), 7);
  EXPECT_EQ(TextOf("UploadIndex"), "7");
  EXPECT_EQ(TextOf("StatusText"), "Accepting Score Data...");
}

TEST_F(UploadProgressWindow, IsResetWhenItOpensAgain) {
  window.Open();
  window.SetMaximum(40);
  window.SetProgress(40);
  window.reject();
  window.Open();
  EXPECT_EQ(bar.maximum(), 224);
  EXPECT_EQ(bar.value(), 0);
  EXPECT_EQ(TextOf("UploadIndex"), "");
  EXPECT_FALSE(window.ClosedByOperator());
}

TEST_F(UploadProgressWindow, PlaysItsAnimationBetweenStartAndStop) {
  window.Open();
  EXPECT_FALSE(Moves());
  window.StartTransferAnim();
  EXPECT_TRUE(Moves());
  window.StopTransferAnim();
  EXPECT_FALSE(Moves());
  window.StartTransferAnim();
  window.Close();
  EXPECT_FALSE(Moves());
}

TEST_F(UploadProgressWindow, KnowsWhetherTheOperatorClosedIt) {
  window.Open();
  window.Close();
  EXPECT_FALSE(window.isVisible());
  EXPECT_FALSE(window.ClosedByOperator());
  window.Open();
  window.close();
  EXPECT_FALSE(window.isVisible());
  EXPECT_TRUE(window.ClosedByOperator());
}

TEST_F(UploadProgressWindow, IsNotClosedByEscape) {
  window.Open();
  QTest::keyClick(&window, Qt::Key_Escape);
  QTest::keyClick(&Find<QPushButton>(window, "Stop"), Qt::Key_Escape);
  QTest::keyClick(&window, Qt::Key_Return);
  EXPECT_TRUE(window.isVisible());
  EXPECT_FALSE(window.ClosedByOperator());
}

TEST_F(UploadProgressWindow, IsStoppedByItsButton) {
  for (const auto& [language, caption] : {std::pair{Language::English, QStringLiteral("Stop")},
                                          {Language::SimplifiedChinese, QStringLiteral("停止")}}) {
    const StringTable texts(language);
    UploadProgress opened(texts, nullptr);
    opened.Open();
    EXPECT_EQ(Find<QPushButton>(opened, "Stop").text(), caption);
    EXPECT_TRUE(Find<QPushButton>(opened, "Stop").isVisible());
    Press(opened, "Stop");
    EXPECT_FALSE(opened.isVisible());
    EXPECT_TRUE(opened.ClosedByOperator());
  }
}

// The platform of these tests brings every window to the front, whatever this says.
TEST_F(UploadProgressWindow, DoesNotAskForTheKeyboard) {
  EXPECT_TRUE(window.testAttribute(Qt::WA_ShowWithoutActivating));
}

}  // namespace
