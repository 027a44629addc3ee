#include "devices/charging/ChargeiButton.h"

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QLabel>
#include <QMetaObject>
#include <QTimer>

#include "tests/devices/charging/ButtonBus.h"
#include "tests/devices/charging/ChargingSite.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"
#include "ui/ResultList.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class ChargeWindow : public testing::TestWithParam<Language> {
 protected:
  ChargeWindow() { Open(); }

  void Open() {
    window = std::make_unique<ChargeiButton>(ChargeiButton::Parts{.Wire = bus,
                                                                  .Events = events,
                                                                  .Boxes = boxes,
                                                                  .Time = clock,
                                                                  .Strings = strings,
                                                                  .Charged = charged,
                                                                  .Signals = {ini, &sounds, strings}},
                                             nullptr);
    started = Timer().isActive();
    interval = Timer().interval();
    Timer().stop();  // ticks come from the test, however long the window takes to come up
    Show(*window);
  }

  QTimer& Timer() const { return Find<QTimer>(*window, "Timer1"); }

  void Ticks(int count) const {
    for (int i = 0; i < count; ++i) {
      QMetaObject::invokeMethod(&Timer(), "timeout", Qt::DirectConnection);
    }
  }

  MemoryButton& TouchedButton(const std::vector<std::uint8_t>& start) {
    const auto serial = static_cast<std::uint8_t>(bus.Buttons.size() + 1);
    MemoryButton& button = bus.Buttons.emplace_back(
        MemoryButton::Rom{0x0C, serial, 0, 0, 0, 0, 0, static_cast<std::uint8_t>(0xA0 + serial)});
    Fill(button, start);
    bus.Put(button);
    return button;
  }

  std::string TextOf(const char* label) const { return Find<QLabel>(*window, label).text().toStdString(); }
  ResultList& Results() const { return Find<ResultList>(*window, "Results"); }

  std::vector<std::string> Row(int row) const {
    std::vector<std::string> cells;
    for (int column = 0; column < 5; ++column) {
      cells.push_back(Results().item(row, column)->text().toStdString());
    }
    return cells;
  }

  std::string In(const char* english, const char* chinese) const {
    return GetParam() == Language::English ? english : chinese;
  }

  ButtonBus bus;
  FakeEventPump events;
  FakeMessageBoxes boxes;
  FakeClock clock;
  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  StringTable strings{GetParam()};
  FakeSoundPlayer sounds{events};
  ChargedButtons charged;
  std::unique_ptr<ChargeiButton> window;
  bool started = false;
  int interval = 0;
};

