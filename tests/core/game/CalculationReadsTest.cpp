#include "core/game/CalculationReads.h"

#include <gtest/gtest.h>

#include <memory>
#include <optional>

#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/TestDatabase.h"

namespace {

/// Two databases of four members each, one of them in place of the missions.
class ReadsOfACalculation : public testing::Test {
 protected:
  struct Source {
    Source() {
      File.AddMembers();
      Data = File.Open();
      Rows = Data->OpenRecordset("Members");
    }

    void Read() const { Rows->WalkTo("ContactID", std::int64_t{5}); }

    bool OthersCanWrite() const {
      return OtherConnection(File.Path()).Try("UPDATE Members SET Clan = 'x' WHERE ContactID = 9") ==
             SQLITE_OK;
    }

    TestDatabase File;
    std::unique_ptr<Database> Data;
    std::unique_ptr<Recordset> Rows;
  };

  void ReadBoth() const {
    members.Read();
    missions.Read();
  }

  void ShowBox() { boxes.Show("text", "title", BoxIcon::Exclamation); }

  void ExpectOthersCanWrite(bool expected) const {
    EXPECT_EQ(members.OthersCanWrite(), expected);
    EXPECT_EQ(missions.OthersCanWrite(), expected);
  }

  Source members;
  Source missions;
  FakeMessageBoxes shown;
  UnlockingBoxes boxes{shown};
};

TEST_F(ReadsOfACalculation, HoldBothDatabasesFromTheFirstReadToTheEnd) {
  {
    const CalculationReads reads(*members.Data, *missions.Data, boxes);
    ExpectOthersCanWrite(true);
    ReadBoth();
    ExpectOthersCanWrite(false);
  }
  ExpectOthersCanWrite(true);
}

TEST_F(ReadsOfACalculation, HoldNeitherWhileABoxIsOpen) {
  const CalculationReads reads(*members.Data, *missions.Data, boxes);
  shown.WhileOpen = [this](const FakeMessageBoxes::Box&) { ExpectOthersCanWrite(true); };
  for (int box = 1; box <= 2; ++box) {
    ReadBoth();
    ShowBox();
    EXPECT_EQ(shown.Boxes.size(), static_cast<std::size_t>(box));
    ReadBoth();
    ExpectOthersCanWrite(false);
  }
}

TEST_F(ReadsOfACalculation, GoOnAfterAnotherCalculationInABox) {
  std::optional<CalculationReads> reads;
  reads.emplace(*members.Data, *missions.Data, boxes);
  int open = 0;
  shown.WhileOpen = [&](const FakeMessageBoxes::Box&) {
    if (++open == 1) {
      const CalculationReads inner(*members.Data, *missions.Data, boxes);
      ReadBoth();
      ExpectOthersCanWrite(false);
      ShowBox();
    }
    ExpectOthersCanWrite(true);
  };
  ReadBoth();
  ShowBox();
  EXPECT_EQ(open, 2);
  ReadBoth();
  ExpectOthersCanWrite(false);
  ShowBox();
  reads.reset();
  ExpectOthersCanWrite(true);
}

TEST_F(ReadsOfACalculation, ChangeNothingInABox) {
  shown.Answers = {BoxAnswer::No};
  EXPECT_EQ(boxes.Show("Sure?", "A title", BoxIcon::Question, BoxButtons::YesNo), BoxAnswer::No);
  const CalculationReads reads(*members.Data, *missions.Data, boxes);
  shown.Answers = {BoxAnswer::Cancel};
  EXPECT_EQ(boxes.Show("Sure?", "A title", BoxIcon::Question, BoxButtons::OkCancel), BoxAnswer::Cancel);
  ASSERT_EQ(shown.Boxes.size(), 2U);
  EXPECT_EQ(shown.Boxes[0],
            (FakeMessageBoxes::Box{"Sure?", "A title", BoxIcon::Question, BoxButtons::YesNo}));
  EXPECT_EQ(shown.Boxes[1],
            (FakeMessageBoxes::Box{"Sure?", "A title", BoxIcon::Question, BoxButtons::OkCancel}));
}

}  // namespace
