// The whole road: the main window, the program that really serves the page, and what phones get of it.

#include <gmock/gmock.h>

#include <QTest>
#include <csignal>
#include <fstream>

#include "platform/qt/QtPipedProgram.h"
#include "tests/support/PrivateData.h"
#include "tests/support/Venue.h"
#include "tests/web/server/ResultsProgram.h"

namespace {

using testing::HasSubstr;
using testing::Not;

/// Processes that this one has started and that run the program of the page.
std::vector<pid_t> ServingProcesses() {
  std::vector<pid_t> found;
  std::ifstream children("/proc/self/task/" + std::to_string(getpid()) + "/children");
  for (pid_t child = 0; children >> child;) {
    std::ifstream words("/proc/" + std::to_string(child) + "/cmdline");
    std::string first;
    std::string second;
    std::getline(words, first, '\0');
    std::getline(words, second, '\0');
    if (first == TESSARINE_RESULTS_PROGRAM && second != "--ask") {
      found.push_back(child);
    }
  }
  return found;
}

std::string GetFrom(std::uint16_t port, const std::string& path) {
  RawClient client(port);
  client.Send("GET " + path + " HTTP/1.1\r\nHost: 127.0.0.1:" + std::to_string(port) +
              "\r\nConnection: close\r\n\r\n");
  return client.ReadAll();
}

class RoadToThePhones : public testing::Test {
 protected:
  RoadToThePhones() {
    venue.Time.Stamps["today"] = "2013-05-21 14:20:00";
    venue.MakePiped = [] { return std::make_unique<QtPipedProgram>(); };
    venue.ResultsProgram = TESSARINE_RESULTS_PROGRAM;
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb", PrivateMember);
    venue.Start();
  }
  ~RoadToThePhones() override { venue.Window->close(); }

  ResultsHost& Host() const { return *venue.Window->findChild<ResultsHost*>(); }

  void Serve(NamesShown names) {
    Host().SetSetup({.On = true, .Address = "127.0.0.1", .Port = 18'700, .Names = names});
    ASSERT_TRUE(WaitForUrl());
  }
  bool WaitForUrl() const {
    return QTest::qWaitFor([this] { return !Host().Url().empty(); }, 20'000);
  }

  /// Waits for a page that holds this text, or no longer holds it.
  bool WaitForPage(const std::string& path, const std::string& text, bool isThere = true) const {
    return QTest::qWaitFor(
        [&] {
          const std::string page = GetFrom(Host().Serving().Port, path);
          return page.starts_with("HTTP/1.1 200") && (page.find(text) != std::string::npos) == isThere;
        },
        20'000);
  }

  void PlayWithTheMember() {
    venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>5</BonusPoints>") +
                            PlayerOf(40,
                                     "<BonusPoints>9</BonusPoints><DallasID>AA0000000000D5E7</DallasID>"
                                     "<MemberIndex>918273645</MemberIndex>")));
  }

  Venue venue;
};

TEST_F(RoadToThePhones, LeadsFromTheBoardToThePage) {
  Serve(NamesShown::OnBoardAndPage);
  PlayWithTheMember();
  EXPECT_TRUE(WaitForPage("/en/g/1/40", "Molefinger"));
  EXPECT_TRUE(WaitForPage("/zh/", "Molefinger"));
  Host().SetSetup({.On = true, .Address = "127.0.0.1", .Port = 18'700, .Names = NamesShown::OnBoard});
  EXPECT_TRUE(WaitForPage("/en/g/1/40", "<bdi>Molefinger", false));
}

TEST_F(RoadToThePhones, CarriesNothingPrivate) {
  Serve(NamesShown::OnBoardAndPage);
  PlayWithTheMember();
  ASSERT_TRUE(WaitForPage("/en/g/1/40", "Molefinger"));
  const std::vector<pid_t> processes = ServingProcesses();
  ASSERT_EQ(processes.size(), 1U);
  const ProcessMemory memory(processes.front());
  EXPECT_TRUE(memory.Holds("Molefinger"));
  for (const std::string& text : Private) {
    EXPECT_FALSE(memory.Holds(text)) << text;
    EXPECT_THAT(GetFrom(Host().Serving().Port, "/en/g/1/40"), Not(HasSubstr(text)));
  }
}

TEST_F(RoadToThePhones, IsBuiltAgainWhenTheProgramIsKilled) {
  Serve(NamesShown::OnBoardAndPage);
  PlayWithTheMember();
  ASSERT_TRUE(WaitForPage("/en/", "Molefinger"));
  const std::vector<pid_t> processes = ServingProcesses();
  ASSERT_EQ(processes.size(), 1U);
  kill(processes.front(), SIGKILL);
  EXPECT_TRUE(QTest::qWaitFor([this] { return Host().Url().empty(); }, 20'000));
  ASSERT_TRUE(WaitForUrl());
  EXPECT_TRUE(WaitForPage("/en/", "Molefinger"));
  EXPECT_EQ(Host().Serving().Starts, 2);
}

TEST_F(RoadToThePhones, EndsWithThePageAndWithTheProgram) {
  Serve(NamesShown::OnBoard);
  ASSERT_EQ(ServingProcesses().size(), 1U);
  Host().SetSetup({});
  EXPECT_TRUE(QTest::qWaitFor([] { return ServingProcesses().empty(); }, 20'000));
  Serve(NamesShown::OnBoard);
  venue.Window->close();
  EXPECT_TRUE(QTest::qWaitFor([] { return ServingProcesses().empty(); }, 20'000));
}

}  // namespace
