#include "sound/SoundRecording.h"

#include "tests/sound/RecordingSite.h"
#include "tests/support/Bytes.h"
#include "tests/support/Thrown.h"

namespace {

using std::chrono::milliseconds;
using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

Bytes Joined(std::initializer_list<Bytes> parts) {
  Bytes all;
  for (const Bytes& part : parts) {
    all.insert(all.end(), part.begin(), part.end());
  }
  return all;
}

/// Samples 1 to 100 over and over, as Samples makes them.
Bytes FirstPage() {
  const std::string samples = Samples(256);
  return {samples.begin(), samples.end()};
}

const Bytes Silence(256, 0x80);

class Recording : public RecordingSite {};

TEST_F(Recording, WithoutFilesIsStartEraseAndEnd) {
  Fill({{"", ""}, {"", ""}});
  Record();
  EXPECT_THAT(port.Sent, ElementsAre(2, 3, 2, 3, 0, 0));
  EXPECT_THAT(port.Log, Contains("Open /dev/x 115200,N,8,1"));
  EXPECT_EQ(port.Log.back(), "Close");
  EXPECT_THAT(display.Statuses,
              ElementsAre("Starting...", "Erasing Flash...", "Erase complete.", "Recording Complete."));
  EXPECT_THAT(display.Statuses2, ElementsAre(""));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Recording, InAProductWithoutFilesAlsoSendsTheTable) {
  Use(Recorder::InProduct);
  Fill({{"", ""}, {"", ""}});
  Record();
  Bytes entries(256);
  entries[1] = 1;
  entries[3] = 2;
  entries[5] = 3;
  EXPECT_EQ(port.Sent, Joined({{10, 0, 2, 0, 1, 0, 0, 0}, entries, {0x95}, {0, 0}}));
  EXPECT_THAT(port.Log, Contains("Open /dev/x 19200,N,8,1"));
  EXPECT_THAT(display.Statuses,
              ElementsAre("Starting...", "Erasing Flash...", "Erase complete.", "Sending Page Indexes",
                          "Page Indexes sent OK", "Recording Complete."));
}

TEST_F(Recording, OfTwoPagesByTheStandAloneRecorder) {
  Fill({{"", ""}, {"/a.raw", Samples(500)}});
  Record();
  EXPECT_EQ(port.Sent, Joined({{2, 3, 2, 3, 1, 1, 2, 0}, FirstPage(), {0x20}, Silence, {0xA3}, {0, 0}}));
  EXPECT_THAT(display.Statuses, ElementsAre("Starting...", "Erasing Flash...", "Erase complete.",
                                            "Programming File: /a.raw", "Idle", "Recording Complete."));
  EXPECT_THAT(display.Statuses2,
              ElementsAre("Sending Page Number:  0 of  1", "Sending Page Number:  1 of  1", ""));
  EXPECT_THAT(display.Rows, ElementsAre(1));
  EXPECT_EQ(display.Pages, 2);
}

TEST_F(Recording, OfTwoPagesInAProduct) {
  Use(Recorder::InProduct);
  Fill({{"/a.raw", Samples(500)}});
  Record();
  Bytes entries(256);
  entries[1] = 1;
  entries[3] = 3;
  EXPECT_EQ(port.Sent, Joined({{10, 0, 2, 0, 1, 0, 0, 0},
                               entries,
                               {0x75},
                               {1, 0, 0, 0},
                               FirstPage(),
                               {0x20},
                               {1, 0, 1, 0},
                               Silence,
                               {0x2C},
                               {0, 0}}));
}

TEST_F(Recording, SendsPagesFromZeroOnThroughAllSoundsThoughTheTableStartsAtOne) {
  Use(Recorder::InProduct);
  Fill({{"/a.raw", Samples(512)}, {"", ""}, {"/b.raw", Samples(256)}});
  Record();
  EXPECT_EQ(table.Entry(0), 1);
  ASSERT_EQ(hardware.Data.size(), 4U);  // the table and three pages
  const std::size_t beforePages = 8 + 257;
  for (std::size_t page = 0; page < 3; ++page) {
    const auto start = port.Sent.begin() + static_cast<std::ptrdiff_t>(beforePages + page * (4 + 257));
    EXPECT_THAT(Bytes(start, start + 4), ElementsAre(1, 0, page, 0));
  }
}

TEST_F(Recording, OfAWaveSendsItsSamplesOnly) {
  Fill({{"/a.wav", Riff(FormatChunk() + Chunk("LIST", "abc") + Chunk("data", Samples(600, 7)))}});
  Record();
  ASSERT_EQ(hardware.Data.size(), 2U);
  const std::string samples = Samples(600, 7);
  EXPECT_EQ(hardware.Data[0], Bytes(samples.begin(), samples.begin() + 256));
  EXPECT_EQ(hardware.Data[1], Silence);
}

TEST_F(Recording, Of20000BytesIs78PagesOfWhichTheLastIsSilent) {
  Fill({{"/a.raw", std::string(20000, 'x')}});
  Record();
  EXPECT_THAT(hardware.Log, Contains("pages 78"));
  ASSERT_EQ(hardware.Data.size(), 78U);
  EXPECT_EQ(hardware.Data[76], Bytes(256, 'x'));
  EXPECT_EQ(hardware.Data[77], Silence);
  EXPECT_THAT(display.Statuses2, Contains("Sending Page Number:  0 of  77"));
  EXPECT_THAT(display.Statuses2, Contains("Sending Page Number:  77 of  77"));
}

TEST_F(Recording, TellsMoreThan255PagesInBothBytes) {
  Fill({{"/a.raw", std::string(300 * 256, 'x')}});
  Record();
  EXPECT_THAT(Bytes(port.Sent.begin() + 4, port.Sent.begin() + 8), ElementsAre(1, 0, 0x2C, 1));
  EXPECT_THAT(hardware.Log, Contains("pages 300"));
  EXPECT_EQ(hardware.Log.back(), "end");
}

TEST_F(Recording, FillsAFileThatIsCutWithZeros) {
  Fill({{"/a.wav", Riff(FormatChunk() + "data" + Little(768, 4) + Samples(300))}});
  Record();
  ASSERT_EQ(hardware.Data.size(), 3U);
  const std::string samples = Samples(300) + std::string(212, '\0');
  EXPECT_EQ(hardware.Data[1], Bytes(samples.begin() + 256, samples.end()));
  EXPECT_EQ(hardware.Data[2], Silence);
}

TEST_F(Recording, RoundsUpToAPageThatTheFileDoesNotFill) {
  Fill({{"/a.raw", Samples(400)}});  // 1.56 pages
  Record();
  ASSERT_EQ(hardware.Data.size(), 2U);
  EXPECT_EQ(hardware.Data[0], FirstPage());
}

TEST_F(Recording, OfNoPagesStopsBeforeItsHeader) {
  Fill({{"/a.raw", std::string(128, 'x')}});
  EXPECT_EQ(NumberThrownBy([this] { Record(); }), 9);
  EXPECT_THAT(port.Sent, ElementsAre(2, 3, 2, 3));
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Recording, OfAFileThatIsGoneStopsAndClosesTheLine) {
  Fill({{"/a.raw", Samples(300)}});
  hardware.Acknowledges = [this](const std::string& what) {
    if (what == "erase") {
      disk.Remove("/a.raw");
    }
    return true;
  };
  EXPECT_EQ(NumberThrownBy([this] { Record(); }), 53);
  EXPECT_FALSE(port.PortOpen());
  EXPECT_THAT(hardware.Log, ElementsAre("start", "erase"));
}

TEST_F(Recording, OfAFileThatTheDiskNoLongerGivesStopsAndClosesTheLine) {
  Fill({{"/a.raw", Samples(300)}});
  hardware.Acknowledges = [this](const std::string& what) {
    if (what == "erase") {
      disk.FailRead("/a.raw", RuntimeError(Fault::PathAccess));
    }
    return true;
  };
  EXPECT_EQ(NumberThrownBy([this] { Record(); }), 75);
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Recording, OfAFileThatGrewBeyondAllPagesOverflows) {
  Fill({{"/a.raw", Samples(300)}});
  hardware.Acknowledges = [this](const std::string& what) {
    if (what == "erase") {
      disk.Put("/a.raw", std::string(32768 * 256, 'x'));
    }
    return true;
  };
  EXPECT_EQ(NumberThrownBy([this] { Record(); }), 6);
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Recording, OfAWaveThatIsRefusedFailsWithoutAnEnd) {
  Fill({{"/a.raw", Samples(300)}, {"/b.wav", Wave(Samples(300))}, {"/c.raw", Samples(300)}});
  hardware.Acknowledges = [this](const std::string& what) {
    if (what == "erase") {
      disk.Put("/b.wav", "text");
    }
    return true;
  };
  Record();
  EXPECT_THAT(hardware.Log, ElementsAre("start", "erase", "header 0", "pages 1", "data"));
  EXPECT_EQ(display.Statuses.back(), "Recording Failed.");
  EXPECT_EQ(display.Statuses2.back(), "");
  EXPECT_FALSE(port.PortOpen());
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Sound File Format error: Not a Wave file.");
}

TEST_F(Recording, PausesAsTheStandAloneRecorderNeedsIt) {
  Fill({{"/a.raw", Samples(300)}});
  Record();
  const std::vector<int> expected = {10, 10, 20, 10, 20, 20, 20, 20, 20, 10};
  std::vector<int> sleeps;
  for (const milliseconds sleep : pump.Sleeps) {
    sleeps.push_back(static_cast<int>(sleep.count()));
  }
  EXPECT_EQ(sleeps, expected);
}

TEST_F(Recording, PausesAsAProductNeedsIt) {
  Use(Recorder::InProduct);
  Fill({{"/a.raw", Samples(300)}});
  Record();
  std::vector<int> expected = {10, 10, 20, 10, 10, 10, 10};  // start, erase, the table's prefix
  expected.insert(expected.end(), 256, 1);
  // the table's check byte and end; the sound's header, none, and its first page with the prefix
  expected.insert(expected.end(), {20, 20, 20, 20, 20, 10, 10, 10, 10});
  expected.insert(expected.end(), 256, 1);
  expected.insert(expected.end(), {20, 20, 10});
  std::vector<int> sleeps;
  for (const milliseconds sleep : pump.Sleeps) {
    sleeps.push_back(static_cast<int>(sleep.count()));
  }
  EXPECT_EQ(sleeps, expected);
}

TEST_F(Recording, LetsTheLineEmptyBeforeEachLongPauseButNotBeforeAShortOne) {
  Use(Recorder::InProduct);
  Fill({{"/a.raw", Samples(300)}});
  Record();
  std::vector<std::size_t> drained;
  for (const FakeSerialPort::DrainCall& call : port.Drains) {
    drained.push_back(call.BytesSent);
  }
  const std::size_t entries = 4 + 4 + 256;
  const std::size_t page = entries + 1 + 4 + 256;
  EXPECT_THAT(drained, ElementsAre(1, 3, 4, 5, 6, 7, 8, entries, entries + 1, entries + 1, entries + 1,
                                   entries + 1, entries + 2, entries + 3, entries + 4, entries + 5, page,
                                   page + 1, page + 2, page + 3));
}

TEST_F(Recording, ReadsTheModeAtEachUse) {
  Fill({{"/a.raw", Samples(600)}});
  int pages = 0;
  hardware.Acknowledges = [&](const std::string& what) {
    if (what == "data" && ++pages == 1) {
      mode = Recorder::InProduct;
      hardware.StandAlone = false;
    }
    return true;
  };
  Record();
  // The second page has the prefix of a product.
  const auto start = port.Sent.begin() + 8 + 257;
  EXPECT_THAT(Bytes(start, start + 4), ElementsAre(1, 0, 1, 0));
}

}  // namespace
