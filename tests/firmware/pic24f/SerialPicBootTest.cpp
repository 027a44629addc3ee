#include "firmware/pic24f/SerialPicBoot.h"

#include <gmock/gmock.h>

#include <array>

#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/support/Bytes.h"
#include "tests/support/Thrown.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;

const Bytes VersionAnswer = {0x55, 0x55, 0x00, 0x02, 0x05, 0x05, 0x01, 0xF8, 0x04};
const Bytes VerifyOk = {0x55, 0x55, 0x08, 0xF8, 0x04};

class SerialPicBootTest : public testing::Test {
 protected:
  SerialPicBootTest() {
    port.OnOutput = [this](std::uint8_t byte) {
      line.push_back(byte);
      if (byte == 0x04 && (line.size() < 2 || line[line.size() - 2] != 0x05)) {
        packets.push_back(line);
        line.clear();
        if (OnPacket) {
          OnPacket();
        }
      }
    };
  }

  std::int32_t Open(int timeOut = 500) { return handle = library.OpenPIC("COM1", 115200, timeOut); }

  void Answer(const Bytes& bytes, int after = 5) {
    events.At(milliseconds(after), [this, bytes] { port.Receive(bytes); });
  }

  FakeEventPump events;
  FakeSerialPort port;
  bool stopped = false;
  SerialPicBoot library{{.Port = port,
                         .Events = events,
                         .DeviceOf = [](const std::string& name) { return "/dev/" + name; },
                         .Stopped = [this] { return stopped; }}};
  std::int32_t handle = 0;
  Bytes line;
  std::vector<Bytes> packets;
  std::function<void()> OnPacket;
};

TEST_F(SerialPicBootTest, OpensThePortAtItsRate) {
  EXPECT_GT(Open(), 0);
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/COM1 115200,N,8,1"));
  EXPECT_EQ(port.Instrument, "pic24f");
  library.ClosePIC(handle);
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(SerialPicBootTest, TellsAPortThatDoesNotOpen) {
  port.FailNextOpen(8005);
  EXPECT_LT(Open(), 0);
  EXPECT_GT(Open(), 0);
}

TEST_F(SerialPicBootTest, DoesNothingWithAnotherHandle) {
  std::array<std::uint8_t, 16> buffer{};
  EXPECT_LT(library.SendGetPacket(1, buffer, 1, 10, 3), 0);
  const std::int32_t first = Open();
  library.ClosePIC(first);
  Open();
  library.ClosePIC(first);
  EXPECT_TRUE(port.PortOpen());
  EXPECT_LT(library.ErasePIC(first, 0, 1, 5), 0);
  library.SendPacket(first, buffer);
  EXPECT_THAT(port.Sent, IsEmpty());
}

TEST_F(SerialPicBootTest, SendsAPacketAndTakesItsAnswer) {
  Open();
  OnPacket = [this] { Answer(VersionAnswer); };
  std::array<std::uint8_t, 11> buffer = {0x00, 0x02};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 2, 10, 3), 4);
  EXPECT_THAT(packets, ElementsAre(Bytes{0x55, 0x55, 0x00, 0x02, 0xFE, 0x04}));
  EXPECT_THAT(Bytes(buffer.begin(), buffer.begin() + 4), ElementsAre(0x00, 0x02, 0x05, 0x01));
}

TEST_F(SerialPicBootTest, TakesAnAnswerThatIsTornAnywhere) {
  for (std::size_t cut = 0; cut <= VersionAnswer.size(); ++cut) {
    Open();
    const auto at = VersionAnswer.begin() + static_cast<std::ptrdiff_t>(cut);
    OnPacket = [&] {
      Answer(Bytes(VersionAnswer.begin(), at), 1);
      Answer(Bytes(at, VersionAnswer.end()), 300);
    };
    std::array<std::uint8_t, 11> buffer = {0x00, 0x02};
    EXPECT_EQ(library.SendGetPacket(handle, buffer, 2, 10, 0), 4) << cut;
  }
}

TEST_F(SerialPicBootTest, TakesAnAnswerThatComesInSlowly) {
  Open();
  OnPacket = [this] {
    for (std::size_t i = 0; i < VersionAnswer.size(); ++i) {
      Answer({VersionAnswer[i]}, 300 + 90 * static_cast<int>(i));  // it ends after 1020 ms
    }
  };
  std::array<std::uint8_t, 11> buffer = {0x00, 0x02};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 2, 10, 0), 4);
}

