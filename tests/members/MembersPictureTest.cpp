#include "tests/members/MembersWindow.h"
#include "tests/members/Pictures.h"
#include "tests/support/OrdinaryUser.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// The window with picture files for its file dialog.
class MembersPicture : public MembersWindow {
 protected:
  /// Creates the file that file dialogs return from now on.
  void Choose(const std::string& bytes) {
    const std::string path = venue.Folder / "photo";
    WriteFile(path, bytes);
    venue.Dialog.Answers = {path};
  }

  std::string StoredHex(int member) { return Stored("hex(Photograph)", member); }

  static std::string Hex(const std::string& bytes) {
    return QByteArray::fromStdString(bytes).toHex().toUpper().toStdString();
  }

  QColor PhotoColour() {
    return Photo().Picture().isNull() ? QColor() : Photo().Picture().pixelColor(10, 10);
  }

  const FakeMessageBoxes::Box large{
      "This photo is large. Large photo's will reduce performance. Do you wish to proceed?", "Photo Warning",
      BoxIcon::Question, BoxButtons::OkCancel};
};

TEST_F(MembersPicture, AsksForAPhotoFile) {
  Open([this] { Press("ChangePicture"); });
  EXPECT_THAT(venue.Dialog.Calls, ElementsAre(FakeFileDialog::Call{
                                      false, "Photo Files(*.bmp,*.jpg,*.gif)|*.bmp;*.jpg;*.gif", ""}));
  EXPECT_EQ(Stored("Photograph", 1), "NULL");
}

