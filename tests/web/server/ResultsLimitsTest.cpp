#include <gmock/gmock.h>
#include <sys/resource.h>
#include <sys/un.h>

#include <algorithm>
#include <memory>
#include <vector>

#include "tests/support/TemporaryFolder.h"
#include "tests/web/server/ResultsProgram.h"
#include "web/server/PageHost.h"

namespace {

using testing::AnyOf;
using testing::StartsWith;

constexpr const char* Found = "HTTP/1.1 200 ";

class CrowdedServer : public testing::Test {
 protected:
  void SetUp() override {
    ASSERT_GT(program.Port, 0);
    program.Put("/", "<p>front</p>");
    program.Settle();
  }

  ResultsProgram program{18'300};
};

/// Lets this program have that many handles.
void AllowHandles(rlim_t count) {
  rlimit limit{};
  getrlimit(RLIMIT_NOFILE, &limit);
  limit.rlim_cur = std::min(limit.rlim_max, std::max(limit.rlim_cur, count));
  setrlimit(RLIMIT_NOFILE, &limit);
}

TEST_F(CrowdedServer, AnswersWhileOthersSendOnlyHalfARequest) {
  std::vector<std::unique_ptr<RawClient>> half;
  for (int i = 0; i < 100; ++i) {
    half.push_back(std::make_unique<RawClient>(program.Port));
    half.back()->Send("GET / HTTP/1.1\r\nHost: 127.");
  }
  EXPECT_THAT(program.Get("/"), StartsWith(Found));
}

TEST_F(CrowdedServer, ReadsARequestThatComesByteByByte) {
  RawClient slow(program.Port);
  for (const char byte : "GET / HTTP/1.1\r\n" + program.Host() + "Connection: close\r\n\r\n") {
    ASSERT_TRUE(slow.Send(std::string(1, byte)));
    ASSERT_THAT(program.Get("/"), StartsWith(Found));
  }
  EXPECT_THAT(slow.ReadAll(), StartsWith(Found));
}

TEST_F(CrowdedServer, RefusesHeadsAndPathsBeyondTheirLimit) {
  for (const std::size_t size : {7'000U, 100'000U, 10'000'000U}) {
    for (const std::string& request :
         {"GET /" + std::string(size, 'a') + " HTTP/1.1\r\n" + program.Host() + "\r\n",
          "GET / HTTP/1.1\r\n" + program.Host() + "X: " + std::string(size, 'a') + "\r\n\r\n"}) {
      RawClient client(program.Port);
      client.Send(request);
      // The rest of a long request may end the connection before the answer is read.
      EXPECT_THAT(client.ReadAll(), AnyOf("", StartsWith("HTTP/1.1 414 "), StartsWith("HTTP/1.1 431 "),
                                          StartsWith("HTTP/1.1 413 ")));
    }
  }
  EXPECT_THAT(program.Get("/"), StartsWith(Found));
}

TEST_F(CrowdedServer, OutlivesWhatIsNoRequest) {
  for (const std::string& rubbish :
       {std::string(5000, '\0'), std::string("\r\n\r\n\r\n"), std::string("\x16\x03\x01\x02\x00", 5),
        std::string("GET\r\n\r\n"), std::string("GET / HTTP/9.9\r\n\r\n"), std::string(100'000, '\xFF'),
        "GET / HTTP/1.1\r\n" + program.Host() + "Content-Length: -1\r\n\r\n",
        "GET / HTTP/1.1\r\n" + program.Host() + "Transfer-Encoding: chunked\r\n\r\nFFFFFFFFFFFFFFFFFF\r\n",
        "GET / HTTP/1.1\r\n" + program.Host() + " folded\r\n\r\n"}) {
    RawClient(program.Port).Send(rubbish);
    EXPECT_THAT(program.Get("/"), StartsWith(Found));
  }
}

TEST_F(CrowdedServer, EndsTheConnectionOfAGetWithABody) {
  RawClient client(program.Port);
  client.Send("GET / HTTP/1.1\r\n" + program.Host() + "Content-Length: 1000000000\r\n\r\nabc");
  EXPECT_TRUE(client.IsClosed());
}

TEST_F(CrowdedServer, EndsTheConnectionsThatWaitedLongestWhenAnAddressHasFiveHundred) {
  AllowHandles(2000);
  std::vector<std::unique_ptr<RawClient>> many;
  for (int i = 0; i < 1000; ++i) {
    many.push_back(std::make_unique<RawClient>(program.Port));
  }
  EXPECT_THAT(program.Get("/"), StartsWith(Found));
  EXPECT_TRUE(many[0]->IsClosed());
  EXPECT_TRUE(many[400]->IsClosed());
  ASSERT_TRUE(many[999]->Send("GET / HTTP/1.1\r\n" + program.Host() + "\r\n"));
  EXPECT_THAT(many[999]->ReadAnswer(), StartsWith(Found));
}

TEST_F(CrowdedServer, AnswersWhileTwoAddressesHoldAllConnections) {
  AllowHandles(2000);
  std::vector<std::unique_ptr<RawClient>> many;
  for (int i = 0; i < 1100; ++i) {
    many.push_back(std::make_unique<RawClient>(program.Port, i % 2 == 0 ? "127.0.0.2" : "127.0.0.3"));
    many.back()->Send("GET / HTTP/1.1\r\nHost: 127.");
  }
  EXPECT_THAT(program.Get("/"), StartsWith(Found));
}

TEST(ServerWithFewHandles, ServesWithAsManyConnectionsAsItMayHave) {
  ResultsProgram program(18'350, "127.0.0.1", 400);
  ASSERT_GT(program.Port, 0);
  EXPECT_THAT(program.About("limits"), testing::ContainsRegex("Max open files +400 +400"));
  program.Put("/", "<p>front</p>");
  program.Settle();
  EXPECT_THAT(program.Get("/"), StartsWith(Found));
}

TEST(ServerWithFewHandles, EndsWhereTheyAreTooFew) {
  ResultsProgram program(18'360, "127.0.0.1", 100);
  EXPECT_EQ(program.Port, 0);
  EXPECT_EQ(program.WaitForEnd(), 4);
}

/// The part that answers, run by the test step by step.
class OwnHost : public testing::Test {
 protected:
  void SetUp() override {
    socket = Listen({.Address = "127.0.0.1", .Port = 18'400});
    ASSERT_GE(socket.Handle, 0);
    host = std::make_unique<PageHost>(socket, pages, visitors);
    ASSERT_TRUE(host->Serving());
  }

  /// Runs the host until it has that many connections.
  void RunUntil(std::size_t connections) {
    for (int tries = 0; tries < 1000 && host->Connections() != connections; ++tries) {
      pollfd wait{.fd = host->Handle(), .events = POLLIN, .revents = 0};
      poll(&wait, 1, 100);
      host->Run();
    }
    ASSERT_EQ(host->Connections(), connections);
  }

  ServedPages pages;
  Visitors visitors;
  ListenSocket socket;
  std::unique_ptr<PageHost> host;
};

TEST_F(OwnHost, EndsAConnectionWhoseRequestTakesTooLong) {
  RawClient slow(socket.Served.Port);
  slow.Send("GET / HTTP/1.1\r\nHos");
  RunUntil(1);
  const auto now = std::chrono::steady_clock::now();
  host->EndSlowOnes(now);
  host->Run();
  EXPECT_EQ(host->Connections(), 1U);
  host->EndSlowOnes(now + PageHost::Limits().First);
  RunUntil(0);
  EXPECT_TRUE(slow.IsClosed());
}

TEST_F(OwnHost, LeavesAConnectionThatWasAnsweredMoreTime) {
  RawClient phone(socket.Served.Port);
  const std::string name = "127.0.0.1:" + std::to_string(socket.Served.Port);
  phone.Send("GET / HTTP/1.1\r\nHost: " + name + "\r\n\r\n");
  RunUntil(1);
  for (int tries = 0; tries < 100 && !visitors.Any(); ++tries) {
    pollfd wait{.fd = host->Handle(), .events = POLLIN, .revents = 0};
    poll(&wait, 1, 100);
    host->Run();
  }
  const auto now = std::chrono::steady_clock::now();
  host->EndSlowOnes(now + PageHost::Limits().First);
  host->Run();
  EXPECT_EQ(host->Connections(), 1U);
  host->EndSlowOnes(now + PageHost::Limits().Request);
  RunUntil(0);
}

TEST(HostForPeersOfAnotherKind, EndsTheirConnectionsUnanswered) {
  // Sockets of files: what comes there has no address, so none that could be a private one.
  const TemporaryFolder folder;
  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  (folder / "pages").copy(address.sun_path, sizeof address.sun_path - 1);
  const auto* plain = reinterpret_cast<const sockaddr*>(&address);
  const int listener = ::socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
  ASSERT_EQ(bind(listener, plain, sizeof address), 0);
  ASSERT_EQ(listen(listener, 8), 0);
  const ServedPages pages;
  Visitors visitors;
  PageHost host({.Handle = listener, .Served = {.Address = "127.0.0.1", .Port = 18'450}}, pages, visitors);
  ASSERT_TRUE(host.Serving());

  const Descriptor stranger(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
  ASSERT_EQ(connect(stranger.Number(), plain, sizeof address), 0);
  const std::string request = "GET / HTTP/1.1\r\nHost: 127.0.0.1:18450\r\n\r\n";
  ASSERT_EQ(send(stranger.Number(), request.data(), request.size(), MSG_NOSIGNAL),
            static_cast<ssize_t>(request.size()));
  host.Run();
  EXPECT_EQ(host.Connections(), 0U);
  EXPECT_FALSE(visitors.Any());
  pollfd wait{.fd = stranger.Number(), .events = POLLIN, .revents = 0};
  ASSERT_EQ(poll(&wait, 1, WireLimit), 1);
  char byte = 0;
  EXPECT_LE(recv(stranger.Number(), &byte, 1, 0), 0);
}

TEST_F(OwnHost, FillsNoMoreThanItsShareForOneWhoDoesNotRead) {
  pages.Take({.Order = PageOrder::Put, .Path = "/large", .Body = std::string(LongestPageBody, 'x')});
  pages.Take({});
  RawClient idle(socket.Served.Port);
  const std::string name = "127.0.0.1:" + std::to_string(socket.Served.Port);
  std::string requests;
  for (int i = 0; i < 60; ++i) {
    requests.append("GET /large HTTP/1.1\r\nHost: ").append(name).append("\r\n\r\n");
  }
  ASSERT_TRUE(idle.Send(requests));
  pollfd wait{.fd = host->Handle(), .events = POLLIN, .revents = 0};
  while (poll(&wait, 1, 200) == 1) {  // until nothing more can be done for it
    host->Run();
  }
  const std::size_t held = idle.CountWaiting();  // by the system, for both ends
  EXPECT_GT(held, 0U);
  EXPECT_LT(held, 1'500'000U);
}

TEST_F(OwnHost, WaitsForNothingWithoutConnections) {
  EXPECT_LT(host->Due().count(), 0);
}

}  // namespace
