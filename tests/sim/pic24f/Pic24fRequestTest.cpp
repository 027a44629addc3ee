#include "sim/pic24f/Pic24fRequest.h"

#include <gtest/gtest.h>

#include <optional>
#include <utility>

#include "tests/support/Bytes.h"

namespace sim {
namespace {

std::optional<Pic24fRequest> Read(const Bytes& data) {
  const auto read = ReadPic24fRequest(data);
  const auto* request = std::get_if<Pic24fRequest>(&read);
  return request == nullptr ? std::nullopt : std::optional(*request);
}

std::string FaultOf(const Bytes& data) {
  const auto read = ReadPic24fRequest(data);
  const auto* fault = std::get_if<BadPacket>(&read);
  return fault == nullptr ? "" : std::string(fault->What);
}

TEST(Pic24fRequest, IsCommandCountAddressAndBytes) {
  EXPECT_EQ(Read({0x01, 0x40, 0x56, 0x34, 0x12}),
            (Pic24fRequest{.Command = Pic24fCommand::ReadProgram, .Count = 64, .Address = 0x123456}));
  EXPECT_EQ(Read({0x03, 0xFF, 0x00, 0x04, 0x00}),
            (Pic24fRequest{.Command = Pic24fCommand::EraseProgram, .Count = 255, .Address = 0x400}));
  Bytes row{0x02, 0x01, 0x80, 0x00, 0x00};
  row.insert(row.end(), 256, 0x11);
  EXPECT_EQ(
      Read(row),
      (Pic24fRequest{
          .Command = Pic24fCommand::WriteProgram, .Count = 1, .Address = 0x80, .Data = Bytes(256, 0x11)}));
  EXPECT_EQ(
      Read({0x05, 0x02, 0x00, 0xFE, 0xFF, 1, 2, 3, 4}),
      (Pic24fRequest{
          .Command = Pic24fCommand::WriteEeprom, .Count = 2, .Address = 0xFFFE00, .Data = {1, 2, 3, 4}}));
  EXPECT_EQ(
      Read({0x07, 0x01, 0x0E, 0x00, 0xF8, 5, 6}),
      (Pic24fRequest{
          .Command = Pic24fCommand::WriteConfiguration, .Count = 1, .Address = 0xF8000E, .Data = {5, 6}}));
}

TEST(Pic24fRequest, MayEndBehindCountOrCommand) {
  EXPECT_EQ(Read({0x00, 0x02}), (Pic24fRequest{.Command = Pic24fCommand::Version, .Count = 2}));
  EXPECT_EQ(Read({0x00, 0x00}), (Pic24fRequest{.Command = Pic24fCommand::Version, .Count = 0}));
  EXPECT_EQ(Read({0x08}), Pic24fRequest{.Command = Pic24fCommand::VerifyOk});
}

TEST(Pic24fRequest, IsRefusedAtAnyOtherLength) {
  const std::string badLength = "a length that the command does not have";
  for (const Bytes& data :
       {Bytes{0x00}, Bytes{0x00, 0x02, 0x00}, Bytes{0x08, 0x00}, Bytes{0x01}, Bytes{0x01, 0x01, 0x00, 0x00},
        Bytes{0x01, 0x01, 0x00, 0x00, 0x00, 0x00}, Bytes{0x02, 0x01, 0x00, 0x00, 0x00, 0x01},
        Bytes{0x03, 0x01, 0x00, 0x00}, Bytes{0x05, 0x02, 0x00, 0x00, 0x00, 1, 2},
        Bytes{0x07, 0x01, 0x00, 0x00, 0xF8, 5}}) {
    EXPECT_EQ(FaultOf(data), badLength) << testing::PrintToString(data);
  }
}

TEST(Pic24fRequest, NeedsAKnownCommandAndACount) {
  EXPECT_EQ(FaultOf({}), "an unknown command");
  EXPECT_EQ(FaultOf({0x09}), "an unknown command");
  EXPECT_EQ(FaultOf({0x01, 0x00, 0x00, 0x00, 0x00}), "a count of 0");
  EXPECT_EQ(FaultOf({0x03, 0x00, 0x00, 0x00, 0x00}), "a count of 0");
}

TEST(Pic24fRequest, IsRepeatedAtTheHeadOfTheAnswerToARead) {
  EXPECT_EQ(HeaderOf({.Command = Pic24fCommand::ReadProgram, .Count = 4, .Address = 0x123456}),
            (Bytes{0x01, 0x04, 0x56, 0x34, 0x12}));
}

TEST(Pic24fRequest, IsDescribedForTheLog) {
  for (const auto& [data, text] : std::vector<std::pair<Bytes, std::string>>{
           {{0x00, 0x02}, "version"},
           {{0x00, 0x00}, "run"},
           {{0x08}, "verify OK"},
           {{0x01, 0x04, 0x00, 0xFE, 0xFF}, "read 4 at FFFE00"},
           {{0x03, 0x02, 0x00, 0x04, 0x00}, "erase 2 at 000400"},
           {{0x06, 0x01, 0x00, 0x00, 0xF8}, "read configuration 1 at F80000"}}) {
    EXPECT_EQ(Describe(*Read(data)), text);
  }
}

}  // namespace
}  // namespace sim
