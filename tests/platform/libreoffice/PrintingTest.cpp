#include <gmock/gmock.h>

#include "platform/libreoffice/LibreOffice.h"
#include "tests/platform/libreoffice/OfficeStart.h"
#include "tests/platform/libreoffice/PrintQueue.h"

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

}  // namespace
