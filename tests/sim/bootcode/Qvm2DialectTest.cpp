#include "sim/bootcode/Qvm2Dialect.h"

#include <gtest/gtest.h>

#include "tests/support/BootLiterals.h"
#include "tests/support/TemporaryFolder.h"

namespace sim {
namespace {

using Heard = BootDialect::Heard;
using namespace wire;

class Qvm2DialectTest : public testing::Test {
 protected:
  // The packet is complete with its last byte and not before.
  BootVerdict Packet(const Bytes& packet) {
    for (std::size_t i = 0; i + 1 < packet.size(); ++i) {
      EXPECT_EQ(dialect_.Take(packet[i]), Heard::More) << i;
      EXPECT_EQ(dialect_.PacketBytes(), i + 1);
      EXPECT_FALSE(dialect_.MayFinish());
    }
    EXPECT_EQ(dialect_.Take(packet.back()), Heard::Complete);
    BootVerdict verdict = dialect_.CarryOut();
    EXPECT_TRUE(dialect_.MayFinish());
    return verdict;
  }

  void ExpectRefused(const Bytes& packet, char answer, const std::string& fault) {
    const std::string before = Flash();
    const BootVerdict verdict = Packet(packet);
    EXPECT_EQ(verdict.Answer, answer);
    EXPECT_EQ(verdict.Fault, fault);
    EXPECT_EQ(Flash(), before);
  }

  std::string Flash() const { return ReadFile(folder_ / "flash"); }

  TemporaryFolder folder_;
  Qvm2Dialect dialect_{folder_ / "flash"};
};

TEST_F(Qvm2DialectTest, ErasesAndWritesWhereThePacketsSay) {
  std::string expected(786432, '\xFF');
  for (const Bytes& erase : {ErasePage0, ErasePage511}) {
    const BootVerdict verdict = Packet(erase);
    EXPECT_EQ(verdict.Answer, 'b');
    EXPECT_EQ(verdict.Fault, "");
  }
  for (const auto& [write, row] :
       {std::pair(WriteCountingRow1, 1U), std::pair(WriteCountingRow4095, 4095U)}) {
    const BootVerdict verdict = Packet(write);
    EXPECT_EQ(verdict.Answer, 'f');
    EXPECT_EQ(verdict.Note, "row " + std::to_string(row) + " written");
    EXPECT_EQ(verdict.Fault, "");
    const Bytes counting = CountingRow();
    expected.replace(std::size_t{192} * row, 192, std::string(counting.begin(), counting.end()));
  }
  EXPECT_EQ(Flash(), expected);
  Packet(ErasePage0);
  EXPECT_EQ(Flash().substr(0, 1536), std::string(1536, '\xFF'));
  EXPECT_EQ(Flash().substr(1536), expected.substr(1536));
}

TEST_F(Qvm2DialectTest, AsksAgainForAPacketWithAnyWrongByte) {
  for (std::size_t place = 1; place < 6; ++place) {
    Bytes packet = ErasePage1;
    packet[place] ^= 0x40U;
    ExpectRefused(packet, 'c', "sent a wrong checksum");
  }
  for (std::size_t place = 1; place < 198; ++place) {
    Bytes packet = WriteCountingRow1;
    packet[place] ^= 0x01U;
    ExpectRefused(packet, 'c', "sent a wrong checksum");
  }
}

TEST_F(Qvm2DialectTest, AsksAgainForAPacketWithAWrongCount) {
  ExpectRefused({0x45, 0x00, 0x00, 0x00, 0x02, 0xB9}, 'c', "sent a count of 2 before 1 bytes");
  ExpectRefused(Bytes{0x5A, 0x00, 0x00, 0x00, 0xC0} + CountingRow() + Bytes{0x46}, 'c',
                "sent a count of 192 before 193 bytes");
}

TEST_F(Qvm2DialectTest, RefusesAddressesOfNoPageOrRow) {
  ExpectRefused({0x45, 0x00, 0x02, 0x00, 0x01, 0xB8}, 'e', "sent the address 000200 of no page");
  ExpectRefused({0x45, 0x08, 0x00, 0x00, 0x01, 0xB2}, 'e', "sent the address 080000 of no page");
  ExpectRefused(Bytes{0x5A, 0x00, 0x00, 0x40, 0xC1} + CountingRow() + Bytes{0x05}, 'e',
                "sent the address 000040 of no row");
  ExpectRefused(Bytes{0x5A, 0x08, 0x00, 0x00, 0xC1} + CountingRow() + Bytes{0x3D}, 'e',
                "sent the address 080000 of no row");
}

TEST_F(Qvm2DialectTest, TellsARowThatIsWrittenOverWhatItHeld) {
  EXPECT_EQ(Packet(WriteCountingRow1).Fault, "");
  EXPECT_EQ(Packet(WriteCountingRow1).Fault, "");
  const BootVerdict verdict = Packet(Bytes{0x5A, 0x00, 0x00, 0x80, 0xC1} + Bytes(192, 0xFF) + Bytes{0x25});
  EXPECT_EQ(verdict.Answer, 'f');
  EXPECT_EQ(verdict.Fault, "wrote row 1 over what it held");
}

TEST_F(Qvm2DialectTest, TakesNothingElseForAPacket) {
  for (const char letter : {'F', 'S', 'X', 'e', '\0'}) {
    EXPECT_EQ(dialect_.Take(static_cast<std::uint8_t>(letter)), Heard::Foreign);
  }
  EXPECT_TRUE(dialect_.MayFinish());
}

TEST_F(Qvm2DialectTest, ForgetsAPacketThatIsDroppedOrCutOff) {
  for (const std::uint8_t byte : ErasePage0) {
    dialect_.Take(byte);
  }
  dialect_.Drop();
  EXPECT_EQ(dialect_.PacketBytes(), 0U);
  dialect_.Take(0x5A);
  dialect_.Restart();
  EXPECT_EQ(Packet(ErasePage0).Answer, 'b');
}

TEST_F(Qvm2DialectTest, HasLettersOfItsOwn) {
  EXPECT_EQ(dialect_.Product(), 'd');
  EXPECT_EQ(dialect_.Begun(), 's');
  EXPECT_FALSE(dialect_.EndsByQuiet());
}

}  // namespace
}  // namespace sim
