#include "members/PictureEnd.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using namespace std::string_literals;

/// `bytes` without the last `count`.
std::string Cut(const std::string& bytes, std::size_t count) {
  return bytes.substr(0, bytes.size() - count);
}

TEST(EndOfAJpeg, IsTheMarkBehindTheFirstScan) {
  const std::string whole = "\xFF\xD8\xFF\xDA\x00\x02\x11\xFF\x00\x22\xFF\xD9"s;
  EXPECT_FALSE(IsCutShort(whole, "jpeg"));
  EXPECT_FALSE(IsCutShort(whole + "more", "jpeg"));
  EXPECT_FALSE(IsCutShort(whole + "\xFF\xDA", "jpeg"));
  for (std::size_t missing = 1; missing <= whole.size(); ++missing) {
    EXPECT_TRUE(IsCutShort(Cut(whole, missing), "jpeg")) << missing;
  }
}

TEST(EndOfAJpeg, IsNotThatOfAPictureInASegment) {
  const std::string segment = "\xFF\xE1\x00\x0A\xFF\xD8\xFF\xDA\xFF\xDA\xFF\xD9"s;
  const std::string rest = "\xFF\xDA\x00\x02\x11"s;
  EXPECT_TRUE(IsCutShort("\xFF\xD8"s + segment + rest, "jpeg"));
  EXPECT_FALSE(IsCutShort("\xFF\xD8"s + segment + rest + "\xFF\xD9", "jpeg"));
}

TEST(EndOfAJpeg, IsFoundBehindMarkersWithoutASegment) {
  for (const char marker : {'\x00', '\x01', '\xD0', '\xD7', '\xD9'}) {
    const std::string whole = "\xFF\xD8\xFF"s + marker + "\xFF\xDA\x00\x02\x11\xFF\xD9"s;
    EXPECT_FALSE(IsCutShort(whole, "jpeg"));
    EXPECT_TRUE(IsCutShort(Cut(whole, 1), "jpeg"));
  }
}

TEST(EndOfAJpeg, IsFoundBehindFillBytesAndLongSegments) {
  const std::string longSegment = "\xFF\xE2\x01\x04"s + std::string(256, '\xFF') + "\xDA\x00"s;
  const std::string whole = "\xFF\xD8\xFF\xFF\xFF\x01junk"s + longSegment + "\xFF\xDA\x00\x02\x11\xFF\xD9"s;
  EXPECT_FALSE(IsCutShort(whole, "jpeg"));
  EXPECT_TRUE(IsCutShort(Cut(whole, 1), "jpeg"));
  EXPECT_TRUE(IsCutShort("\xFF\xD8"s + longSegment + "\xFF\xD9", "jpeg"));  // no scan at all
}

/// Head, a colour table of four entries, a comment with the bytes of an end, a picture with a table of two
/// entries and data in two blocks.
const std::string GifHead = "GIF89a\x01\x00\x01\x00\x81\x00\x00"s + "\x00\x3B,,,,,!!!!!"s;
const std::string GifComment = "!\xFE\x03,\x00\x3B\x00"s;
const std::string GifPicture =
    ",\x00\x00\x00\x00\x01\x00\x01\x00\x80"s + "\x00\x00\x00\x3B\x3B\x3B"s + "\x02\x02\x00\x3B\x01\x01\x00"s;

TEST(EndOfAGif, IsThatOfItsFirstPicture) {
  const std::string whole = GifHead + GifComment + GifPicture;
  EXPECT_FALSE(IsCutShort(whole, "gif"));
  EXPECT_FALSE(IsCutShort(whole + "\x3B", "gif"));
  EXPECT_FALSE(IsCutShort(whole + Cut(GifPicture, 3), "gif"));
  for (std::size_t missing = 1; missing <= whole.size(); ++missing) {
    EXPECT_TRUE(IsCutShort(Cut(whole, missing), "gif")) << missing;
  }
}

TEST(EndOfAGif, IsLeftToTheReaderWhenThereIsNoPicture) {
  EXPECT_FALSE(IsCutShort(GifHead + "\x3B", "gif"));
}

/// A BMP of 3 x 2 pixels, 24 bits each, whose pixels begin at `pixels`.
std::string Bmp(const std::string& height, const std::string& compression = "\0\0\0\0"s) {
  return "BM\xFF\xFF\xFF\x7F\x00\x00\x00\x00\x36\x00\x00\x00"s + "\x28\x00\x00\x00\x03\x00\x00\x00"s +
         height + "\x01\x00\x18\x00"s + compression + std::string(20, '\0') + std::string(2 * 12, 'p');
}

TEST(EndOfABmp, IsThatOfItsLastRow) {
  for (const std::string& height : {"\x02\x00\x00\x00"s, "\xFE\xFF\xFF\xFF"s}) {  // upward and downward
    const std::string whole = Bmp(height);
    EXPECT_FALSE(IsCutShort(whole, "bmp"));
    EXPECT_FALSE(IsCutShort(whole + "more", "bmp"));
    for (std::size_t missing = 1; missing <= 2 * 12 + 1; ++missing) {
      EXPECT_TRUE(IsCutShort(Cut(whole, missing), "bmp")) << missing;
    }
  }
}

TEST(EndOfABmp, IsFoundByTheOldHeaderToo) {
  const std::string whole = "BM\xFF\xFF\xFF\x7F\x00\x00\x00\x00\x1A\x00\x00\x00"s +
                            "\x0C\x00\x00\x00\x03\x00\x02\x00\x01\x00\x18\x00"s + std::string(2 * 12, 'p');
  EXPECT_FALSE(IsCutShort(whole, "bmp"));
  EXPECT_TRUE(IsCutShort(Cut(whole, 1), "bmp"));
}

TEST(EndOfABmp, IsLeftToTheReaderWhenItIsCompressed) {
  for (const std::string& runLength : {"\x01\x00\x00\x00"s, "\x02\x00\x00\x00"s}) {
    EXPECT_FALSE(IsCutShort(Cut(Bmp("\x02\x00\x00\x00"s, runLength), 20), "bmp"));
  }
  const std::string bitFields = "\x03\x00\x00\x00"s;
  EXPECT_TRUE(IsCutShort(Cut(Bmp("\x02\x00\x00\x00"s, bitFields), 1), "bmp"));
}

TEST(EndOfAPicture, IsTheReadersMatterInOtherFormats) {
  EXPECT_FALSE(IsCutShort("", "png"));
  EXPECT_FALSE(IsCutShort(Cut(Bmp("\x02\x00\x00\x00"s), 1), "png"));
}

}  // namespace
