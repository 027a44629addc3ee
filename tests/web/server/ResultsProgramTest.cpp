#include <gmock/gmock.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

#include "tests/web/server/ResultsProgram.h"
#include "web/server/ListenSocket.h"

namespace {

using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

class ResultsServer : public testing::Test {
 protected:
  void SetUp() override {
    ASSERT_GT(program.Port, 0);
    program.Put("/", "<p>front</p>");
    program.Put("/en/g/1/40", "<p>gun</p>");
    program.Put("/missing", "<p>gone</p>");
    program.Settle();
  }

  ResultsProgram program;
};

TEST_F(ResultsServer, ServesItsPages) {
  EXPECT_THAT(program.Get("/"), AllOf(StartsWith("HTTP/1.1 200 "), EndsWith("\r\n\r\n<p>front</p>"),
                                      HasSubstr("Content-Type: text/html; charset=utf-8\r\n")));
  EXPECT_THAT(program.Get("/en/g/1/40"), EndsWith("\r\n\r\n<p>gun</p>"));
  EXPECT_THAT(program.Get("/?from=poster"), EndsWith("\r\n\r\n<p>front</p>"));
}

TEST_F(ResultsServer, AnswersHeadWithoutTheBody) {
  EXPECT_THAT(program.Ask("HEAD / HTTP/1.1", program.Host()),
              AllOf(StartsWith("HTTP/1.1 200 "), HasSubstr("Content-Length: 12\r\n"), EndsWith("\r\n\r\n")));
}

TEST_F(ResultsServer, KeepsAConnection) {
  RawClient client(program.Port);
  for (int i = 0; i < 3; ++i) {
    ASSERT_TRUE(client.Send("GET / HTTP/1.1\r\n" + program.Host() + "\r\n"));
    EXPECT_THAT(client.ReadAnswer(), AllOf(StartsWith("HTTP/1.1 200 "), EndsWith("<p>front</p>")));
  }
}

TEST_F(ResultsServer, AnswersRequestsSentAtOnceInTheirOrder) {
  RawClient client(program.Port);
  client.Send("GET /en/g/1/40 HTTP/1.1\r\n" + program.Host() + "\r\nGET / HTTP/1.1\r\n" + program.Host() +
              "\r\n");
  EXPECT_THAT(client.ReadAnswer(), EndsWith("<p>gun</p>"));
  EXPECT_THAT(client.ReadAnswer(), EndsWith("<p>front</p>"));
}

TEST_F(ResultsServer, DoesNotSendAPageThatTheBrowserHas) {
  const std::string answer = program.Get("/");
  const std::size_t at = answer.find("ETag: ");
  ASSERT_NE(at, std::string::npos);
  const std::string tag = answer.substr(at + 6, answer.find("\r\n", at) - at - 6);
  const auto again = [&] {
    return program.Ask("GET / HTTP/1.1", program.Host() + "If-None-Match: " + tag + "\r\n");
  };
  EXPECT_THAT(again(), AllOf(StartsWith("HTTP/1.1 304 "), Not(HasSubstr("front"))));
  EXPECT_THAT(program.Ask("GET / HTTP/1.1", program.Host() + "If-None-Match: *\r\n"),
              StartsWith("HTTP/1.1 304 "));
  program.Put("/", "<p>new</p>");
  program.Settle();
  EXPECT_THAT(again(), AllOf(StartsWith("HTTP/1.1 200 "), EndsWith("<p>new</p>")));
}

TEST_F(ResultsServer, ReplacesAndRemovesPages) {
  program.Put("/", "<p>new</p>");
  program.Write(EncodeFrame({.Order = PageOrder::Remove, .Path = "/en/g/1/40", .Body = ""}));
  program.Settle();
  EXPECT_THAT(program.Get("/"), EndsWith("<p>new</p>"));
  EXPECT_THAT(program.Get("/en/g/1/40"), StartsWith("HTTP/1.1 404 "));
}

TEST_F(ResultsServer, SendsTheUsualHeadersWithEveryAnswerToAWholeRequest) {
  for (const std::string& answer :
       {program.Get("/"), program.Get("/none"), program.Ask("GET / HTTP/1.1", "Host: other\r\n"),
        program.Ask("POST / HTTP/1.1", program.Host() + "Content-Length: 0\r\n"),
        program.Ask("GET / HTTP/1.1", ""), program.Get("/favicon.ico")}) {
    EXPECT_THAT(answer, AllOf(HasSubstr("Content-Security-Policy: default-src 'none'; "),
                              HasSubstr("X-Content-Type-Options: nosniff\r\n"),
                              HasSubstr("Referrer-Policy: no-referrer\r\n"),
                              HasSubstr("Cache-Control: no-cache\r\n")));
    EXPECT_THAT(answer,
                AllOf(Not(HasSubstr("Server:")), Not(HasSubstr("Set-Cookie")), Not(HasSubstr("unsafe"))));
  }
}

TEST_F(ResultsServer, SaysThatAPageIsNotThere) {
  for (const char* path :
       {"/none", "/missing", "/en", "/../../etc/passwd", "/%2e%2e/%2e%2e/etc/passwd", "/%2F", "/%00", "//",
        "/.", "https://other/", "*", "/\xC3\xA4", "/en/g/1/40/", "/etc/passwd", "/proc/self/environ"}) {
    EXPECT_THAT(program.Get(path), AllOf(StartsWith("HTTP/1.1 404 "), EndsWith("<p>gone</p>"))) << path;
  }
}

TEST_F(ResultsServer, TakesNoPathForAnotherThatItBeginsWith) {
  using namespace std::string_literals;
  const std::string url = "http://127.0.0.1:" + std::to_string(program.Port);
  for (const std::string& path : {"/\0x"s, "/\0"s, "\0"s, "\0/"s, "/en/g/1/40\0.html"s, "/\0?a=b"s, "/?\0"s,
                                  "/?a=\0b"s, url + "\0"s, url + "/\0x"s}) {
    EXPECT_THAT(program.Get(path), AllOf(StartsWith("HTTP/1.1 404 "), EndsWith("<p>gone</p>"))) << path;
  }
  for (const char* path : {"/", "/?", "/?a", "/?a=b&c", "//?"}) {
    const bool isFront = std::string_view(path) != "//?";
    EXPECT_THAT(program.Get(path), EndsWith(isFront ? "<p>front</p>" : "<p>gone</p>")) << path;
  }
  EXPECT_THAT(program.Ask("GET   / HTTP/1.1", program.Host()), EndsWith("<p>front</p>"));
}

TEST_F(ResultsServer, RefusesOtherHosts) {
  const std::string port = std::to_string(program.Port);
  const std::vector<std::string> hosts{"Host: other\r\n",
                                       "Host: 127.0.0.1\r\n",
                                       "Host: 127.0.0.1:1\r\n",
                                       "Host: \r\n",
                                       "Host: 127.0.0.1.other:" + port + "\r\n",
                                       program.Host() + program.Host(),
                                       "Host: other\r\n" + program.Host(),
                                       "Host: user@127.0.0.1:" + port + "\r\n"};
  for (const std::string& host : hosts) {
    EXPECT_THAT(program.Ask("GET / HTTP/1.1", host), StartsWith("HTTP/1.1 421 ")) << host;
  }
  EXPECT_THAT(program.Ask("GET / HTTP/1.0", ""), StartsWith("HTTP/1.1 421 "));
  EXPECT_THAT(program.Ask("GET / HTTP/1.1", ""), StartsWith("HTTP/1.1 421 "));
  for (const char* url :
       {"http://other/", "http://127.0.0.1/", "http://127.0.0.1:1/", "http://", "http:///"}) {
    EXPECT_THAT(program.Get(url), StartsWith("HTTP/1.1 421 ")) << url;
  }
  EXPECT_THAT(program.Ask("GET http://127.0.0.1:" + port + "/ HTTP/1.1", "Host: other\r\n"),
              StartsWith("HTTP/1.1 421 "));
  EXPECT_THAT(program.Ask("GET / HTTP/1.1", "Host: LOCALHOST:" + port + "\r\n"), StartsWith("HTTP/1.1 200 "));
}

TEST_F(ResultsServer, TakesTheWholeAddressInPlaceOfThePath) {
  const std::string url = "http://127.0.0.1:" + std::to_string(program.Port);
  EXPECT_THAT(program.Get(url), EndsWith("\r\n\r\n<p>front</p>"));
  EXPECT_THAT(program.Get(url + "/?from=poster"), EndsWith("\r\n\r\n<p>front</p>"));
  EXPECT_THAT(program.Get("HTTP" + url.substr(4) + "/en/g/1/40"), EndsWith("\r\n\r\n<p>gun</p>"));
}

TEST_F(ResultsServer, HasNoIconAndSaysSoBriefly) {
  EXPECT_THAT(program.Get("/favicon.ico"), AllOf(StartsWith("HTTP/1.1 204 "), EndsWith("\r\n\r\n")));
}

TEST_F(ResultsServer, RefusesRequestsThatCanBeReadInTwoWays) {
  for (const std::string& headers :
       {std::string("Content-Length: -1\r\n"), std::string("Content-Length: 99999999999999999999999\r\n"),
        std::string("Content-Length: 5\r\nTransfer-Encoding: chunked\r\n"),
        std::string("Content-Length: 5\r\nContent-Length: 6\r\n")}) {
    RawClient client(program.Port);
    client.Send("GET / HTTP/1.1\r\n" + program.Host() + headers + "\r\nGET /en/g/1/40 HTTP/1.1\r\n" +
                program.Host() + "\r\n");
    EXPECT_THAT(client.ReadAll(), Not(HasSubstr("<p>gun</p>"))) << headers;
    EXPECT_TRUE(client.IsClosed());
  }
}

TEST_F(ResultsServer, RefusesOtherMethods) {
  for (const char* method : {"POST", "PUT", "DELETE", "OPTIONS", "TRACE", "CONNECT", "PATCH", "get", "X"}) {
    EXPECT_THAT(program.Ask(std::string(method) + " / HTTP/1.1", program.Host()),
                AllOf(StartsWith("HTTP/1.1 405 "), HasSubstr("Allow: GET, HEAD\r\n")))
        << method;
  }
}

TEST_F(ResultsServer, CountsItsVisitors) {
  program.Get("/");
  EXPECT_EQ(program.NextReport(), (PageReport{.Kind = ReportKind::Visitors, .Number = 1}));
}

TEST_F(ResultsServer, TakesTheNextFreePort) {
  const ResultsProgram second(program.Port);
  EXPECT_GT(second.Port, program.Port);
  EXPECT_LT(second.Port, program.Port + TriedPorts);
  EXPECT_THAT(second.Get("/"), StartsWith("HTTP/1.1 404 "));
}

TEST_F(ResultsServer, EndsWithItsParent) {
  program.CloseInput();
  EXPECT_EQ(program.WaitForEnd(), 0);
}

TEST_F(ResultsServer, EndsWhenItsOrdersAreNone) {
  program.Write("GET / HTTP/1.1\r\n");
  EXPECT_EQ(program.WaitForEnd(), 2);
}

TEST_F(ResultsServer, HasNoHandlesButItsPipesAndItsSockets) {
  std::vector<std::string> targets;
  for (const auto& entry :
       std::filesystem::directory_iterator("/proc/" + std::to_string(program.Process()) + "/fd")) {
    targets.push_back(std::filesystem::read_symlink(entry.path()).string());
  }
  const auto count = [&targets](const char* kind) {
    return std::ranges::count_if(targets,
                                 [kind](const std::string& target) { return target.starts_with(kind); });
  };
  EXPECT_GE(count("pipe:"), 2);
  EXPECT_EQ(count("socket:"), 1);  // the one that listens
  EXPECT_EQ(count("anon_inode:"), 1);
  EXPECT_EQ(targets.size(), 5U);  // with the stream of its errors
}

TEST_F(ResultsServer, GaveUpItsRights) {
  EXPECT_THAT(program.About("status"), HasSubstr("NoNewPrivs:\t1"));
  EXPECT_THAT(program.About("status"), HasSubstr("CapEff:\t0000000000000000"));
  const std::string limits = program.About("limits");
  EXPECT_THAT(limits, testing::ContainsRegex("Max file size +0 +0"));
  EXPECT_THAT(limits, testing::ContainsRegex("Max open files +1056 +1056"));
  EXPECT_THAT(limits, testing::ContainsRegex("Max core file size +0 +0"));
}

TEST(ResultsServerElsewhere, ServesOnlyAtPrivateAddresses) {
  for (const char* address : {"0.0.0.0", "8.8.8.8", "::", "somewhere", ""}) {
    ResultsProgram program(18'200, address);
    EXPECT_EQ(program.Port, 0) << address;
    EXPECT_EQ(program.WaitForEnd(), 3) << address;
  }
}

}  // namespace
