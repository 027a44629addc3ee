// Files as the programs of two tool chains write them: 40 bytes, from address 0 on and across the first 64
// KB.

#include <gmock/gmock.h>

#include "firmware/hex/HexCheck.h"
#include "firmware/hex/ImageComparison.h"
#include "firmware/hex/ImagePadding.h"

namespace {

using Cause = LostStretch::Cause;
using testing::IsEmpty;
using testing::StartsWith;

constexpr const char* Objcopy =
    ":10000000010407000D101300191C1F0025282B00E8\r\n"
    ":10001000313437003D404300494C4F0055585B0098\r\n"
    ":08002000616467006D7073005C\r\n"
    ":00000001FF\r\n";

constexpr const char* SrecCat =
    ":020000040000FA\n"
    ":20000000010407000D101300191C1F0025282B00313437003D404300494C4F0055585B0090\n"
    ":08002000616467006D7073005C\n"
    ":00000001FF\n";

/// Segment addresses, as some tool chains write them below 1 MB.
constexpr const char* ObjcopyAcross =
    ":10FFF000010407000D101300191C1F0025282B00F9\r\n"
    ":020000021000EC\r\n"
    ":10000000313437003D404300494C4F0055585B00A8\r\n"
    ":08001000616467006D7073006C\r\n"
    ":040000030000FFF00A\r\n"
    ":00000001FF\r\n";

constexpr const char* SrecCatAcross =
    ":020000040000FA\n"
    ":20FFF000010407000D101300191C1F0025282B00313437003D404300494C4F0055585B00A1\n"
    ":020000040001F9\n"
    ":08001000616467006D7073006C\n"
    ":00000001FF\n";

constexpr const char* FirstLine = ":0400000001020300F6\n";

TEST(ToolChainFiles, PassTheCheck) {
  for (const char* file : {Objcopy, SrecCat, ObjcopyAcross, SrecCatAcross}) {
    EXPECT_EQ(CheckHexText(file), 1);
  }
}

TEST(ToolChainFiles, GiveTheSameImage) {
  const std::string image = PaddedImage(DivideHexText(Objcopy).ProgMem);
  EXPECT_THAT(image, StartsWith("000000 01 04 07 00 0D 10 13 00 19 1C 1F 00 25 28 2B 00 \n"
                                "000010 31 34 37 00 3D 40 43 00 49 4C 4F 00 55 58 5B 00 \n"
                                "000020 61 64 67 00 6D 70 73 00 FF FF FF 00 FF FF FF 00 \n"
                                "000030 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00\n"));
  EXPECT_EQ(PaddedImage(DivideHexText(SrecCat).ProgMem), image);
  EXPECT_THAT(CompareImages(Objcopy, image, ""), IsEmpty());
  EXPECT_THAT(CompareImages(SrecCat, image, ""), IsEmpty());
}

TEST(ToolChainFiles, LoseNothingAcrossLinearSegments) {
  const std::string file = std::string(FirstLine) + SrecCatAcross;
  EXPECT_THAT(CompareImages(file, PaddedImage(DivideHexText(file).ProgMem), ""), IsEmpty());
}

TEST(ToolChainFiles, AreWarnedOfWhereTheyHaveSegmentAddresses) {
  const std::string file = std::string(FirstLine) + ObjcopyAcross;
  EXPECT_THAT(CompareImages(file, PaddedImage(DivideHexText(file).ProgMem), ""),
              testing::Contains(LostStretch{0x10000, 24, Cause::Missing}));
}

}  // namespace
