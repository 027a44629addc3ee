#include "web/server/TrialRequest.h"

#include <gtest/gtest.h>

#include "tests/web/server/ResultsProgram.h"

namespace {

/// What the program reports that is started to ask.
std::string ReportOf(const std::string& address, const std::string& port) {
  Pipe reports;
  StandardStreams streams;
  streams.Output = reports.WriteEnd.Number();
  ChildProcess asker({TESSARINE_RESULTS_PROGRAM, "--ask", address, port}, streams);
  reports.WriteEnd.Close();
  std::string bytes;
  std::array<char, 64> part{};
  for (ssize_t count = 0; (count = read(reports.ReadEnd.Number(), part.data(), part.size())) > 0;) {
    bytes.append(part.data(), static_cast<std::size_t>(count));
  }
  return bytes;
}

const std::string Answered("A\x01\x00\x00\x00", 5);
const std::string Unanswered("A\x00\x00\x00\x00", 5);

TEST(TrialRequest, IsAnsweredByTheProgramThatServesThePages) {
  ResultsProgram program(18'600);
  program.Put("/now", "0123456789abcdef");
  program.Show();
  program.Settle();
  EXPECT_TRUE(IsAnswered({.Address = "127.0.0.1", .Port = program.Port}));
  EXPECT_EQ(ReportOf("127.0.0.1", std::to_string(program.Port)), Answered);
}

TEST(TrialRequest, IsNoVisitor) {
  ResultsProgram program(18'620);
  program.Put("/now", "0123456789abcdef");
  program.Show();
  program.Settle();  // its own requests are those of a visitor
  const auto counted = program.NextReport();
  ASSERT_TRUE(counted);
  EXPECT_EQ(counted->Number, 1U);
  EXPECT_TRUE(IsAnswered({.Address = "127.0.0.1", .Port = program.Port}));
}

TEST(TrialRequest, IsNotAnsweredWhereNothingIsServed) {
  std::uint16_t port = 0;
  {
    ResultsProgram program(18'640);
    EXPECT_FALSE(IsAnswered({.Address = "127.0.0.1", .Port = program.Port}));  // it has no page yet
    port = program.Port;
  }
  EXPECT_EQ(ReportOf("127.0.0.1", std::to_string(port)), Unanswered);
}

TEST(TrialRequest, IsNotMadeOfTheInternet) {
  EXPECT_FALSE(IsAnswered({.Address = "8.8.8.8", .Port = 80}));
  EXPECT_FALSE(IsAnswered({.Address = "example.org", .Port = 80}));
  EXPECT_EQ(ReportOf("127.0.0.1", "0"), "");
}

}  // namespace
