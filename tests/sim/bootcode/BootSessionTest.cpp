#include "sim/bootcode/BootSession.h"

#include <gtest/gtest.h>

#include "sim/bootcode/Qvm2Dialect.h"
#include "sim/bootcode/QvmDialect.h"
#include "tests/support/BootLiterals.h"

namespace sim {
namespace {

using namespace wire;

// The answers to bytes, and what the host did wrong.
class Conversation {
 public:
  explicit Conversation(BootDialect& dialect)
      : session_(dialect, [this](std::size_t packet) {
          Packets.push_back(packet);
          return packet == SpoilPacket ? std::optional<std::uint8_t>('c') : std::nullopt;
        }) {}

  std::string Say(const Bytes& bytes) {
    std::string answers;
    for (const std::uint8_t byte : bytes) {
      if (const std::optional<BootStep> step = session_.Take(byte)) {
        answers += Note(*step);
      }
    }
    return answers;
  }
  std::string Say(const std::string& text) { return Say(Bytes(text.begin(), text.end())); }
  std::string BeQuiet() { return Note(session_.Quiet()); }
  BootSession& Session() { return session_; }

  std::vector<std::string> Faults;
  std::vector<std::size_t> Packets;
  std::size_t SpoilPacket = 0;
  int Finished = 0;

 private:
  std::string Note(const BootStep& step) {
    if (!step.Fault.empty()) {
      Faults.push_back(step.Fault);
    }
    Finished += step.Finished ? 1 : 0;
    return step.Answer ? std::string(1, static_cast<char>(*step.Answer)) : "";
  }

  BootSession session_;
};

TEST(BootSession, LeadsAProductOfTheSecondKindFromTheStartToTheEnd) {
  Qvm2Dialect dialect{std::nullopt};
  Conversation host(dialect);
  host.Session().SwitchOn();
  EXPECT_EQ(host.Say("XPB"), "xds");
  EXPECT_EQ(host.Say(ErasePage0 + WriteBlankRow0 + WriteCountingRow1), "bff");
  EXPECT_EQ(host.Finished, 0);
  EXPECT_EQ(host.Say("F"), "f");
  EXPECT_EQ(host.Finished, 1);
  EXPECT_EQ(host.Faults, std::vector<std::string>{});
  EXPECT_EQ(host.Packets, (std::vector<std::size_t>{1, 2, 3}));
}

TEST(BootSession, LeadsAProductOfTheFirstKindFromTheStartToTheEnd) {
  QvmDialect dialect{std::nullopt};
  Conversation host(dialect);
  host.Session().SwitchOn();
  EXPECT_EQ(host.Say("XPB"), "xpb");
  EXPECT_EQ(host.Say(Bytes{0x53, 0x00, 0x70, 0x8F}), "f");
  EXPECT_FALSE(host.Session().AwaitsQuiet());
  EXPECT_EQ(host.Say(Bytes{0x5A, 0x46, 0x5A}), "");
  EXPECT_TRUE(host.Session().AwaitsQuiet());
  EXPECT_EQ(host.BeQuiet(), "f");
  EXPECT_FALSE(host.Session().AwaitsQuiet());
  EXPECT_EQ(host.Say("F"), "f");
  EXPECT_EQ(host.Finished, 1);
  EXPECT_EQ(host.Packets, std::vector<std::size_t>{1});
  EXPECT_EQ(host.Faults, std::vector<std::string>{});
}

TEST(BootSession, AnswersNothingButWhatIsDue) {
  Qvm2Dialect dialect{std::nullopt};
  Conversation host(dialect);
  host.Session().SwitchOn();
  EXPECT_EQ(host.Say("PX"), "x");
  EXPECT_EQ(host.Say("XP"), "d");
  EXPECT_EQ(host.Say("FB"), "s");
  EXPECT_EQ(host.Say("SF"), "f");
  EXPECT_EQ(host.Faults,
            (std::vector<std::string>{"sent 50 where X was due", "sent 58 where P was due",
                                      "sent 46 where B was due", "sent 53 where a packet was due"}));
}

TEST(BootSession, AnswersNothingWhileTheDeviceIsNotInItsBootCode) {
  Qvm2Dialect dialect{std::nullopt};
  Conversation host(dialect);
  EXPECT_EQ(host.Say("XPB"), "");
  EXPECT_EQ(host.Faults, std::vector<std::string>{"spoke to a device that is not in its boot code"});
  host.Session().SwitchOn();
  EXPECT_EQ(host.Say("XPBF"), "xdsf");
  EXPECT_EQ(host.Say("FF"), "");
  EXPECT_EQ(host.Faults.size(), 2U);
}

TEST(BootSession, BeginsAnewWheneverTheDeviceIsSwitchedOn) {
  Qvm2Dialect dialect{std::nullopt};
  Conversation host(dialect);
  for (const char* begun : {"", "X", "XP", "XPB", "XPBE", "XPBZ123"}) {
    host.Session().SwitchOn();
    host.Say(begun);
    host.Session().SwitchOn();
    EXPECT_EQ(host.Session().PacketBytes(), 0U);
    EXPECT_EQ(host.Session().Packet(), 1U);
    EXPECT_EQ(host.Say("XPB"), "xds") << begun;
  }
  EXPECT_EQ(host.Faults, std::vector<std::string>{});
}

TEST(BootSession, DoesNotCarryOutAPacketWhoseAnswerIsSpoilt) {
  Qvm2Dialect dialect{std::nullopt};
  Conversation host(dialect);
  host.Session().SwitchOn();
  host.Say("XPB");
  host.SpoilPacket = 2;
  EXPECT_EQ(host.Say(WriteCountingRow1), "f");
  EXPECT_EQ(host.Say(ErasePage0), "c");
  // Had the page been erased, its first row could not be written over.
  EXPECT_EQ(host.Say(Bytes{0x5A, 0x00, 0x00, 0x80, 0xC1} + Bytes(192, 0xFF) + Bytes{0x25}), "f");
  EXPECT_EQ(host.Faults, std::vector<std::string>{"wrote row 1 over what it held"});
  EXPECT_EQ(host.Session().Packet(), 4U);
}

}  // namespace
}  // namespace sim