INSTANTIATE_TEST_SUITE_P(Languages, ChargeWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

TEST_P(ChargeWindow, AsksForAButtonAndPollsFiveTimesASecond) {
  EXPECT_EQ(window->windowTitle(), QStringLiteral("Charge iButton"));
  EXPECT_EQ(TextOf("Label1"), "Swipe iButton Now...");
  EXPECT_EQ(TextOf("StatusLabel"), "");
  EXPECT_FALSE(Find<QLabel>(*window, "Picture1").pixmap().isNull());
  EXPECT_EQ(Find<QPushButton>(*window, "Close").text(), QStringLiteral("Close"));
  EXPECT_TRUE(started);
  EXPECT_EQ(interval, 200);
  EXPECT_THAT(bus.Log, IsEmpty());
}

TEST_P(ChargeWindow, PollsByItself) {
  bool polled = false;
  bus.OnCall = [&](const std::string& operation) { polled = polled || operation == "TMEndSession"; };
  Timer().start();
  EXPECT_TRUE(QTest::qWaitFor([&] { return polled; }));
}

TEST_P(ChargeWindow, ShowsTheStatusUntilTheButtonLeaves) {
  MemoryButton& bandage = TouchedButton({1, 0});
  Ticks(3);
  EXPECT_EQ(TextOf("StatusLabel"), "Charged Bandage OK");
  bus.TakeAway(bandage);
  Ticks(2);
  EXPECT_EQ(TextOf("StatusLabel"), "");
}

TEST_P(ChargeWindow, ShowsTheWordsOfTheStatusNowhereElse) {
  TouchedButton({0, 0});
  Ticks(1);
  int labels = 0;
  for (const QLabel* label : window->findChildren<QLabel*>()) {
    labels += label->text().contains(QStringLiteral("Charged Mag OK")) ? 1 : 0;
  }
  EXPECT_EQ(labels, 1);
  for (int column = 0; column < 5; ++column) {
    EXPECT_NE(Row(0)[static_cast<std::size_t>(column)], "Charged Mag OK");
  }
}

TEST_P(ChargeWindow, ListsTheButtonsNewestFirst) {
  MemoryButton& mag = TouchedButton({0, 0});
  Ticks(1);
  bus.TakeAway(mag);
  MemoryButton& refusing = TouchedButton({1, 0});
  refusing.Protected = true;
  Ticks(3);
  EXPECT_THAT(Row(0), ElementsAre("2", "14:30:05", In("Bandage", "绷带"), "A20000000000020C",
                                  In("Different when read back", "回读不一致")));
  EXPECT_THAT(Row(1), ElementsAre("1", "14:30:05", In("Ammo Mag", "弹匣"), "A10000000000010C",
                                  In("Charged", "已充值")));
  EXPECT_NE(Results().item(0, 0)->background().style(), Qt::NoBrush);
  EXPECT_EQ(Results().item(1, 0)->background().style(), Qt::NoBrush);
}

TEST_P(ChargeWindow, ListsWhatWasNotChargedAndWhy) {
  TouchedButton({9, 0});
  Ticks(1);
  EXPECT_THAT(Row(0), ElementsAre("1", "14:30:05", "9", "A10000000000010C",
                                  In("Unknown, not charged", "类型未知，未充值")));
  MemoryButton& gone = TouchedButton({1, 0});
  bus.BeforeByte = [&](std::size_t) { bus.TakeAway(gone); };
  Ticks(4);
  EXPECT_THAT(Row(0), ElementsAre("2", "14:30:05", "", "A20000000000020C", In("Not read", "未能读取")));
}

TEST_P(ChargeWindow, FindsItsListAgain) {
  TouchedButton({0, 0});
  Ticks(1);
  Press(*window, "Close");
  Open();
  ASSERT_EQ(Results().rowCount(), 1);
  EXPECT_EQ(Row(0)[3], "A10000000000010C");
}

TEST_P(ChargeWindow, CountsOnWhereTheListNoLongerHoldsTheFirstButtons) {
  for (std::size_t i = 0; i < ChargedButtons::Most + 2; ++i) {
    charged.Add({"09:00:00", 0, "A10000000000010C", ChargeResult::Charged});
  }
  Open();
  TouchedButton({0, 0});
  Ticks(1);
  EXPECT_EQ(Results().rowCount(), static_cast<int>(ChargedButtons::Most));
  EXPECT_EQ(Row(0)[0], "503");
  EXPECT_EQ(Row(1)[0], "502");
  EXPECT_EQ(Row(Results().rowCount() - 1)[0], "4");
}

TEST_P(ChargeWindow, SignalsWhatTheReadingBackShowed) {
  MemoryButton& mag = TouchedButton({0, 0});
  Ticks(3);
  EXPECT_EQ(TextOf("Sign"), In("\u2713 Charged", "\u2713 已充值"));
  ASSERT_THAT(sounds.Played, SizeIs(1));
  bus.TakeAway(mag);
  MemoryButton& refusing = TouchedButton({0, 0});
  refusing.Protected = true;
  Ticks(1);
  EXPECT_EQ(TextOf("StatusLabel"), "Charged Mag OK");
  EXPECT_EQ(TextOf("Sign"), In("\u2717 Different when read back", "\u2717 回读不一致"));
  ASSERT_THAT(sounds.Played, SizeIs(2));
  EXPECT_NE(sounds.Played[0], sounds.Played[1]);
}

TEST_P(ChargeWindow, SignalsAButtonThatCannotBeReadOnlyOnce) {
  TouchedButton({0, 0});
  bus.FailingAccesses = 9;
  Ticks(7);
  EXPECT_EQ(Results().rowCount(), 1);
  EXPECT_THAT(sounds.Played, SizeIs(1));
}

TEST_P(ChargeWindow, KeepsTheSignOfAButtonThatCannotBeRead) {
  TouchedButton({0, 0});
  bus.FailingAccesses = 9;
  for (int tick = 0; tick < 7; ++tick) {
    Ticks(1);
    EXPECT_EQ(TextOf("Sign"), In("\u2717 Not read", "\u2717 未能读取")) << tick;
  }
}

TEST_P(ChargeWindow, SignalsAButtonThatCannotBeReadAtEachTouch) {
  MemoryButton& mag = TouchedButton({0, 0});
  bus.FailingAccesses = 6;
  Ticks(1);
  bus.TakeAway(mag);
  Ticks(4);
  bus.Put(mag);
  Ticks(4);
  EXPECT_EQ(Results().rowCount(), 2);
  EXPECT_THAT(sounds.Played, SizeIs(2));
}

TEST_P(ChargeWindow, SignalsAButtonThatCannotBeReadWhenItIsOpenedAgainToo) {
  TouchedButton({0, 0});
  bus.FailingAccesses = 6;
  Ticks(1);
  Press(*window, "Close");
  Open();
  Ticks(1);
  EXPECT_EQ(Results().rowCount(), 2);
  EXPECT_THAT(sounds.Played, SizeIs(2));
}

TEST_P(ChargeWindow, TakesTheSignAwayWhileItAsks) {
  MemoryButton& mag = TouchedButton({0, 0});
  Ticks(1);
  bus.TakeAway(mag);
  MemoryButton& torn = TouchedButton({1, 0});
  torn.Memory[63] ^= 1;
  std::string signAtBox = "none";
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { signAtBox = TextOf("Sign"); };
  Ticks(4);
  EXPECT_EQ(signAtBox, "");
}

TEST_P(ChargeWindow, TellsOfAMissingReaderOnceAndLooksEveryTwoSeconds) {
  const auto& line = Find<QLabel>(*window, "ReaderLabel");
  EXPECT_FALSE(line.isVisible());
  bus.Handle = 0;
  Ticks(1);
  EXPECT_THAT(boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Error loading button driver", "Button Error",
                                                             BoxIcon::None}));
  EXPECT_EQ(Timer().interval(), 2000);
  EXPECT_TRUE(line.isVisible());
  EXPECT_EQ(line.text().toStdString(), In("No reader", "没有读取器"));
  Ticks(3);
  EXPECT_THAT(boxes.Boxes, SizeIs(1));
  bus.Handle = 7;
  Ticks(1);
  EXPECT_EQ(Timer().interval(), 200);
  EXPECT_FALSE(line.isVisible());
  bus.Handle = 0;
  Ticks(1);
  EXPECT_THAT(boxes.Boxes, SizeIs(2));
}

