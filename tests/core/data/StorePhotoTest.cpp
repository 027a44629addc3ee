#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "core/data/Photo.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::string Pattern(std::size_t size) {
  std::string pattern(size, '\0');
  for (std::size_t i = 0; i < size; ++i) {
    pattern[i] = static_cast<char>(1 + i % 251);
  }
  return pattern;
}

class Storing : public testing::Test {
 protected:
  Storing() {
    ExecuteSql(venue.MembersFile(), "INSERT INTO Members (ContactID) VALUES (1)");
    venue.Open();
  }

  /// Stores a file with these bytes.
  void Store(const std::string& bytes) {
    files.Put("/photo.jpg", bytes);
    StoreFile("/photo.jpg");
  }

  void StoreFile(const std::string& path) {
    venue.RsMembers->Edit();
    StorePhoto(path, *venue.RsMembers, "Photograph", "PhotographLength", files, venue.Boxes);
    venue.RsMembers->Update();
  }

  std::string Query(const std::string& expression) {
    return OtherConnection(venue.MembersFile()).Query("SELECT " + expression + " FROM Members");
  }

  std::string Stored() { return StoredPhoto(*venue.RsMembers, "Photograph", "PhotographLength"); }

  const FakeMessageBoxes::Box warning{
      "This photo is large. Large photo's will reduce performance. Do you wish to proceed?", "Photo Warning",
      BoxIcon::Question, BoxButtons::OkCancel};
  ScoredGame venue;
  FakeFiles files;
};

struct Case {
  std::size_t Size;
  const char* Column;
};

TEST_F(Storing, WritesTheBlocksOfTheStoredFormat) {
  for (const Case& photo :
       {Case{1, "1"}, Case{4000, "4000"}, Case{5000, "5000"}, Case{5001, "15001"}, Case{15000, "25000"},
        Case{25000, "25000"}, Case{27000, "37000"}, Case{30000, "30000"}}) {
    Store(Pattern(photo.Size));
    EXPECT_EQ(Query("length(Photograph)"), photo.Column) << photo.Size;
    EXPECT_EQ(Query("PhotographLength"), std::to_string(photo.Size));
    EXPECT_EQ(Stored().substr(0, photo.Size), Pattern(photo.Size));
    EXPECT_EQ(Stored().size(), std::stoul(photo.Column));
  }
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Storing, GivesBackAFileWithItsPadding) {
  Store(Pattern(27000));
  EXPECT_TRUE(ExportPhoto(*venue.RsMembers, "Photograph", "PhotographLength", "/out", files));
  EXPECT_EQ(files.Read("/out").size(), 37000U);
  EXPECT_EQ(files.Read("/out").substr(0, 27000), Pattern(27000));
}

TEST_F(Storing, ReplacesALargerPhotoWhole) {
  Store(Pattern(90000));
  Store(Pattern(3000));
  EXPECT_EQ(Query("length(Photograph)"), "3000");
  EXPECT_EQ(Stored(), Pattern(3000));
}

TEST_F(Storing, DoesNotAskUpTo100000Bytes) {
  Store(Pattern(100000));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Query("length(Photograph)"), "100000");
}

TEST_F(Storing, AsksFrom100001BytesOn) {
  Store(Pattern(100001));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(warning));
  EXPECT_EQ(Query("PhotographLength"), "100001");
}

TEST_F(Storing, KeepsTheOldPhotoWhenTheAnswerIsCancel) {
  Store(Pattern(700));
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  Store(Pattern(100001));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(warning));
  EXPECT_EQ(Query("PhotographLength"), "700");
  EXPECT_EQ(Stored(), Pattern(700));
}

TEST_F(Storing, TakesThirtyMegabytes) {
  const std::string huge = Pattern(30'000'000);
  Store(huge);
  EXPECT_EQ(Query("length(Photograph)"), "30000000");
  EXPECT_TRUE(Stored() == huge);
}

TEST_F(Storing, ChangesNothingForAnEmptyFile) {
  Store(Pattern(700));
  Store("");
  EXPECT_EQ(Query("PhotographLength"), "700");
  EXPECT_EQ(Stored(), Pattern(700));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Storing, SaysInAPlainBoxWhyAFileCannotBeRead) {
  Store(Pattern(700));
  files.FailRead("/photo.jpg", RuntimeError(75, "Path/File access error: /photo.jpg"));
  StoreFile("/photo.jpg");
  StoreFile("/gone.jpg");
  EXPECT_THAT(
      venue.Boxes.Boxes,
      ElementsAre(FakeMessageBoxes::Box{"Path/File access error: /photo.jpg", "Tessarine", BoxIcon::None,
                                        BoxButtons::Ok},
                  FakeMessageBoxes::Box{"File not found", "Tessarine", BoxIcon::None, BoxButtons::Ok}));
  EXPECT_EQ(Stored(), Pattern(700));
}

TEST_F(Storing, NeedsARowInEditMode) {
  files.Put("/photo.jpg", "x");
  EXPECT_EQ(NumberThrownBy([&] {
              StorePhoto("/photo.jpg", *venue.RsMembers, "Photograph", "PhotographLength", files,
                         venue.Boxes);
            }),
            3020);
}

}  // namespace
