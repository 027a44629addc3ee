#include "sim/onewire/RomId.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace sim {
namespace {

constexpr RomId Counting{0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};

TEST(RomId, ReadsTheCrcFirstAndTheFamilyCodeLast) {
  EXPECT_EQ(ParseRomId("EFCDAB8967452301"), Counting);
  EXPECT_EQ(ParseRomId("efcdab8967452301"), Counting);
  EXPECT_EQ(ParseRomId("0A00000000000001"), (RomId{1, 0, 0, 0, 0, 0, 0, 10}));
}

TEST(RomId, IsWrittenInUpperCaseWithAllZeros) {
  EXPECT_EQ(RomIdText(Counting), "EFCDAB8967452301");
  EXPECT_EQ(RomIdText({0x0A, 0, 0, 0, 0, 0, 0x0B, 0x0C}), "0C0B00000000000A");
}

TEST(RomId, RefusesWhatIsNotSixteenHexadecimalDigits) {
  for (const char* text : {"", "EFCDAB896745230", "EFCDAB89674523011", "EFCDAB896745230G", "0xCDAB8967452301",
                           "EF CDAB896745230", "-1CDAB8967452301", "+1CDAB8967452301"}) {
    EXPECT_THROW(ParseRomId(text), std::invalid_argument) << text;
  }
}

// The example of the maker's application note on the CRC.
TEST(RomId, IsMadeWithItsCrc) {
  EXPECT_EQ(MakeRomId(0x02, 0x00000001B81C), (RomId{0x02, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0xA2}));
  EXPECT_EQ(MakeRomId(0xFF, 0xFEDCBA987654)[6], 0xFE);
}

}  // namespace
}  // namespace sim