TEST_F(MembersPicture, StoresTheFilesBytesAndShowsThem) {
  const std::string bytes = PictureFile(Qt::red);
  Choose(bytes);
  Open([this] {
    EXPECT_TRUE(Photo().Picture().isNull());
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
  EXPECT_EQ(StoredHex(1), Hex(bytes));
  EXPECT_EQ(Stored("PhotographLength", 1), std::to_string(bytes.size()));
}

TEST_F(MembersPicture, PadsAPhotoToItsBlocks) {
  Choose(PictureFileOf(27000, Qt::red));
  Open([this] {
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
  EXPECT_EQ(Stored("PhotographLength || ' ' || length(Photograph)", 1), "27000 37000");
}

TEST_F(MembersPicture, ClearsThePictureOfAMemberWithoutOne) {
  Choose(PictureFile(Qt::red));
  Open([this] {
    Press("ChangePicture");
    Press("DataNext");
    EXPECT_TRUE(Photo().Picture().isNull());
    Press("DataPrevious");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
}

TEST_F(MembersPicture, ShowsNoPictureWhereNobodyWasFound) {
  Choose(PictureFile(Qt::red));
  Open([this] {
    Press("ChangePicture");
    SearchFor("nobody");
    EXPECT_TRUE(Photo().Picture().isNull());
  });
}

TEST_F(MembersPicture, ClearsThePictureBeforeASearchAlsoWhenItCannotBeRead) {
  Choose(PictureFile(Qt::red));
  Open([this] {
    Press("ChangePicture");
    SearchFor("O'B");
    EXPECT_TRUE(Photo().Picture().isNull());
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
    SearchFor("");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
}

TEST_F(MembersPicture, ReplacesAPhotoByASmallerOne) {
  Choose(PictureFileOf(30000, Qt::red));
  const std::string small = PictureFile(Qt::blue);
  Open([&] {
    Press("ChangePicture");
    Choose(small);
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::blue));
  });
  EXPECT_EQ(StoredHex(1), Hex(small));
}

TEST_F(MembersPicture, AsksBeforeItTakesMoreThan100000Bytes) {
  Choose(PictureFileOf(100000, Qt::red));
  Open([this] {
    Press("ChangePicture");
    EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
    Choose(PictureFileOf(100001, Qt::blue));
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::blue));
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(large));
  EXPECT_EQ(Stored("PhotographLength", 1), "100001");
}

TEST_F(MembersPicture, ShowsTheNewPictureDuringTheQuestionAndTheOldOneWhenItWasRefused) {
  const std::string old = PictureFile(Qt::red);
  Choose(old);
  Open([&] {
    Press("ChangePicture");
    Choose(PictureFileOf(100001, Qt::blue));
    venue.Boxes.Answers = {BoxAnswer::Cancel};
    venue.Boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
      EXPECT_EQ(PhotoColour(), QColor(Qt::blue));
      EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT count(*) FROM Members"), "4");
    };
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(large));
  EXPECT_EQ(StoredHex(1), Hex(old));
}

TEST_F(MembersPicture, ShowsTheOldPictureWhenNoFileIsChosen) {
  Choose(PictureFile(Qt::red));
  Open([this] {
    Press("ChangePicture");
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
}

TEST_F(MembersPicture, ChangesNothingForAnEmptyFile) {
  const std::string old = PictureFile(Qt::red);
  Choose(old);
  Open([this] {
    Press("ChangePicture");
    Choose("");
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
  EXPECT_EQ(StoredHex(1), Hex(old));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersPicture, StoresWhatIsNoPictureAndShowsNone) {
  Choose("this is no picture");
  Open([this] {
    Press("ChangePicture");
    EXPECT_TRUE(Photo().Picture().isNull());
    Press("DataNext");
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
  });
  EXPECT_EQ(StoredHex(1), Hex("this is no picture"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersPicture, TakesThirtyMegabytes) {
  Choose(PictureFileOf(30'000'000, Qt::red));
  Open([this] {
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::red));
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(large));
  EXPECT_EQ(Stored("length(Photograph)", 1), "30000000");
}

TEST_F(MembersPicture, SaysThatAFileIsGoneOrCannotBeRead) {
  Choose("");
  const std::string path = venue.Folder / "photo";
  std::filesystem::remove(path);
  Open([&] {
    Press("ChangePicture");
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"File not found: " + path, "Tessarine",
                                                                     BoxIcon::None, BoxButtons::Ok}));
    venue.Boxes.Boxes.clear();
    venue.Dialog.Answers = {venue.Folder.Path()};
    Press("ChangePicture");
    EXPECT_EQ(venue.Boxes.Boxes.size(), 1U);
  });
  EXPECT_EQ(Stored("Photograph", 1), "NULL");
}

TEST_F(MembersPicture, WritesTheEntriesBackBeforeItAsksForTheFile) {
  venue.Dialog.WhileOpen = [this] { EXPECT_EQ(Stored("City", 1), "Swansea"); };
  Open([this] {
    Enter("CityEntry", "Swansea");
    Press("ChangePicture");
  });
  EXPECT_EQ(venue.Dialog.Calls.size(), 1U);
}

TEST_F(MembersPicture, KeepsTheOldPhotoWhenTheFileIsLocked) {
  Choose(PictureFile(Qt::red));
  OtherConnection other(venue.DataFile("members.mdb"));
  Open([&] {
    other.Execute("BEGIN IMMEDIATE");
    Press("ChangePicture");
    other.Execute("COMMIT");
    EXPECT_TRUE(Photo().Picture().isNull());
    Choose(PictureFile(Qt::blue));
    Press("ChangePicture");
    EXPECT_EQ(PhotoColour(), QColor(Qt::blue));
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3050': "));
}

TEST_F(MembersPicture, ShowsNothingOfAPhotoThatIsShorterThanItsLength) {
  Sql("UPDATE Members SET Photograph = x'FFD8FF', PhotographLength = 50000 WHERE ContactID = 1");
  Sql("UPDATE Members SET Photograph = NULL, PhotographLength = 50000 WHERE ContactID = 2");
  Sql("UPDATE Members SET PhotographLength = NULL WHERE ContactID = 5");
  Open([this] {
    EXPECT_TRUE(Photo().Picture().isNull());
    Press("DataNext");
    EXPECT_TRUE(Photo().Picture().isNull());
    Press("DataNext");
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

}  // namespace
