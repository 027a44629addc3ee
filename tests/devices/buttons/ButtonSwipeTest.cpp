#include "devices/buttons/ButtonSwipe.h"

#include <gmock/gmock.h>

#include <QLabel>

#include "core/game/DallasId.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeOneWire.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::IsEmpty;

class ButtonSwipeWindow : public testing::Test {
 protected:
  static constexpr FakeOneWire::Rom Button = {0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};

  /// Does `act` after the first look at the reader.
  void AfterAPoll(const std::function<void()>& act) {
    wire.OnCall = [this, act](const std::string& operation) {
      if (operation == "TMEndSession" && !done_) {
        done_ = true;
        QTimer::singleShot(0, &window, act);
      }
    };
  }

  auto Polls() const { return std::count(wire.Log.begin(), wire.Log.end(), "TMNext"); }

  FakeOneWire wire;
  FakeMessageBoxes boxes;
  StringTable strings{Language::English};
  ButtonSwipe window{wire, boxes, strings, nullptr};
  QTimer& timer = Find<QTimer>(window, "Timer1");

 private:
  bool done_ = false;
};

TEST_F(ButtonSwipeWindow, AsksForTheButton) {
  EXPECT_EQ(window.windowTitle(), QStringLiteral("Button"));
  EXPECT_EQ(Find<QLabel>(window, "Instructions").text(),
            QStringLiteral("Insert Membership Button into the Reader now..."));
  EXPECT_EQ(Find<QPushButton>(window, "Cancel").text(), QStringLiteral("Cancel"));
  EXPECT_FALSE(Find<QLabel>(window, "Image1").pixmap().isNull());
}

TEST_F(ButtonSwipeWindow, PollsTenTimesASecondOnceItIsShown) {
  EXPECT_EQ(timer.interval(), 100);
  EXPECT_FALSE(timer.isActive());
  Show(window);
  EXPECT_TRUE(timer.isActive());
  EXPECT_THAT(wire.Log, IsEmpty());
}

TEST_F(ButtonSwipeWindow, GoesWithTheButtonThatWasRead) {
  AfterAPoll([this] { wire.Devices = {Button}; });
  window.exec();
  EXPECT_EQ(window.DallasID(), "EFCDAB8967452301");
  EXPECT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_FALSE(window.isVisible());
  EXPECT_FALSE(timer.isActive());
}

TEST_F(ButtonSwipeWindow, StaysWhileItTellsOfTheButton) {
  wire.Devices = {Button};
  bool visible = false;
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { visible = window.isVisible(); };
  window.exec();
  EXPECT_TRUE(visible);
}

/// The box is modal and events go on while it is open.
TEST_F(ButtonSwipeWindow, DoesNotPollWhileItTellsOfTheButton) {
  wire.Devices = {Button};
  boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
    QTimer later;
    bool over = false;
    QObject::connect(&later, &QTimer::timeout, &later, [&] { over = true; });
    later.start(3 * timer.interval());
    EXPECT_TRUE(QTest::qWaitFor([&] { return over; }));
  };
  window.exec();
  EXPECT_EQ(Polls(), 1);
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(ButtonSwipeWindow, GoesAtTheEndOfTheNextPollAfterCancel) {
  AfterAPoll([this] {
    Press(window, "Cancel");
    EXPECT_TRUE(window.isVisible());
  });
  window.exec();
  EXPECT_EQ(Polls(), 2);
  EXPECT_EQ(window.DallasID(), NoDallasId);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(ButtonSwipeWindow, ReturnsAButtonThatIsReadInThePollAfterCancel) {
  AfterAPoll([this] {
    Press(window, "Cancel");
    wire.Devices = {Button};
  });
  window.exec();
  EXPECT_EQ(window.DallasID(), "EFCDAB8967452301");
}

TEST_F(ButtonSwipeWindow, TakesTheCloseBoxForCancel) {
  AfterAPoll([this] {
    window.close();
    EXPECT_TRUE(window.isVisible());
  });
  window.exec();
  EXPECT_EQ(Polls(), 2);
  EXPECT_EQ(window.DallasID(), NoDallasId);
}

TEST_F(ButtonSwipeWindow, TakesEscapeForCancel) {
  AfterAPoll([this] { Type(window, Qt::Key_Escape); });
  window.exec();
  EXPECT_EQ(Polls(), 2);
}

TEST_F(ButtonSwipeWindow, DoesNotTakeReturnForCancel) {
  AfterAPoll([this] {
    QTest::keyClick(&window, Qt::Key_Return);
    wire.OnCall = [this](const std::string& operation) {
      if (operation == "TMEndSession" && Polls() == 4) {
        Press(window, "Cancel");
      }
    };
  });
  window.exec();
  EXPECT_EQ(Polls(), 4);
}

TEST_F(ButtonSwipeWindow, ForgetsTheLastButtonWhenItComesUpAgain) {
  wire.Devices = {Button};
  window.exec();
  ASSERT_EQ(window.DallasID(), "EFCDAB8967452301");
  wire.Devices.clear();
  AfterAPoll([this] { Press(window, "Cancel"); });
  window.exec();
  EXPECT_EQ(window.DallasID(), NoDallasId);
}

TEST_F(ButtonSwipeWindow, GoesWhenTheReaderDoesNotAnswer) {
  wire.Handle = 0;
  window.exec();
  EXPECT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_FALSE(timer.isActive());
}

TEST_F(ButtonSwipeWindow, GoesWhenTheDriverFails) {
  wire.Broken = "TMNext";
  window.exec();
  EXPECT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Title, "Driver Error");
  EXPECT_FALSE(timer.isActive());
}

class ButtonSwipeLook : public testing::TestWithParam<Language> {};

TEST_P(ButtonSwipeLook, IsCaredFor) {
  FakeOneWire wire;
  FakeMessageBoxes boxes;
  const StringTable strings(GetParam());
  ButtonSwipe window(wire, boxes, strings, nullptr);
  Show(window);
  ExpectCaredFor(window);
}

INSTANTIATE_TEST_SUITE_P(Languages, ButtonSwipeLook,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

}  // namespace
