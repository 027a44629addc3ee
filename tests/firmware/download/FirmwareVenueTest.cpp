// The window with its real line, event loop and files, and the simulated boot code of both kinds. Whatever
// goes wrong, the window says what is told of it, the device holds what had been accepted until then, and the
// next download succeeds.

#include <gmock/gmock.h>

#include <algorithm>
#include <string>

#include "tests/firmware/download/FirmwareVenue.h"

namespace {

using sim::BootFailure;
using sim::BootProduct;
using sim::BootTrouble;

// Replies of a device of the second kind: 1 BOOT, 2 "x", 3 "d", 4 "s", 5 page 0, 6 to 13 its rows, 14 the end
// or page 1; of the first kind: 5 set-up, 6 to 8 the buffers, 9 the end. Packets are counted from the first
// page or buffer on.
constexpr std::size_t StruckReply = 6;
constexpr std::size_t StruckPacket = 2;

BootTrouble TroubleOf(const sim::BootFailureInfo& failure) {
  return {.Failure = failure.Failure,
          .Place = failure.Place == sim::FailurePlace::Frame ? StruckPacket : StruckReply};
}

bool IsUnplugged(BootFailure failure) {
  return failure == BootFailure::Unplugged || failure == BootFailure::UnpluggedInPacket;
}

class VenueFailure : public testing::TestWithParam<sim::BootFailureInfo> {
 protected:
  void Run(FirmwareVenue& venue) {
    if (GetParam().Failure == BootFailure::StrayLetter) {
      venue.PressAfter(1, "cmdBreak");
    }
    venue.Download(TroubleOf(GetParam()));
  }

