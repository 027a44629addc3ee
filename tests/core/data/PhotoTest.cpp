#include "core/data/Photo.h"

#include <gtest/gtest.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/support/ScoredGame.h"

namespace {

struct Cut {
  std::size_t Size;
  std::size_t Blocks;
  std::size_t Rest;
};

TEST(PhotoBlocks, AreRoundedToNearestWithTiesToEven) {
  for (const Cut& cut : {Cut{0, 0, 0}, Cut{1, 0, 1}, Cut{4000, 0, 4000}, Cut{5000, 0, 5000},
                         Cut{15000, 2, 5000}, Cut{25000, 2, 5000}, Cut{27000, 3, 7000}, Cut{30000, 3, 0}}) {
    EXPECT_EQ(BlocksOf(cut.Size).Blocks, cut.Blocks) << cut.Size;
    EXPECT_EQ(BlocksOf(cut.Size).Rest, cut.Rest) << cut.Size;
  }
}

class Exporting : public testing::Test {
 protected:
  /// A member with `stored` bytes of the pattern in the photo column, and `length` in the length column.
  void Store(std::size_t stored, const std::string& length) {
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, PhotographLength) VALUES (1, " + length + ")");
    venue.Open();
    venue.RsMembers->Edit();
    venue.RsMembers->AppendChunk("Photograph", Blob(Pattern(stored).begin(), Pattern(stored).end()));
    venue.RsMembers->Update();
  }

  static const std::string& Pattern(std::size_t size) {
    static std::string pattern;
    pattern.resize(size);
    for (std::size_t i = 0; i < size; ++i) {
      pattern[i] = static_cast<char>(i * 31 + i / 256);
    }
    return pattern;
  }

  bool Export() { return ExportPhoto(*venue.RsMembers, "Photograph", "PhotographLength", "/tmp/p", files); }

  ScoredGame venue;
  FakeFiles files;
};

TEST_F(Exporting, WritesThePhotoWithItsPadding) {
  files.Put("/tmp/p", "");
  Store(37000, "27000");
  EXPECT_TRUE(Export());
  EXPECT_EQ(files.Contents().at("/tmp/p"), Pattern(37000));
}

TEST_F(Exporting, WritesNoMoreThanTheBlockRuleMoves) {
  Store(40000, "5000");
  EXPECT_TRUE(Export());
  EXPECT_EQ(files.Contents().at("/tmp/p"), Pattern(5000));
}

TEST_F(Exporting, SaysWhenThereIsNoPhoto) {
  files.Put("/tmp/p", "");
  Store(10, "0");
  EXPECT_FALSE(Export());
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET PhotographLength = NULL");
  venue.RsMembers->MoveFirst();
  EXPECT_FALSE(Export());
  EXPECT_EQ(files.Contents().at("/tmp/p"), "");
}

TEST_F(Exporting, OfAColumnThatIsTooShortGivesWhatIsThere) {
  Store(12000, "2000000000");
  EXPECT_TRUE(Export());
  EXPECT_EQ(files.Contents().at("/tmp/p"), Pattern(12000));
}

TEST_F(Exporting, OfALengthThatCannotBeGivesWhatIsThere) {
  Store(12000, "1e300");
  EXPECT_TRUE(Export());
  EXPECT_EQ(files.Contents().at("/tmp/p"), Pattern(12000));
}

TEST_F(Exporting, IgnoresAColumnThatIsNotThere) {
  Store(10, "10");
  EXPECT_TRUE(ExportPhoto(*venue.RsMembers, "Nowhere", "PhotographLength", "/tmp/p", files));
  EXPECT_EQ(files.Contents().at("/tmp/p"), "");
  EXPECT_FALSE(ExportPhoto(*venue.RsMembers, "Photograph", "Nowhere", "/tmp/p", files));
}

TEST_F(Exporting, IgnoresAFileThatCannotBeWritten) {
  Store(10, "10");
  files.FailReplace("/tmp/p", RuntimeError(61));
  EXPECT_TRUE(Export());
}

}  // namespace
