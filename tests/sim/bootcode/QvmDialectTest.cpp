#include "sim/bootcode/QvmDialect.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "tests/support/JoinedBytes.h"
#include "tests/support/TemporaryFolder.h"

namespace sim {
namespace {

using Heard = BootDialect::Heard;

const Bytes SetUpBytes{0x53, 0x00, 0x70, 0x8F};

class QvmDialectTest : public testing::Test {
 protected:
  Heard Take(const Bytes& bytes) {
    Heard heard = Heard::More;
    for (const std::uint8_t byte : bytes) {
      EXPECT_EQ(heard, Heard::More);
      heard = dialect_.Take(byte);
    }
    return heard;
  }

  // Whole by itself, or when the line falls quiet.
  std::uint8_t CarryOut(const Bytes& bytes) {
    if (Take(bytes) == Heard::More) {
      EXPECT_TRUE(dialect_.EndsByQuiet());
    }
    return dialect_.CarryOut().Answer;
  }

  std::string Stored() const { return ReadFile(folder_ / "lines"); }

  TemporaryFolder folder_;
  QvmDialect dialect_{folder_ / "lines"};
};

TEST_F(QvmDialectTest, KeepsTheBuffersAsLines) {
  EXPECT_EQ(CarryOut(SetUpBytes), 'f');
  EXPECT_EQ(CarryOut({0x5A, 0x01, 0xAB, 0x5A}), 'f');
  EXPECT_EQ(CarryOut({0x5A}), 'f');
  EXPECT_EQ(CarryOut({0x5A, 0x46}), 'f');
  EXPECT_EQ(Stored(), ":01AB5A\r\n:\r\n:46\r\n");
}

TEST_F(QvmDialectTest, EndsABufferAtItsLongest) {
  CarryOut(SetUpBytes);
  const Bytes longest = Bytes{0x5A} + Bytes(51, 0x22);
  EXPECT_EQ(Take(longest), Heard::Complete);
  EXPECT_EQ(dialect_.PacketBytes(), 52U);
  EXPECT_EQ(dialect_.CarryOut().Answer, 'f');
  EXPECT_EQ(dialect_.Take(0x22), Heard::Foreign);
}

TEST_F(QvmDialectTest, WantsToBeSetUpBeforeABufferOrTheEnd) {
  EXPECT_FALSE(dialect_.MayFinish());
  EXPECT_EQ(dialect_.Take('Z'), Heard::Foreign);
  EXPECT_EQ(Take(SetUpBytes), Heard::Complete);
  EXPECT_EQ(dialect_.PacketBytes(), 0U);
  EXPECT_FALSE(dialect_.EndsByQuiet());
  EXPECT_EQ(dialect_.CarryOut().Answer, 'f');
  EXPECT_TRUE(dialect_.MayFinish());
  EXPECT_EQ(dialect_.Take('S'), Heard::Foreign);
  dialect_.Take('Z');
  EXPECT_FALSE(dialect_.MayFinish());
}

TEST_F(QvmDialectTest, RefusesOtherSetUps) {
  for (const Bytes& other :
       {Bytes{0x53, 0x01, 0x70, 0x8F}, Bytes{0x53, 0x00, 0x71, 0x8F}, Bytes{0x53, 0x00, 0x70, 0x8E}}) {
    Take(other);
    const BootVerdict verdict = dialect_.CarryOut();
    EXPECT_NE(verdict.Answer, 'f');
    EXPECT_EQ(verdict.Fault, "sent a set-up other than 00 70 8F");
    EXPECT_FALSE(dialect_.MayFinish());
  }
}

TEST_F(QvmDialectTest, BeginsItsStoreAnewWithEachSetUpAndNotBefore) {
  CarryOut(SetUpBytes);
  CarryOut({0x5A, 0x11});
  dialect_.Restart();
  EXPECT_FALSE(dialect_.MayFinish());
  EXPECT_EQ(Stored(), ":11\r\n");
  CarryOut(SetUpBytes);
  EXPECT_EQ(Stored(), "");
  CarryOut({0x5A, 0x22});
  EXPECT_EQ(Stored(), ":22\r\n");
}

TEST_F(QvmDialectTest, ForgetsABufferThatIsDropped) {
  CarryOut(SetUpBytes);
  Take({0x5A, 0x11});
  dialect_.Drop();
  EXPECT_TRUE(dialect_.MayFinish());
  EXPECT_EQ(Stored(), "");
}

TEST_F(QvmDialectTest, HasLettersOfItsOwn) {
  EXPECT_EQ(dialect_.Product(), 'p');
  EXPECT_EQ(dialect_.Begun(), 'b');
}

TEST(BufferStore, LeavesItsFileAloneUntilItIsCleared) {
  const TemporaryFolder folder;
  WriteFile(folder / "lines", ":OLDER");
  BufferStore store(folder / "lines");
  EXPECT_EQ(ReadFile(folder / "lines"), ":OLDER");
  store.Clear();
  EXPECT_EQ(ReadFile(folder / "lines"), "");
  EXPECT_THROW(BufferStore(folder / "missing/lines"), std::runtime_error);
}

TEST(BufferStore, NeedsNoFile) {
  BufferStore store(std::nullopt);
  store.Clear();
  store.Add(Bytes{1, 2});
  EXPECT_EQ(store.Buffers(), (std::vector<Bytes>{{1, 2}}));
}

}  // namespace
}  // namespace sim