TEST_P(ChargeWindow, CountsTheTwoSecondsFromTheEndOfTheBox) {
  bus.Handle = 0;
  Timer().start();
  int remaining = 0;
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { EXPECT_EQ(Timer().interval(), 200); };
  Ticks(1);
  remaining = Timer().remainingTime();
  EXPECT_GT(remaining, 1700);
}

TEST_P(ChargeWindow, ReportsADriverThatFailsOnce) {
  bus.Broken = "TMNext";
  Ticks(3);
  ASSERT_THAT(boxes.Boxes, SizeIs(1));
  EXPECT_THAT(boxes.Boxes[0].Text, testing::StartsWith("Run-time error '53'"));
  EXPECT_EQ(Timer().interval(), 2000);
}

TEST_P(ChargeWindow, PollsNotWhileItAsks) {
  MemoryButton& torn = TouchedButton({1, 0});
  torn.Memory[63] ^= 1;
  long sessions = 0;
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) {
    Ticks(2);
    sessions = std::count(bus.Log.begin(), bus.Log.end(), "TMExtendedStartSession 1 5");
  };
  Ticks(1);
  EXPECT_EQ(sessions, 1);
}

TEST_P(ChargeWindow, ClosesByButtonEscapeAndCloseBoxEvenInATick) {
  const std::function<void()> ways[] = {[this] { Press(*window, "Close"); },
                                        [this] { Type(*window, Qt::Key_Escape); },
                                        [this] { window->close(); }};
  for (const auto& close : ways) {
    Open();
    close();
    EXPECT_FALSE(window->isVisible());
    Open();
    bus.OnCall = [&](const std::string& operation) {
      if (operation == "TMNext") {
        close();
      }
    };
    Ticks(1);
    EXPECT_FALSE(window->isVisible());
    bus.OnCall = {};
  }
  EXPECT_FALSE(bus.SessionOpen());
}

TEST_P(ChargeWindow, EndsAWriteSilentlyWhenItIsClosedInIt) {
  MemoryButton& mag = TouchedButton({0, 0});
  bus.BeforeByte = [this](std::size_t byte) {
    constexpr std::size_t inTheWrite = 40;
    if (byte == inTheWrite) {
      window->close();
    }
  };
  Ticks(1);
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(mag.Copies, 1U);
  EXPECT_THAT(charged.All(), SizeIs(1));
  EXPECT_THAT(sounds.Played, IsEmpty());
}

TEST_P(ChargeWindow, IsCaredForWithAndWithoutButtons) {
  ExpectCaredFor(*window);
  MemoryButton& refusing = TouchedButton({1, 0});
  refusing.Protected = true;
  Ticks(1);
  ExpectCaredFor(*window);
  bus.Handle = 0;
  Ticks(1);
  ExpectCaredFor(*window);
}

}  // namespace