  /// Another download on the same line, if it is not lost.
  void RunAgain(FirmwareVenue& venue) {
    if (!venue.IsEnabled("cmdDownload")) {
      venue.Press("Close");
      EXPECT_FALSE(venue.PortIsOpen());
      venue.OpenWindow();
    }
    venue.Download();
    venue.ExpectEnd({});
  }
};

TEST_P(VenueFailure, OfADeviceOfPages) {
  FirmwareVenue venue(BootProduct::Qvm2, sim::Pace::Fast,
                      GetParam().Failure == BootFailure::DoubleReply ? 2 : 1);
  Run(venue);
  switch (GetParam().Failure) {
    case BootFailure::None:
    case BootFailure::NoiseBeforeBoot:
    case BootFailure::BootTwice:
    case BootFailure::BootTorn:
    case BootFailure::AsksAgain:
    case BootFailure::LateReply:
      venue.ExpectEnd({});
      EXPECT_EQ(venue.Flash(), venue.WholeImage());
      EXPECT_EQ(venue.TextOf("lblStatus"), "Loaded 64 code words");
      break;
    case BootFailure::StrayLetter:
      venue.ExpectEnd(End::NoLoadMode);
      EXPECT_EQ(venue.Flash(), FirmwareVenue::Before());
      break;
    case BootFailure::WrongProduct:
      venue.ExpectEnd(End::WrongProduct);
      EXPECT_EQ(venue.Flash(), FirmwareVenue::Before());
      break;
    case BootFailure::BadAddress:
      venue.ExpectEnd(End::InvalidAddress);
      EXPECT_EQ(venue.Flash(), venue.RowsOfPage0(0));
      break;
    case BootFailure::UnpluggedInPacket:
    case BootFailure::Unplugged:
      venue.ExpectEnd(End::Lost);
      EXPECT_EQ(venue.Flash(), venue.RowsOfPage0(GetParam().Failure == BootFailure::Unplugged ? 1 : 0));
      break;
    case BootFailure::Silence:
      venue.ExpectEnd(End::TimedOut);
      EXPECT_EQ(venue.Flash(), venue.RowsOfPage0(1));
      break;
    case BootFailure::OtherReply:
    case BootFailure::NoiseBeforeReply:
      venue.ExpectEnd(End::InvalidReply);
      EXPECT_EQ(venue.Flash(), venue.RowsOfPage0(1));
      break;
    case BootFailure::DoubleReply:
      // Each reply is taken for that of the next packet; the next page finds it out.
      venue.ExpectEnd(End::InvalidEraseReply);
      venue.AwaitReplies(14);
      EXPECT_EQ(venue.Flash(), venue.RowsOfPage0(8).replace(PageBytes, PageBytes, PageBytes, '\xFF'));
      break;
  }
  if (!venue.Boxes().empty() && !IsUnplugged(GetParam().Failure)) {
    RunAgain(venue);
    EXPECT_EQ(venue.Flash(), venue.WholeImage());
  }
}

TEST_P(VenueFailure, OfADeviceOfBuffers) {
  FirmwareVenue venue(BootProduct::Qvm, sim::Pace::Fast);
  Run(venue);
  switch (GetParam().Failure) {
    case BootFailure::None:
    case BootFailure::NoiseBeforeBoot:
    case BootFailure::BootTwice:
    case BootFailure::BootTorn:
    case BootFailure::AsksAgain:
    case BootFailure::LateReply:
    case BootFailure::OtherReply:
    case BootFailure::NoiseBeforeReply:
    case BootFailure::DoubleReply:
      venue.ExpectEnd({});
      venue.AwaitDownloads(1);
      EXPECT_EQ(venue.Flash(), venue.Buffers(3));
      EXPECT_EQ(venue.TextOf("lblStatus"), "Loaded 52 code words");  // 26, then 51.5, one line late
      break;
    case BootFailure::StrayLetter:
      venue.ExpectEnd(End::NoLoadMode);
      EXPECT_EQ(venue.Flash(), "");
      break;
    case BootFailure::WrongProduct:
      venue.ExpectEnd(End::WrongProduct);
      EXPECT_EQ(venue.Flash(), "");
      break;
    case BootFailure::BadAddress:
      venue.ExpectEnd(End::InvalidAddress);
      EXPECT_EQ(venue.Flash(), venue.Buffers(1));
      break;
    case BootFailure::UnpluggedInPacket:
    case BootFailure::Unplugged:
      venue.ExpectEnd(End::Lost);
      EXPECT_EQ(venue.TextOf("lblCurrentBuffer"), "Buffer Empty");
      EXPECT_EQ(venue.Flash(), venue.Buffers(1));
      break;
    case BootFailure::Silence:
      venue.ExpectEnd(End::TimedOut);
      EXPECT_EQ(venue.Flash(), venue.Buffers(1));
      break;
  }
  if (!IsUnplugged(GetParam().Failure)) {
    RunAgain(venue);
    EXPECT_EQ(venue.Flash(), venue.Buffers(3));
  }
}

std::string NameOf(const testing::TestParamInfo<sim::BootFailureInfo>& failure) {
  std::string name(failure.param.Name);
  std::replace(name.begin(), name.end(), '-', '_');
  return name;
}

INSTANTIATE_TEST_SUITE_P(Failures, VenueFailure, testing::ValuesIn(sim::BootFailures), NameOf);

TEST(VenueDownload, IsRightAtTheSpeedOfTheLine) {
  for (const BootProduct product : {BootProduct::Qvm2, BootProduct::Qvm}) {
    FirmwareVenue venue(product, sim::Pace::AsWired, 2);
    venue.Download();
    venue.ExpectEnd({});
    EXPECT_EQ(venue.Flash(), product == BootProduct::Qvm2 ? venue.WholeImage() : venue.Buffers(3));
  }
}

TEST(VenueDownload, TellsOnceThatTheLineWasPulledOutInsteadOfAReply) {
  for (const std::size_t reply : {2U, 3U, 4U, 5U, 13U, 14U}) {
    FirmwareVenue venue(BootProduct::Qvm2, sim::Pace::Fast);
    venue.Download({.Failure = BootFailure::Unplugged, .Place = reply});
    venue.ExpectEnd(End::Lost);
  }
  FirmwareVenue venue(BootProduct::Qvm2, sim::Pace::Fast);
  venue.Download({.Failure = BootFailure::Unplugged, .Place = 1});
  EXPECT_EQ(venue.Boxes(), End::Lost);
}

TEST(VenueDownload, TimesOutWhenTheLastAnswerStaysAway) {
  FirmwareVenue venue(BootProduct::Qvm2, sim::Pace::Fast);
  venue.Download({.Failure = BootFailure::Silence, .Place = 14});
  venue.ExpectEnd(End::TimedOut);
  EXPECT_EQ(venue.Flash(), venue.WholeImage());
}

TEST(VenueDownload, IsLeftByClosingAfterAnInvalidPage) {
  FirmwareVenue venue(BootProduct::Qvm2, sim::Pace::Fast);
  venue.Download({.Failure = BootFailure::BadAddress, .Place = 1});
  venue.ExpectEnd(End::InvalidEraseAddress);
  EXPECT_EQ(venue.Flash(), FirmwareVenue::Before());
  venue.Press("Close");
  EXPECT_FALSE(venue.WindowIsThere());
  EXPECT_FALSE(venue.PortIsOpen());
}

TEST(VenueDownload, EndsWithOneBoxWhenItIsStoppedOrClosed) {
  for (const auto& [silentFrom, boxes] :
       {std::pair{1U, End::NoLoadMode}, {2U, End::NotFinished}, {7U, End::NotFinished}}) {
    for (const char* button : {"cmdBreak", "Close"}) {
      FirmwareVenue venue(BootProduct::Qvm2, sim::Pace::Fast);
      venue.PressAfter(silentFrom, button);
      venue.Download({.Failure = BootFailure::Silence, .Place = silentFrom});
      EXPECT_EQ(venue.Boxes(), boxes) << button;
      EXPECT_EQ(venue.WindowIsThere(), std::string(button) == "cmdBreak");
      EXPECT_EQ(venue.PortIsOpen(), std::string(button) == "cmdBreak");
    }
  }
}

}  // namespace
