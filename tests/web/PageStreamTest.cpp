#include "web/PageStream.h"

#include <gmock/gmock.h>

#include "platform/RuntimeError.h"

namespace {

using namespace std::string_literals;

const std::string PutBytes = "P\x02\x00\x03\x00\x00\x00/aabc"s;
const std::string RemoveBytes = "R\x02\x00\x00\x00\x00\x00/a"s;
const std::string ShowBytes = "S\x00\x00\x00\x00\x00\x00"s;

bool Breaks(const std::string& bytes) {
  PageFrameReader reader;
  reader.Add(bytes);
  while (reader.Next()) {
  }
  return reader.Broken();
}

bool ReportBreaks(const std::string& bytes) {
  PageReportReader reader;
  reader.Add(bytes);
  while (reader.Next()) {
  }
  return reader.Broken();
}

TEST(PageOrders, AreTheseBytes) {
  EXPECT_EQ(EncodeFrame({.Order = PageOrder::Put, .Path = "/a", .Body = "abc"}), PutBytes);
  EXPECT_EQ(EncodeFrame({.Order = PageOrder::Remove, .Path = "/a", .Body = ""}), RemoveBytes);
  EXPECT_EQ(EncodeFrame({}), ShowBytes);
}

TEST(PageOrders, AreReadHoweverTheyAreTorn) {
  PageFrameReader reader;
  std::vector<PageFrame> frames;
  for (const char byte : PutBytes + RemoveBytes + ShowBytes) {
    reader.Add({&byte, 1});
    while (const auto frame = reader.Next()) {
      frames.push_back(*frame);
    }
  }
  const PageFrame put{.Order = PageOrder::Put, .Path = "/a", .Body = "abc"};
  const PageFrame remove{.Order = PageOrder::Remove, .Path = "/a", .Body = ""};
  EXPECT_THAT(frames, testing::ElementsAre(put, remove, PageFrame{}));
  EXPECT_FALSE(reader.Broken());
}

TEST(PageOrders, BreakTheStreamWhenTheyAreNone) {
  EXPECT_TRUE(Breaks("X\x00\x00\x00\x00\x00\x00"s));
  EXPECT_TRUE(Breaks("S\x01\x00\x00\x00\x00\x00/"s));
  EXPECT_TRUE(Breaks("P\x00\x00\x03\x00\x00\x00"s));
  EXPECT_TRUE(Breaks("R\x02\x00\x01\x00\x00\x00"s));
  EXPECT_TRUE(Breaks("P\x41\x00\x01\x00\x00\x00"s));
  EXPECT_TRUE(Breaks("P\x02\x00\x01\x00\x04\x00"s));
  EXPECT_TRUE(Breaks("P\x02\x00\x01\x00\x00\x00/Ab"s));
  EXPECT_FALSE(Breaks(PutBytes + ShowBytes));
}

TEST(PageOrders, LargerThanTheReadersMemoryAreReadWhole) {
  PageFrameReader reader;
  for (int round = 0; round < 3; ++round) {
    const PageFrame large{.Order = PageOrder::Put,
                          .Path = "/a",
                          .Body = std::string(LongestPageBody, static_cast<char>('a' + round))};
    const std::string bytes = EncodeFrame(large) + PutBytes;
    reader.Add(std::string_view(bytes).substr(0, 100'000));
    EXPECT_EQ(reader.Next(), std::nullopt);
    reader.Add(std::string_view(bytes).substr(100'000));
    EXPECT_EQ(reader.Next(), large);
    EXPECT_EQ(reader.Next(), (PageFrame{.Order = PageOrder::Put, .Path = "/a", .Body = "abc"}));
    EXPECT_EQ(reader.Next(), std::nullopt);
  }
}

TEST(PageOrders, OfABrokenStreamAreNotRead) {
  PageFrameReader reader;
  reader.Add("X\x00\x00\x00\x00\x00\x00"s);
  EXPECT_EQ(reader.Next(), std::nullopt);
  reader.Add(PutBytes);
  EXPECT_EQ(reader.Next(), std::nullopt);
  EXPECT_TRUE(reader.Broken());
}

TEST(PageOrders, BeyondTheLimitsAreNotMade) {
  const auto fails = [](const PageFrame& frame) {
    try {
      EncodeFrame(frame);
      return false;
    } catch (const RuntimeError& error) {
      return error.Number() == Fault::InvalidProcedureCall;
    }
  };
  EXPECT_TRUE(fails({.Order = PageOrder::Put, .Path = "a", .Body = "b"}));
  EXPECT_TRUE(fails({.Order = PageOrder::Put, .Path = "", .Body = "b"}));
  EXPECT_TRUE(fails({.Order = PageOrder::Put, .Path = "/" + std::string(LongestPagePath, 'a'), .Body = "b"}));
  EXPECT_TRUE(fails({.Order = PageOrder::Put, .Path = "/a", .Body = std::string(LongestPageBody + 1, 'b')}));
  EXPECT_FALSE(fails({.Order = PageOrder::Put, .Path = "/a", .Body = std::string(LongestPageBody, 'b')}));
}

TEST(PagePaths, AreOfFewLetters) {
  for (const char* path : {"/", "/en/", "/en/g/12/224", "/style.css"}) {
    EXPECT_TRUE(IsPagePath(path)) << path;
  }
  for (const char* path :
       {"", "en", "/A", "/a b", "/../a", "/a..b", "//a", "/a?b", "/%41", "/a\\b", "/\xC3\xA4"}) {
    EXPECT_FALSE(IsPagePath(path)) << path;
  }
}

TEST(PageReports, AreTheseBytes) {
  EXPECT_EQ(EncodeReport({.Kind = ReportKind::Port, .Number = 8080}), "P\x90\x1F\x00\x00"s);
  EXPECT_EQ(EncodeReport({.Kind = ReportKind::Visitors, .Number = 3}), "V\x03\x00\x00\x00"s);
}

TEST(PageReports, AreReadHoweverTheyAreTorn) {
  PageReportReader reader;
  reader.Add("P\x90");
  EXPECT_EQ(reader.Next(), std::nullopt);
  reader.Add("\x1F\x00\x00V\x03\x00\x00\x00"s);
  EXPECT_EQ(reader.Next(), (PageReport{.Kind = ReportKind::Port, .Number = 8080}));
  EXPECT_EQ(reader.Next(), (PageReport{.Kind = ReportKind::Visitors, .Number = 3}));
  EXPECT_EQ(reader.Next(), std::nullopt);
}

TEST(PageReports, AreNumbersInTheirRangesOnly) {
  EXPECT_TRUE(ReportBreaks("P\x00\x00\x00\x00"s));
  EXPECT_TRUE(ReportBreaks("P\x00\x00\x01\x00"s));
  EXPECT_TRUE(ReportBreaks("V\x01\x10\x00\x00"s));
  EXPECT_TRUE(ReportBreaks("W\x01\x00\x00\x00"s));
  EXPECT_FALSE(ReportBreaks("V\x00\x10\x00\x00"s));
  EXPECT_FALSE(ReportBreaks("P\xFF\xFF\x00\x00"s));
}

}  // namespace
