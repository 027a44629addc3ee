#include <gmock/gmock.h>

#include <tuple>

#include "sim/recorder/SoundRecorder.h"
#include "tests/sim/recorder/RecorderHost.h"

namespace sim {
namespace {

using std::chrono::milliseconds;
using testing::Contains;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

// One recording would do, but a busy machine makes pauses of its own.
TEST(SoundRecorder, NotesAHostThatLeavesNoPauses) {
  constexpr int mostRecordings = 50;
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Gun);
  for (int i = 0; i < mostRecordings && recorder.HostFaults().size() < 4; ++i) {
    RecordTwoInProduct(host);
  }
  EXPECT_THAT(recorder.HostFaults(),
              UnorderedElementsAre("the host leaves less than 20 ms before the check byte",
                                   "the host leaves less than 10 ms between the bytes of a command",
                                   "the host leaves less than 20 ms before a page or header",
                                   "the host leaves less than 1 ms between the bytes of a page"));
}

TEST(SoundRecorder, NotesAHostThatPlaysOneSoundRightBehindTheOther) {
  constexpr int mostSounds = 200;
  SoundRecorder recorder(Quick());
  RecorderHost host(recorder.DevicePath(), Alone);
  for (int i = 0; i < mostSounds && recorder.HostFaults().size() < 2; ++i) {
    EXPECT_EQ(host.Ask({3, 2, 0}), Ack);
  }
  EXPECT_THAT(recorder.HostFaults(), Contains("the host leaves less than 1 s between two sounds"));
}

// Leaves the pauses of both modes as a program does, by waiting for bytes that do not come.
class PatientHost : public RecorderHost {
 public:
  using RecorderHost::RecorderHost;

  void Pause(int length) { EXPECT_EQ(ReadByte(milliseconds(length)), std::nullopt); }
  void WriteSlowly(const Bytes& bytes, int pause) {
    for (const std::uint8_t byte : bytes) {
      Write({byte});
      Pause(pause);
    }
  }
  Bytes CheckedBy(std::uint8_t check) {
    Pause(20);
    return Ask({check});
  }
};

TEST(SoundRecorder, FindsNoFaultInAHostThatKeepsToThePauses) {
  SoundRecorder recorder({});
  {
    PatientHost host(recorder.DevicePath(), Gun);
    host.WriteSlowly({10}, 10);
    EXPECT_EQ(host.Ask({0}), Ack);
    host.WriteSlowly({2}, 10);
    EXPECT_EQ(host.Ask({0}, 2), Ack + Ack);
    for (const auto& [number, page, check] :
         {std::tuple{0, TableOfTwo, TableOfTwoCheck}, std::tuple{0, SilentPage, SilentCheck},
          std::tuple{1, SilentPage, std::uint8_t{0x2C}}}) {
      host.Pause(20);
      host.WriteSlowly({1, 0, static_cast<std::uint8_t>(number), 0}, 10);
      host.WriteSlowly(page, 1);
      EXPECT_EQ(host.CheckedBy(check), Ack);
    }
  }
  PatientHost host(recorder.DevicePath(), Alone);
  host.WriteSlowly({2}, 10);
  EXPECT_EQ(host.Ask({3}), Ack);
  host.WriteSlowly({2}, 10);
  EXPECT_EQ(host.Ask({3}, 2), Ack + Ack);
  for (std::uint8_t sound = 0; sound < 3; ++sound) {
    host.Pause(20);
    host.WriteSlowly({1}, 10);
    EXPECT_EQ(host.Ask({sound}), Ack);
    host.Pause(20);
    host.WriteSlowly({1}, 20);
    host.WriteSlowly({0}, 20);
    host.Write(SilentPage);
    host.Pause(23);
    EXPECT_EQ(host.CheckedBy(SilentCheck), Ack);
  }
  EXPECT_THAT(recorder.HostFaults(), IsEmpty());
}

}  // namespace
}  // namespace sim