TEST_F(SerialPicBootTest, GivesUpAnAnswerThatDoesNotGoOn) {
  Open();
  OnPacket = [this] { Answer(Bytes(VersionAnswer.begin(), VersionAnswer.end() - 1), 400); };
  std::array<std::uint8_t, 11> buffer = {0x00, 0x02};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 2, 10, 0), SerialPicBoot::NoAnswer);
  EXPECT_LE(events.Now(), milliseconds(720));
}

TEST_F(SerialPicBootTest, GivesUpAnAnswerThatNeverEnds) {
  Open();
  std::function<void()> babble = [&] {
    port.Receive({0x55, 0x55, 0x01});
    events.At(milliseconds(10), babble);
  };
  babble();
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 0), SerialPicBoot::NoAnswer);
  EXPECT_LE(events.Now(), milliseconds(1200));
}

TEST_F(SerialPicBootTest, RepeatsAPacketAsOftenAsAskedFor) {
  Open();
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 3), SerialPicBoot::NoAnswer);
  EXPECT_EQ(packets, std::vector<Bytes>(4, VerifyOk));
  EXPECT_GE(events.Now(), milliseconds(2000));
  EXPECT_LE(events.Now(), milliseconds(2100));
}

TEST_F(SerialPicBootTest, TakesTheAnswerToARepeatedPacket) {
  Open();
  OnPacket = [this] {
    if (packets.size() == 3) {
      Answer(VerifyOk);
    }
  };
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 5), 1);
  EXPECT_EQ(packets.size(), 3U);
}

TEST_F(SerialPicBootTest, NeverRepeatsForEver) {
  Open(1);
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_LT(library.SendGetPacket(handle, buffer, 1, 10, 32767), 0);
  EXPECT_EQ(packets.size(), 21U);
  packets.clear();
  EXPECT_LT(library.SendGetPacket(handle, buffer, 1, 10, -5), 0);
  EXPECT_EQ(packets.size(), 1U);
}

TEST_F(SerialPicBootTest, PassesOverNoiseWrongChecksumsAndOtherAnswers) {
  Open();
  OnPacket = [this] {
    Answer({0xFF, 0x00, 0x55, 0x04}, 1);
    Answer({0x55, 0x55, 0x08, 0xF7, 0x04}, 2);
    Answer(VersionAnswer, 3);
    Answer(VerifyOk, 4);
  };
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 0), 1);
  EXPECT_EQ(buffer[0], 0x08);
}

TEST_F(SerialPicBootTest, GivesUpUnderNoiseThatNeverEnds) {
  Open();
  std::function<void()> noise = [&] {
    port.Receive({0xAA, 0x55});
    events.At(milliseconds(1), noise);
  };
  noise();
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 1), SerialPicBoot::NoAnswer);
}

TEST_F(SerialPicBootTest, DropsWhatCameBefore) {
  Open();
  port.Receive(VerifyOk);
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 0), SerialPicBoot::NoAnswer);
}

TEST_F(SerialPicBootTest, NeverPutsMoreThanItHoldsIntoABuffer) {
  Open();
  OnPacket = [this] { Answer({0x55, 0x55, 0x08, 1, 2, 3, 6, 7, 8, 0xDD, 0x04}); };
  std::array<std::uint8_t, 4> buffer = {0x08, 0, 0, 0};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 255, 0), SerialPicBoot::NoAnswer);
  EXPECT_THAT(buffer, ElementsAre(0x08, 0, 0, 0));
}

TEST_F(SerialPicBootTest, ReadsInstructions) {
  Open();
  OnPacket = [this] {
    Answer({0x55, 0x55, 0x01, 0x02, 0x80, 0x00, 0x00, 1, 2, 3, 0, 6, 7, 8, 0, 0x62, 0x04});
  };
  const PicRecord record{
      .Command = 1, .DataLength = 8, .Address = 0x80, .BlockSize = 4, .BytesPerAddress = 2};
  std::array<std::uint8_t, 257> buffer{};
  EXPECT_EQ(library.ReadPIC(handle, record, buffer), 8);
  EXPECT_THAT(packets, ElementsAre(Bytes{0x55, 0x55, 0x01, 0x02, 0x80, 0x00, 0x00, 0x7D, 0x04}));
  EXPECT_THAT(Bytes(buffer.begin(), buffer.begin() + 9), ElementsAre(1, 2, 3, 0, 6, 7, 8, 0, 0));
}

