#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>

#include "tests/platform/sqlite/EditedMembers.h"
#include "tests/support/Thrown.h"

namespace {

using Chunks = EditedMembers;

Blob Bytes(std::size_t count, std::uint8_t first) {
  Blob bytes(count);
  for (std::size_t i = 0; i < count; ++i) {
    bytes[i] = static_cast<std::uint8_t>(first + i * 31 % 251);
  }
  return bytes;
}

TEST_F(Chunks, OfALongColumnAreReadFromAnyOffset) {
  const Blob photo = Bytes(25'000, 3);
  rows->Edit();
  rows->SetField("Photograph", photo);
  rows->Update();
  EXPECT_EQ(rows->GetChunk("Photograph", 0, 10'000), Blob(photo.begin(), photo.begin() + 10'000));
  EXPECT_EQ(rows->GetChunk("photograph", 20'000, 10'000), Blob(photo.begin() + 20'000, photo.end()));
  EXPECT_EQ(rows->GetChunk("Photograph", 24'999, 1), Blob(photo.end() - 1, photo.end()));
  EXPECT_EQ(rows->GetChunk("Photograph", 25'000, 1), Blob());
  EXPECT_EQ(rows->GetChunk("Photograph", 90'000, 1), Blob());
  EXPECT_EQ(rows->GetChunk("Photograph", 1, static_cast<std::size_t>(-1)),
            Blob(photo.begin() + 1, photo.end()));
}

TEST_F(Chunks, OfNullAreEmpty) {
  EXPECT_EQ(rows->GetChunk("Photograph", 0, 10), Blob());
}

TEST_F(Chunks, BelongToTheRowUnderTheCursor) {
  file.Execute("UPDATE Members SET Photograph = X'0102' WHERE ContactID = 1");
  EXPECT_EQ(rows->GetChunk("Photograph", 0, 10), (Blob{1, 2}));
  rows->MoveNext();
  EXPECT_EQ(rows->GetChunk("Photograph", 0, 10), Blob());
}

TEST_F(Chunks, AppendedFirstReplaceAndTheOthersAdd) {
  file.Execute("UPDATE Members SET Photograph = X'FFFFFF' WHERE ContactID = 1");
  rows->Edit();
  rows->AppendChunk("Photograph", {1, 2});
  rows->AppendChunk("Photograph", {3});
  EXPECT_EQ(rows->GetChunk("Photograph", 1, 10), (Blob{2, 3}));
  EXPECT_EQ(file.Query("SELECT hex(Photograph) FROM Members WHERE ContactID = 1"), "FFFFFF");
  rows->Update();
  EXPECT_EQ(file.Query("SELECT hex(Photograph) FROM Members WHERE ContactID = 1"), "010203");
  rows->Edit();
  rows->AppendChunk("Photograph", {4});
  rows->Update();
  EXPECT_EQ(rows->GetChunk("Photograph", 0, 10), Blob{4});
}

TEST_F(Chunks, CanBeAppendedToANewRow) {
  rows->AddNew();
  rows->AppendChunk("Photograph", {1});
  rows->AppendChunk("Photograph", {2});
  rows->Update();
  EXPECT_EQ(file.Query("SELECT hex(Photograph) FROM Members WHERE ContactID = 10"), "0102");
}

TEST_F(Chunks, OfNothingMakeAnEmptyColumnAndNotNull) {
  rows->Edit();
  rows->AppendChunk("Photograph", {});
  rows->Update();
  EXPECT_EQ(file.Query("SELECT typeof(Photograph) FROM Members WHERE ContactID = 1"), "blob");
}

TEST_F(Chunks, AreLeftAloneByOtherUpdates) {
  file.Execute("UPDATE Members SET Photograph = X'FF' WHERE ContactID = 1");
  rows->Edit();
  rows->SetField("FirstName", "John");
  rows->Update();
  EXPECT_EQ(file.Query("SELECT hex(Photograph) FROM Members WHERE ContactID = 1"), "FF");
}

TEST_F(Chunks, OfAnotherKindOfColumnAre3259) {
  EXPECT_EQ(NumberThrownBy([&] { rows->GetChunk("FirstName", 0, 1); }), 3259);
  rows->Edit();
  EXPECT_EQ(NumberThrownBy([&] { rows->AppendChunk("FirstName", {1}); }), 3259);
  EXPECT_EQ(NumberThrownBy([&] { rows->AppendChunk("Nothing", {1}); }), 3265);
}

}  // namespace
