#include "sim/recorder/SoundRecorder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <optional>
#include <sstream>
#include <tuple>

#include "sim/recorder/RecorderReport.h"
#include "tests/sim/recorder/RecorderHost.h"

namespace sim {
namespace {

using std::chrono::milliseconds;
using testing::Contains;
using Kind = RecorderCommandKind;
using Sounds = std::map<std::uint8_t, Bytes>;

bool ComesToFault(const SoundRecorder& recorder, const std::string& fault) {
  for (std::size_t count = 1; recorder.WaitUntilHostFaults(count, Limit); ++count) {
    if (recorder.HostFaults().at(count - 1) == fault) {
      return true;
    }
  }
  return false;
}

TEST(SoundRecorder, TakesTableAndPagesInAGun) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Gun);
  RecordTwoInProduct(host);
  EXPECT_TRUE(host.IsSilent());
  ASSERT_TRUE(recorder.WaitUntilRecorded(1, Limit));
  const SoundRecorderTraffic traffic = recorder.Traffic();
  const SoundChip::Table table = *traffic.Chip.IndexTable();
  EXPECT_EQ(Bytes(table.begin(), table.end()), TableOfTwo);
  EXPECT_EQ(traffic.Chip.AllPages(), RisingPage + SilentPage + SilentPage);
  EXPECT_EQ(traffic.Chip.Sounds(), (Sounds{{0, RisingPage + SilentPage}, {1, SilentPage}}));
  EXPECT_EQ(traffic.Commands, (std::vector<RecorderCommand>{{Kind::Start},
                                                            {Kind::Erase},
                                                            {Kind::Page, 0},
                                                            {Kind::Page, 0},
                                                            {Kind::Page, 1},
                                                            {Kind::Page, 2},
                                                            {Kind::End}}));
}

TEST(SoundRecorder, TakesSoundBySoundStandAlone) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Alone);
  RecordTwoStandAlone(host);
  EXPECT_TRUE(host.IsSilent());
  ASSERT_TRUE(recorder.WaitUntilRecorded(1, Limit));
  const SoundRecorderTraffic traffic = recorder.Traffic();
  EXPECT_EQ(traffic.Chip.Sounds(), (Sounds{{0, RisingPage + SilentPage}, {9, SilentPage}}));
  EXPECT_EQ(traffic.Chip.IndexTable(), std::nullopt);
  EXPECT_EQ(traffic.Commands,
            (std::vector<RecorderCommand>{
                {Kind::Start}, {Kind::Erase}, {Kind::Header, 0}, {Kind::Header, 9}, {Kind::End}}));
}

TEST(SoundRecorder, TakesARecordingWithoutSounds) {
  SoundRecorder recorder(Quick());
  {
    RecorderHost host(recorder.DevicePath(), Alone);
    BeginStandAlone(host);
    EXPECT_EQ(host.Ask({0, 0}), Ack);
  }
  RecorderHost host(recorder.DevicePath(), Gun);
  BeginInProduct(host);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + TableOfTwo + Bytes{TableOfTwoCheck}), Ack);
  EXPECT_EQ(host.Ask({0, 0}), Ack);
  ASSERT_TRUE(recorder.WaitUntilRecorded(2, Limit));
  EXPECT_TRUE(recorder.Traffic().Chip.Sounds().empty());
}

TEST(SoundRecorder, CountsMoreThan255PagesOfASound) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Alone);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 4}), Ack);
  host.Write({2, 1});
  for (int page = 0; page < 258; ++page) {
    ASSERT_EQ(host.Ask(SilentPage + Bytes{SilentCheck}), Ack) << page;
  }
  EXPECT_EQ(host.Ask({0, 0}), Ack);
  EXPECT_EQ(recorder.Traffic().Chip.Sounds(), (Sounds{{4, Bytes(258 * 256, 0x80)}}));
}

TEST(SoundRecorder, IncludesThePageNumberInTheCheckOfAGun) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Gun);
  BeginInProduct(host);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + TableOfTwo + Bytes{TableOfTwoCheck}), Ack);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 2, 1} + RisingPage + Bytes{0xB4}), Ack);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 3, 1} + RisingPage + Bytes{RisingCheck}), Refusal);
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent page 258 in place of 0"));
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent a wrong check byte of page 259"));
  EXPECT_EQ(recorder.Traffic().Chip.PageCount(), 1U);
}

TEST(SoundRecorder, RefusesAWrongCheckByteOfTableAndSound) {
  SoundRecorder recorder(Quick());
  {
    RecorderHost host(recorder.DevicePath(), Gun);
    BeginInProduct(host);
    EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + TableOfTwo + Bytes{TableOfTwoCheck ^ 1}), Refusal);
    // A host that goes on nevertheless sends page 0.
    EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + RisingPage + Bytes{RisingCheck}), Ack);
  }
  EXPECT_EQ(recorder.Traffic().Chip.IndexTable(), std::nullopt);
  EXPECT_EQ(recorder.Traffic().Chip.AllPages(), RisingPage);
  RecorderHost host(recorder.DevicePath(), Alone);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 0}), Ack);
  EXPECT_EQ(host.Ask(Bytes{2, 0} + RisingPage + Bytes{RisingCheck ^ 0x80}), Refusal);
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent a wrong check byte of table"));
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent a wrong check byte of page 0"));
  // The sound is over, so the next byte begins a command.
  EXPECT_EQ(host.Ask({2, 3}), Ack);
}

