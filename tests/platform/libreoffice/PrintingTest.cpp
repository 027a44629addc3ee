#include <gmock/gmock.h>

#include "platform/libreoffice/LibreOffice.h"
#include "tests/platform/libreoffice/OfficeStart.h"
#include "tests/platform/libreoffice/PrintQueue.h"
#include "tests/support/Thrown.h"

namespace {

TEST(Printing, GoesToTheDefaultPrinterOfTheSystem) {
  PrintQueue queue;
  ASSERT_TRUE(queue.IsUp());
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  ASSERT_TRUE(StartAndWait(office));
  for (const char* name : {"Ann", "Ben"}) {
    const auto document = office.Add(TESSARINE_PROGRAM_FOLDER "/score_card_default.doc");
    document->SetBookmark("PlayerName", name);
    document->PrintOut();
    document->Close();
  }
  ASSERT_TRUE(WaitUntil([&] { return queue.Printed().size() == 2; }));
  for (const std::string& job : queue.Printed()) {
    EXPECT_EQ(ReadFile(job).substr(0, 5), "%PDF-");
  }
}

TEST(Printing, FailsWhenThePrinterTakesNoJobs) {
  PrintQueue queue(PrintQueue::Takes::Nothing);
  ASSERT_TRUE(queue.IsUp());
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  ASSERT_TRUE(StartAndWait(office));
  const auto document = office.Add(TESSARINE_PROGRAM_FOLDER "/score_card_default.doc");
  EXPECT_EQ(NumberThrownBy([&] { document->PrintOut(); }), 482);
  document->Close();
}

TEST(Printing, FailsWithoutAPrinter) {
  setenv("CUPS_SERVER", "/nowhere", 1);
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  const bool ready = StartAndWait(office);
  unsetenv("CUPS_SERVER");
  ASSERT_TRUE(ready);
  const auto document = office.Add(TESSARINE_PROGRAM_FOLDER "/score_card_default.doc");
  EXPECT_EQ(NumberThrownBy([&] { document->PrintOut(); }), 482);
  document->Close();
}

}  // namespace