TEST_F(SerialPicBootTest, ReadsTheIdentity) {
  Open();
  OnPacket = [this] {
    Answer({0x55, 0x55, 0x01, 0x01, 0x00, 0x00, 0xFF, 0x47, 0x05, 0x04, 0x00, 0x00, 0xB4, 0x04});
  };
  const PicRecord record{
      .Command = 1, .DataLength = 4, .Address = 0xFF0000, .BlockSize = 4, .BytesPerAddress = 2};
  std::array<std::uint8_t, 11> buffer{};
  EXPECT_EQ(library.ReadPIC(handle, record, buffer), 4);
  EXPECT_THAT(packets, ElementsAre(Bytes{0x55, 0x55, 0x01, 0x01, 0x00, 0x00, 0xFF, 0xFF, 0x04}));
  EXPECT_EQ(buffer[1] * 256 + buffer[0], 0x0447);
}

TEST_F(SerialPicBootTest, RepeatsAReadWithAShortAnswer) {
  Open();
  OnPacket = [this] { Answer({0x55, 0x55, 0x01, 0x02, 0x80, 0x00, 0x00, 1, 2, 3, 0, 0x77, 0x04}); };
  const PicRecord record{
      .Command = 1, .DataLength = 8, .Address = 0x80, .BlockSize = 4, .BytesPerAddress = 2, .MaxRetries = 2};
  std::array<std::uint8_t, 257> buffer{};
  EXPECT_EQ(library.ReadPIC(handle, record, buffer), SerialPicBoot::ShortAnswer);
  EXPECT_EQ(packets.size(), 3U);
}

TEST_F(SerialPicBootTest, RepeatsAQuestionWithAShortAnswer) {
  Open();
  OnPacket = [this] {
    Answer(packets.size() == 1 ? Bytes{0x55, 0x55, 0x00, 0x02, 0x05, 0x05, 0xF9, 0x04} : VersionAnswer);
  };
  std::array<std::uint8_t, 11> buffer = {0x00, 0x02};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 2, 10, 3), 4);
  EXPECT_EQ(packets.size(), 2U);
}

TEST_F(SerialPicBootTest, PassesOverTheAnswerToAnotherRead) {
  Open();
  OnPacket = [this] {
    Answer({0x55, 0x55, 0x01, 0x01, 0x40, 0x00, 0x00, 9, 9, 9, 0, 0xA3, 0x04}, 1);
    Answer({0x55, 0x55, 0x01, 0x01, 0x80, 0x00, 0x00, 1, 2, 3, 0, 0x78, 0x04}, 2);
  };
  const PicRecord record{
      .Command = 1, .DataLength = 4, .Address = 0x80, .BlockSize = 4, .BytesPerAddress = 2};
  std::array<std::uint8_t, 257> buffer{};
  EXPECT_EQ(library.ReadPIC(handle, record, buffer), 4);
  EXPECT_EQ(buffer[0], 1);
}

TEST_F(SerialPicBootTest, WritesRows) {
  Open();
  OnPacket = [this] { Answer({0x55, 0x55, 0x02, 0xFE, 0x04}); };
  const PicRecord record{
      .Command = 2, .DataLength = 256, .Address = 0x015780, .BlockSize = 256, .BytesPerAddress = 2};
  const Bytes row(256, 0x11);
  EXPECT_GT(library.WritePIC(handle, record, row), 0);
  ASSERT_EQ(packets.size(), 1U);
  Bytes expected = {0x55, 0x55, 0x02, 0x01, 0x80, 0x57, 0x01};
  expected.insert(expected.end(), row.begin(), row.end());
  expected.insert(expected.end(), {0x25, 0x04});
  EXPECT_EQ(packets[0], expected);
}

TEST_F(SerialPicBootTest, CountsEepromInWords) {
  Open();
  OnPacket = [this] { Answer({0x55, 0x55, 0x05, 0x05, 0xFB, 0x04}); };
  const PicRecord record{
      .Command = 5, .DataLength = 16, .Address = 0xFE0010, .BlockSize = 1, .BytesPerAddress = 1};
  const Bytes data(16, 0x20);
  EXPECT_GT(library.WritePIC(handle, record, data), 0);
  ASSERT_EQ(packets.size(), 1U);
  EXPECT_EQ(Bytes(packets[0].begin(), packets[0].begin() + 8),
            (Bytes{0x55, 0x55, 0x05, 0x05, 0x08, 0x10, 0x00, 0xFE}));
}

TEST_F(SerialPicBootTest, ErasesPages) {
  Open();
  OnPacket = [this] { Answer({0x55, 0x55, 0x03, 0xFD, 0x04}, 4000); };  // pages take their time
  EXPECT_GT(library.ErasePIC(handle, 0, 43, 5), 0);
  EXPECT_THAT(packets, ElementsAre(Bytes{0x55, 0x55, 0x03, 0x2B, 0x00, 0x00, 0x00, 0xD2, 0x04}));
}