TEST(SoundRecorder, PlaysWhateverNumberItIsToldInBothModes) {
  SoundRecorder recorder(Quick());
  {
    RecorderHost host(recorder.DevicePath(), Gun);
    EXPECT_EQ(host.Ask({14, 0, 0}), Ack);
  }
  RecorderHost host(recorder.DevicePath(), Alone);
  EXPECT_EQ(host.Ask({3, 2, 127}), Ack);
  EXPECT_EQ(recorder.Traffic().Commands, (std::vector<RecorderCommand>{{Kind::Play, 0}, {Kind::Play, 127}}));
}

TEST(SoundRecorder, PlaysAsLongAsTheSoundTakes) {
  SoundRecorder recorder({});
  RecorderHost host(recorder.DevicePath(), Alone);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 0}), Ack);
  EXPECT_EQ(host.Ask(Bytes{4, 0} + SilentPage + Bytes{SilentCheck}), Ack);
  for (int page = 1; page < 4; ++page) {
    EXPECT_EQ(host.Ask(SilentPage + Bytes{SilentCheck}), Ack);
  }
  const auto start = std::chrono::steady_clock::now();
  EXPECT_EQ(host.Ask({3, 2, 0}), Ack);
  EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::duration<double>(4 * 256 / 22050.0));
}

TEST(SoundRecorder, TakesTheTimeOfAnErase) {
  SoundRecorderSettings settings = Quick();
  settings.EraseTime = milliseconds(120);
  SoundRecorder recorder(settings);
  RecorderHost host(recorder.DevicePath(), Gun);
  EXPECT_EQ(host.Ask({10, 0}), Ack);
  const auto start = std::chrono::steady_clock::now();
  EXPECT_EQ(host.Ask({2, 0}, 2), Ack + Ack);
  EXPECT_GE(std::chrono::steady_clock::now() - start, milliseconds(120));
}

TEST(SoundRecorder, IgnoresAHostThatDoesNotAwaitTheEndOfTheErase) {
  SoundRecorderSettings settings = Quick();
  settings.EraseTime = milliseconds(120);
  SoundRecorder recorder(settings);
  RecorderHost host(recorder.DevicePath(), Gun);
  EXPECT_EQ(host.Ask({10, 0}), Ack);
  EXPECT_EQ(host.Ask({2, 0}), Ack);
  EXPECT_EQ(host.Ask({0, 0}), Ack);
  ASSERT_TRUE(host.IsSilent());
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent bytes during the erase"));
  EXPECT_EQ(host.Ask({0, 0}), Ack);
}

TEST(SoundRecorder, DoesNotAnswerWhatComesOutOfOrder) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Gun);
  for (const auto& [bytes, fault] :
       std::vector<std::pair<Bytes, std::string>>{{{2, 0}, "the host sent an erase without a start"},
                                                  {{0, 0}, "the host sent an end before the erase"},
                                                  {{1, 0, 0, 0}, "the host sent a page before the erase"},
                                                  {{7, 8, 9}, "the host sent bytes that are no command"}}) {
    host.Write(bytes);
    EXPECT_TRUE(ComesToFault(recorder, fault)) << fault;
  }
  EXPECT_TRUE(host.IsSilent());
  RecorderHost other(recorder.DevicePath(), Alone);
  other.Write({1, 5});
  EXPECT_TRUE(ComesToFault(recorder, "the host sent a sound before the erase"));
  EXPECT_TRUE(other.IsSilent());
}

TEST(SoundRecorder, TakesASoundOfNoPagesForAFault) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Alone);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 0}), Ack);
  EXPECT_EQ(host.Ask({0, 0, 0, 0}), Ack);
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent a sound of 0 pages"));
}

TEST(SoundRecorder, FindsACommandBehindStrayBytes) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Gun);
  EXPECT_EQ(host.Ask({7, 7, 10, 10, 0}), Ack);
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent bytes that are no command").Times(1));
}

TEST(SoundRecorder, ForgetsACommandThatIsCutShort) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Gun);
  host.Write({1, 0});
  ASSERT_TRUE(recorder.WaitUntilHostFaults(1, Limit));
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent a command cut short"));
  EXPECT_EQ(host.Ask({10, 0}), Ack);
}

TEST(SoundRecorder, TakesTheSameTwoBytesForStartOrEraseByWhatCameBefore) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Alone);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({2, 3}), Ack);
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(recorder.Traffic().Commands,
            (std::vector<RecorderCommand>{{Kind::Start}, {Kind::Erase}, {Kind::Start}}));
}

