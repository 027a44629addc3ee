#include "sound/SoundRecording.h"
#include "tests/sound/RecordingSite.h"
#include "tests/support/Thrown.h"

namespace {

using testing::IsEmpty;

/// What can happen while a byte goes out.
enum class Mishap { LineLost, WindowCloses };

/// A recording of a wave and of raw samples, in either mode.
class RecordingAtEachByte : public RecordingSite, public testing::WithParamInterface<Recorder> {
 protected:
  RecordingAtEachByte() {
    Use(GetParam());
    Fill({{"/a.wav", Wave(Samples(500))}, {"", ""}, {"/b.raw", Samples(300)}});
  }

  /// Returns the number of the fault that the operator is told.
  int RecordUntil(std::size_t byte, Mishap mishap) {
    ForgetAll();
    const auto toHardware = port.OnOutput;
    port.OnOutput = [&](std::uint8_t sent) {
      toHardware(sent);
      if (port.Sent.size() == byte && mishap == Mishap::LineLost) {
        port.Lose();
      } else if (port.Sent.size() == byte) {
        stopped = true;
      }
    };
    const int fault = NumberThrownBy([this] { Record(); });
    port.OnOutput = toHardware;
    stopped = false;
    return fault;
  }

  std::size_t BytesOfARecording() {
    ForgetAll();
    Record();
    return port.Sent.size();
  }

 private:
  void ForgetAll() {
    hardware.Forget();
    port.Sent.clear();
    display.Statuses.clear();
  }
};

INSTANTIATE_TEST_SUITE_P(InBothModes, RecordingAtEachByte,
                         testing::Values(Recorder::InProduct, Recorder::StandAlone));

TEST_P(RecordingAtEachByte, TellsOfALostLineOnceAndClosesIt) {
  const std::size_t bytes = BytesOfARecording();
  ASSERT_GT(bytes, 750U);
  for (std::size_t byte = 1; byte <= bytes; ++byte) {
    SCOPED_TRACE(byte);
    EXPECT_EQ(RecordUntil(byte, Mishap::LineLost), 8012);
    EXPECT_EQ(port.Sent.size(), byte);
    EXPECT_FALSE(port.PortOpen());
    const std::string& status = display.Statuses.back();
    // Two bytes go out before anything is erased, two for the erase, two at the end.
    EXPECT_EQ(status, byte <= 4 ? "Idle" : byte >= bytes - 1 ? "Recording Complete." : "Recording Failed.");
    ASSERT_THAT(boxes.Boxes, IsEmpty());
  }
}

TEST_P(RecordingAtEachByte, EndsSilentlyWhenTheWindowCloses) {
  const std::size_t bytes = BytesOfARecording();
  for (std::size_t byte = 1; byte <= bytes; ++byte) {
    SCOPED_TRACE(byte);
    EXPECT_EQ(RecordUntil(byte, Mishap::WindowCloses), 0);
    EXPECT_EQ(port.Sent.size(), byte);
    ASSERT_THAT(boxes.Boxes, IsEmpty());
    port.Close();  // as the window does
  }
}

TEST_P(RecordingAtEachByte, WorksTheNextTime) {
  const std::size_t bytes = BytesOfARecording();
  for (const std::size_t byte : {std::size_t{1}, std::size_t{3}, std::size_t{9}, bytes / 2, bytes - 1}) {
    RecordUntil(byte, Mishap::LineLost);
    EXPECT_EQ(BytesOfARecording(), bytes) << byte;
    EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
  }
}

}  // namespace
