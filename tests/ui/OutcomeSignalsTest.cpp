#include "ui/OutcomeSignals.h"

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QLabel>

#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/support/Controls.h"
#include "ui/OutcomeTones.h"

namespace {

using testing::IsEmpty;
using testing::SizeIs;

class Signals : public testing::Test {
 protected:
  Signals() { files.CreateFolder("/data"); }

  /// The widget with the settings as they are now.
  OutcomeSignals& Open(SoundPlayer* player) {
    widget = std::make_unique<OutcomeSignals>();
    widget->SetUp({ini, player, strings});
    Show(*widget);
    return *widget;
  }

  QLabel& Sign() const { return Find<QLabel>(*widget, "Sign"); }
  QCheckBox& Switch(const char* name) const { return Find<QCheckBox>(*widget, name); }

  FakeEventPump events;
  FakeFiles files;
  IniReader ini{files, "/data/tessarine.ini"};
  StringTable strings{Language::English};
  FakeSoundPlayer sounds{events};
  std::unique_ptr<OutcomeSignals> widget;
};

TEST_F(Signals, ShowASignAndPlayASoundUnlessSwitchedOff) {
  Open(&sounds).Tell(true, QStringLiteral("Good"));
  EXPECT_TRUE(Sign().isVisible());
  EXPECT_EQ(Sign().text(), QStringLiteral("\u2713 Good"));
  EXPECT_THAT(sounds.Played, SizeIs(1));
}

TEST_F(Signals, DifferInColourMarkAndSound) {
  Open(&sounds).Tell(true, QStringLiteral("x"));
  const QString good = Sign().styleSheet();
  widget->Tell(false, QStringLiteral("x"));
  EXPECT_NE(Sign().styleSheet(), good);
  EXPECT_EQ(Sign().text(), QStringLiteral("\u2717 x"));
  ASSERT_THAT(sounds.Played, SizeIs(2));
  EXPECT_NE(sounds.Played[0].Samples, sounds.Played[1].Samples);
}

TEST_F(Signals, AreTakenAway) {
  Open(&sounds).Tell(true, QStringLiteral("Good"));
  widget->Clear();
  EXPECT_TRUE(Sign().text().isEmpty());
  EXPECT_TRUE(Sign().styleSheet().isEmpty());
}

TEST_F(Signals, WriteNoSettingUntilTheOperatorChangesOne) {
  Open(&sounds).Tell(false, QStringLiteral("x"));
  EXPECT_FALSE(files.FileExists("/data/tessarine.ini"));
  Switch("SoundSwitch").click();
  EXPECT_EQ(ini.ReadIni(Keys::OutcomeSound), "0");
  EXPECT_EQ(ini.ReadSection("outcome").size(), 1U);
}

TEST_F(Signals, StaySwitchedOffInTheNextWindow) {
  Open(&sounds);
  Switch("SoundSwitch").click();
  Switch("SignSwitch").click();
  EXPECT_FALSE(Sign().isVisible());
  Open(&sounds).Tell(true, QStringLiteral("Good"));
  EXPECT_FALSE(Sign().isVisible());
  EXPECT_FALSE(Switch("SignSwitch").isChecked());
  EXPECT_FALSE(Switch("SoundSwitch").isChecked());
  EXPECT_THAT(sounds.Played, IsEmpty());
  Switch("SignSwitch").click();
  Switch("SoundSwitch").click();
  EXPECT_TRUE(Sign().isVisible());
  widget->Tell(true, QStringLiteral("Good"));
  EXPECT_THAT(sounds.Played, SizeIs(1));
  EXPECT_EQ(ini.ReadIni(Keys::OutcomeSign), "1");
}

TEST_F(Signals, SayWhenThereIsNoSoundDevice) {
  sounds.NoDevice = true;
  Open(&sounds).Tell(true, QStringLiteral("Good"));
  EXPECT_EQ(Switch("SoundSwitch").text(), QStringLiteral("Sound (no sound device)"));
  sounds.NoDevice = false;
  widget->Tell(true, QStringLiteral("Good"));
  EXPECT_EQ(Switch("SoundSwitch").text(), QStringLiteral("Sound"));
}

TEST_F(Signals, OfferNoSoundWithoutAPlayer) {
  Open(nullptr).Tell(true, QStringLiteral("Good"));
  EXPECT_FALSE(Switch("SoundSwitch").isEnabled());
  EXPECT_EQ(Sign().text(), QStringLiteral("\u2713 Good"));
}

TEST(OutcomeTones, BeginAndEndInSilence) {
  for (const auto& samples : {OutcomeTones::Success(), OutcomeTones::Failure()}) {
    ASSERT_GT(samples.size(), OutcomeTones::SamplesPerSecond / 5U);
    EXPECT_LT(samples.size(), static_cast<std::size_t>(OutcomeTones::SamplesPerSecond));
    EXPECT_NEAR(samples.front(), 128, 2);
    EXPECT_NEAR(samples.back(), 128, 2);
    EXPECT_GT(*std::max_element(samples.begin(), samples.end()), 200);
    EXPECT_LT(*std::min_element(samples.begin(), samples.end()), 56);
  }
}

}  // namespace