TEST(SoundRecorder, TakesThemForAStartOnceAnEarlierOneIsForgotten) {
  SoundRecorderSettings settings = Quick();
  settings.Patience = milliseconds(30);
  SoundRecorder recorder(settings);
  RecorderHost host(recorder.DevicePath(), Alone);
  EXPECT_EQ(host.Ask({2, 3}), Ack);
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(host.Ask({2, 3}), Ack);
  EXPECT_EQ(recorder.Traffic().Commands, (std::vector<RecorderCommand>{{Kind::Start}, {Kind::Start}}));
}

TEST(SoundRecorder, ObeysAHostThatBeginsAnewInTheMiddleOfASound) {
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Alone);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 0}), Ack);
  EXPECT_EQ(host.Ask(Bytes{2, 0} + RisingPage + Bytes{RisingCheck}), Ack);
  EXPECT_EQ(host.Ask({2, 3}), Ack);
  EXPECT_EQ(host.Ask({2, 3}, 2), Ack + Ack);
  EXPECT_EQ(host.Ask({1, 0}), Ack);
  host.Write(Bytes{2, 0} + Bytes(100, 7));
  EXPECT_EQ(host.Ask({3, 2, 1}), Ack);
  EXPECT_THAT(recorder.HostFaults(), Contains("the host sent 100 bytes of a longer block"));
}

TEST(SoundRecorder, ServesBothSpeedsUnlessItIsOneOfTheTwo) {
  for (const auto& [kind, own, other] :
       {std::tuple{RecorderKind::Gun, Gun, Alone}, std::tuple{RecorderKind::StandAlone, Alone, Gun}}) {
    SoundRecorderSettings settings = Quick();
    settings.Kind = kind;
    SoundRecorder recorder(settings);
    {
      RecorderHost host(recorder.DevicePath(), other);
      host.Write(other == Gun ? Bytes{10, 0} : Bytes{2, 3});
      ASSERT_TRUE(recorder.WaitUntilHostFaults(1, Limit));
      EXPECT_TRUE(host.IsSilent());
    }
    EXPECT_EQ(recorder.HostFaults(),
              std::vector<std::string>{"the host speaks " + std::to_string(other) + ",8N1 instead of " +
                                       std::to_string(own) + ",8N1"});
    RecorderHost host(recorder.DevicePath(), own);
    EXPECT_EQ(host.Ask(own == Gun ? Bytes{10, 0} : Bytes{2, 3}), Ack);
  }
}

TEST(SoundRecorder, LogsBothDirections) {
  std::ostringstream log;
  {
    SoundRecorderSettings settings = Quick();
    settings.Log = &log;
    SoundRecorder recorder(settings);
    RecorderHost host(recorder.DevicePath(), Alone);
    BeginStandAlone(host);
    EXPECT_EQ(host.Ask({1, 3}), Ack);
    EXPECT_EQ(host.Ask(Bytes{1, 0} + SilentPage + Bytes{SilentCheck}), Ack);
  }
  std::string rows;
  std::istringstream lines(log.str());
  for (std::string line; std::getline(lines, line);) {
    if (line.find("fault") == std::string::npos) {
      rows += line.substr(line.find("recorder")) + '\n';
    }
  }
  std::string page;
  for (int i = 0; i < 256; ++i) {
    page += " 80";
  }
  EXPECT_EQ(rows,
            "recorder <- 02 03 start or erase\nrecorder -> AA\n"
            "recorder <- 02 03 start or erase\nrecorder -> AA\nrecorder -> AA\n"
            "recorder <- 01 03 header of sound 3\nrecorder -> AA\n"
            "recorder <- 01 00 1 pages\n"
            "recorder <-" +
                page + " A3 page 0\nrecorder -> AA\n");
}

TEST(SoundRecorder, ListsItsSoundsOnCommand) {
  SoundRecorder recorder(Quick());
  EXPECT_EQ(ObeyRecorderCommand(recorder, "sounds"), "no sounds");
  RecorderHost host(recorder.DevicePath(), Alone);
  RecordTwoStandAlone(host);
  EXPECT_EQ(ObeyRecorderCommand(recorder, " sounds "), "sound 0: 2 pages, 0.02 s\nsound 9: 1 pages, 0.01 s");
  EXPECT_EQ(ObeyRecorderCommand(recorder, ""), "");
  EXPECT_THROW(ObeyRecorderCommand(recorder, "sounds all"), std::invalid_argument);
  EXPECT_THROW(ObeyRecorderCommand(recorder, "play"), std::invalid_argument);
}

TEST(SoundRecorder, StopsInTheMiddleOfAPageWhenItIsDestroyed) {
  std::optional<SoundRecorder> recorder(std::in_place, Quick());
  RecorderHost host(recorder->DevicePath(), Alone);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 0}), Ack);
  host.Write(Bytes{2, 0} + Bytes(100, 7));
  recorder.reset();
  EXPECT_TRUE(host.ReadUntilHangUp().empty());
  EXPECT_TRUE(host.HungUp());
}

TEST(SoundRecorder, WaitsNoLongerThanToldForARecording) {
  const SoundRecorder recorder(Quick());
  EXPECT_FALSE(recorder.WaitUntilRecorded(1, milliseconds(10)));
}

}  // namespace
}  // namespace sim
