#include "archive/Entries.h"

#include <gtest/gtest.h>
#include <zlib.h>

#include <string_view>

#include "core/gamefile/GameFile.h"

namespace {

std::string UnpackedOr(const Blob& data, std::int64_t size, Unpacking expected) {
  std::string bytes = "left over";
  EXPECT_EQ(Unpack(data, size, bytes), expected);
  return bytes;
}

/// `bytes` deflated by the library in one go.
Blob Deflated(const std::string& bytes) {
  Blob data(compressBound(bytes.size()));
  uLongf length = data.size();
  EXPECT_EQ(compress(data.data(), &length, reinterpret_cast<const Bytef*>(bytes.data()), bytes.size()), Z_OK);
  data.resize(length);
  return data;
}

TEST(EntryNames, TellDayTimeAndNumber) {
  EXPECT_EQ(EntryName("2026-11-21 20:15:59", 123, 0), "2026-11-21/2015-000123.game.xml");
  EXPECT_EQ(EntryName("2026-11-21 20:15:59", 123, 2), "2026-11-21/2015-000123-2.game.xml");
  EXPECT_EQ(EntryName("2026-01-02 00:00:00", 1234567, 0), "2026-01-02/0000-1234567.game.xml");
}

TEST(EntryNames, LeadNowhereElseWhateverTheTimeSays) {
  for (const char* played :
       {"", "N/A", "2026-11-21", "../../../etc 20:15", "../../etc/x 20:15:5", "21.11.2026 20:15:30"}) {
    EXPECT_EQ(EntryName(played, 7, 0), "undated/000007.game.xml") << played;
  }
}

TEST(EntryTimes, AreSecondsOfTheLocalTime) {
  EXPECT_EQ(SecondsOf("2026-11-21 20:15:31") - SecondsOf("2026-11-21 20:15:00"), 31);
  EXPECT_EQ(SecondsOf("2026-11-22 20:15:00") - SecondsOf("2026-11-21 20:15:00"), 86400);
  EXPECT_NEAR(static_cast<double>(SecondsOf("2001-09-09 01:46:40")), 1e9, 86400.0);
  EXPECT_EQ(SecondsOf("N/A"), 0);
  EXPECT_EQ(SecondsOf(""), 0);
}

TEST(Entries, ComeBackAsTheyWere) {
  std::string noise;
  for (unsigned i = 0, state = 1; i < 70000; ++i, state = state * 1664525U + 1013904223U) {
    noise += static_cast<char>(state >> 24U);
  }
  for (const std::string& bytes :
       {std::string(), std::string("x"), std::string("<GameData/>"), std::string(200000, 'a'), noise}) {
    const Blob packed = Packed(bytes);
    EXPECT_LE(packed.size(), bytes.size());
    EXPECT_EQ(UnpackedOr(packed, static_cast<std::int64_t>(bytes.size()), Unpacking::Done), bytes);
  }
  EXPECT_LT(Packed(std::string(200000, 'a')).size(), 1000U);
}

TEST(Entries, BeginAsTheirBytesDo) {
  std::string bytes;
  for (int line = 0; line < 5000; ++line) {
    bytes.append(std::to_string(line * 7919)).append(",");
  }
  const Blob packed = Packed(bytes);
  ASSERT_GT(packed.size(), 4096U);
  const Blob start(packed.begin(), packed.begin() + 4096);
  EXPECT_EQ(BeginningOf(start, true, 3000), bytes.substr(0, 3000));
  EXPECT_EQ(BeginningOf(packed, true, bytes.size() + 9), bytes);
  EXPECT_EQ(BeginningOf(Blob(bytes.begin(), bytes.end()), false, 3000), bytes.substr(0, 3000));
  EXPECT_EQ(BeginningOf({'a', 'b'}, false, 3000), "ab");
  EXPECT_EQ(BeginningOf({'a', 'b'}, true, 3000), "");
  EXPECT_EQ(BeginningOf({}, true, 3000), "");
}

TEST(Entries, ArePackedPieceByPieceAsWell) {
  std::string bytes;
  Packer packer;
  unsigned state = 1;
  for (int piece = 0; piece < 300; ++piece) {
    std::string next(static_cast<std::size_t>(piece * 7 % 1000), 'a');
    for (char& letter : next) {
      state = state * 1664525U + 1013904223U;
      letter = static_cast<char>('a' + (state >> 28U));
    }
    packer.Add(next);
    bytes += next;
    EXPECT_EQ(packer.Size(), bytes.size());
  }
  const Blob packed = packer.Finish();
  EXPECT_LT(packed.size(), bytes.size());
  EXPECT_EQ(UnpackedOr(packed, static_cast<std::int64_t>(bytes.size()), Unpacking::Done), bytes);
}

bool IsEqual(const Blob& data, std::int64_t size, const std::string& bytes, std::size_t step) {
  EntryComparison comparison(data, size);
  for (std::size_t at = 0; at < bytes.size(); at += step) {
    comparison.Add(std::string_view(bytes).substr(at, step));
  }
  return comparison.IsEqual();
}

TEST(Entries, AreComparedPieceByPiece) {
  std::string text;
  for (int line = 0; line < 9000; ++line) {
    text += std::to_string(line * 7919 % 1000) + "<Index>\n";
  }
  const auto size = static_cast<std::int64_t>(text.size());
  const Blob plain(text.begin(), text.end());
  for (const Blob& data : {Packed(text), plain}) {
    for (const std::size_t step : {std::size_t{1}, std::size_t{1000}, text.size()}) {
      EXPECT_TRUE(IsEqual(data, size, text, step)) << step;
      EXPECT_FALSE(IsEqual(data, size, text + "x", step));
      EXPECT_FALSE(IsEqual(data, size, text.substr(0, text.size() - 1), step));
      std::string other = text;
      other.back() = 'x';
      EXPECT_FALSE(IsEqual(data, size, other, step));
    }
    EXPECT_FALSE(IsEqual(data, size + 1, text, 1000));
    EXPECT_FALSE(IsEqual(data, -1, text, 1000));
  }
  Blob cut = Packed(text);
  cut.pop_back();
  EXPECT_FALSE(IsEqual(cut, size, text, 1000));
  Blob longer = Packed(text);
  longer.push_back(0);
  EXPECT_FALSE(IsEqual(longer, size, text, 1000));
  EXPECT_FALSE(IsEqual({}, size, text, 1000));
  EXPECT_TRUE(IsEqual({}, 0, "", 1));
}

TEST(Entries, ThatClaimAnotherSizeAreDamaged) {
  const std::string bytes(5000, 'a');
  const Blob packed = Packed(bytes);
  for (const std::int64_t size :
       {std::int64_t{-1}, std::int64_t{0}, std::int64_t{4999}, std::int64_t{5001}}) {
    EXPECT_EQ(UnpackedOr(packed, size, Unpacking::Damaged), "") << size;
  }
}

TEST(Entries, WithAnythingButAWholeStreamAreDamaged) {
  const std::string bytes = "some text and some more of the same text and some more";
  const Blob packed = Deflated(bytes);
  const auto size = static_cast<std::int64_t>(bytes.size());
  ASSERT_LT(packed.size(), bytes.size());
  for (std::size_t length = 0; length < packed.size(); ++length) {
    UnpackedOr(Blob(packed.begin(), packed.begin() + static_cast<std::ptrdiff_t>(length)), size,
               Unpacking::Damaged);
  }
  for (std::size_t at = 0; at < packed.size(); ++at) {
    Blob broken = packed;
    broken[at] ^= 0x10U;
    std::string read;
    EXPECT_TRUE(Unpack(broken, size, read) == Unpacking::Damaged || read == bytes) << at;
  }
  Blob longer = packed;
  longer.push_back(0);
  UnpackedOr(longer, size, Unpacking::Damaged);
}

TEST(Entries, ThatSwellBeyondAllMeasureAreRefused) {
  UnpackedOr(Blob(4096, 0), std::int64_t{1} << 30U, Unpacking::TooLarge);
  UnpackedOr(Blob(10, 0), std::int64_t{LargestEntry} + 1, Unpacking::TooLarge);
  const Blob bomb = Deflated(std::string(LargestEntry + 1, '\0'));
  ASSERT_LT(bomb.size(), 100000U);
  UnpackedOr(bomb, std::int64_t{LargestEntry} + 1, Unpacking::TooLarge);
  UnpackedOr(bomb, 1000, Unpacking::Damaged);
  UnpackedOr(bomb, std::int64_t{LargestEntry}, Unpacking::Damaged);
}

TEST(Entries, HaveRoomForTheFullestGame) {
  const StringTable strings(Language::English);
  Game game(strings);
  for (Player& player : game.Players) {
    player.Active = true;
    player.ShotCount = player.TotalDamage = player.Soldiering = player.RunCounter = -2147483647;
    for (std::int32_t& hit : player.HitByPlayer) {
      hit = 2147483647;
    }
  }
  EXPECT_LT(WriteGameFile(game, std::string(10000, '<')).size(), LargestEntry / 4);
}

}  // namespace