TEST_F(SerialPicBootTest, RefusesToEraseNoBlockOrTooMany) {
  Open();
  EXPECT_LT(library.ErasePIC(handle, 0, 0, 5), 0);
  EXPECT_LT(library.ErasePIC(handle, 0, 256, 5), 0);
  EXPECT_LT(library.ErasePIC(handle, 0, -1, 5), 0);
  EXPECT_THAT(packets, IsEmpty());
}

TEST_F(SerialPicBootTest, RefusesRecordsWithoutAPacket) {
  Open();
  Bytes buffer(256);
  for (const PicRecord& record : {PicRecord{.Command = 1, .DataLength = 4, .BlockSize = 0},
                                  PicRecord{.Command = 1, .DataLength = 2, .BlockSize = 4},
                                  PicRecord{.Command = 1, .DataLength = 300, .BlockSize = 4},
                                  PicRecord{.Command = 2, .DataLength = 256, .BlockSize = 1},
                                  PicRecord{.Command = 5, .DataLength = 1, .BlockSize = 1}}) {
    EXPECT_EQ(library.ReadPIC(handle, record, buffer), SerialPicBoot::InvalidRecord);
    EXPECT_EQ(library.WritePIC(handle, record, buffer), SerialPicBoot::InvalidRecord);
  }
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 0, 10, 3), SerialPicBoot::InvalidRecord);
  EXPECT_THAT(packets, IsEmpty());
}

TEST_F(SerialPicBootTest, ComparesMemory) {
  Open();
  OnPacket = [this] { Answer({0x55, 0x55, 0x01, 0x01, 0x80, 0x00, 0x00, 1, 2, 3, 0, 0x78, 0x04}); };
  const PicRecord record{
      .Command = 1, .DataLength = 4, .Address = 0x80, .BlockSize = 4, .BytesPerAddress = 2};
  EXPECT_EQ(library.VerifyPIC(handle, record, Bytes{1, 2, 3, 0}), 1);
  EXPECT_EQ(library.VerifyPIC(handle, record, Bytes{1, 2, 4, 0}), SerialPicBoot::NotEqual);
}

TEST_F(SerialPicBootTest, TakesAPacketThatComesByItself) {
  Open();
  Answer(VersionAnswer);
  std::array<std::uint8_t, 11> buffer{};
  EXPECT_EQ(library.GetPacket(handle, buffer), 4);
  EXPECT_EQ(library.GetPacket(handle, buffer), SerialPicBoot::NoAnswer);
}

TEST_F(SerialPicBootTest, SendsThePacketThatRunsTheProgram) {
  Open();
  library.SendPacket(handle, Bytes{0x00, 0x00});
  EXPECT_THAT(packets, ElementsAre(Bytes{0x55, 0x55, 0x00, 0x00, 0x00, 0x04}));
}

TEST_F(SerialPicBootTest, EndsItsWaitWhenStopped) {
  Open(60000);
  events.At(milliseconds(100), [this] { stopped = true; });
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 5), SerialPicBoot::Ended);
  EXPECT_EQ(events.Now(), milliseconds(100));
}

TEST_F(SerialPicBootTest, ThrowsOnceWhenTheLineIsLost) {
  Open();
  OnPacket = [this] { events.At(milliseconds(10), [this] { port.Lose(); }); };
  events.At(milliseconds(20), [] {});
  std::array<std::uint8_t, 11> buffer = {0x08};
  EXPECT_EQ(NumberThrownBy([&] { library.SendGetPacket(handle, buffer, 1, 10, 5); }), 8012);
  EXPECT_FALSE(port.PortOpen());
  EXPECT_EQ(library.SendGetPacket(handle, buffer, 1, 10, 5), SerialPicBoot::NoPort);
  Open();
  EXPECT_TRUE(port.PortOpen());
}

TEST_F(SerialPicBootTest, WaitsLongerOnASlowLine) {
  handle = library.OpenPIC("COM1", 1200, 100);
  OnPacket = [this] { Answer({0x55, 0x55, 0x02, 0xFE, 0x04}, 2300); };  // 264 bytes take 2.2 s
  const PicRecord record{.Command = 2, .DataLength = 256, .BlockSize = 256, .BytesPerAddress = 2};
  EXPECT_GT(library.WritePIC(handle, record, Bytes(256, 0x11)), 0);
  EXPECT_EQ(packets.size(), 1U);
}

}  // namespace
