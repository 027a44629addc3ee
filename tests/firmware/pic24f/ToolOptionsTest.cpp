#include "firmware/pic24f/tool/ToolOptions.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace {

TEST(ToolOptions, TakesCommandsAndOptionsInAnyOrder) {
  const ToolOptions options = ParseToolOptions(
      {"--port", "/dev/ttyUSB0", "write", "--rate", "9600", "new.hex", "--despite-warnings"});
  EXPECT_EQ(options.Command, "write");
  EXPECT_EQ(options.File, "new.hex");
  EXPECT_EQ(options.Port, "/dev/ttyUSB0");
  EXPECT_EQ(options.Rate, 9600);
  EXPECT_TRUE(options.DespiteWarnings);
  EXPECT_EQ(ParseToolOptions({"identify", "--port", "COM1"}).Rate, 115200);
  EXPECT_EQ(ParseToolOptions({"erase", "--port", "p", "--device", "PIC", "--keep-config"}).DeviceName, "PIC");
  EXPECT_EQ(ParseToolOptions({"import", "a.hex", "--out", "d"}).Out, "d");
}

TEST(ToolOptions, NeedsNothingForHelp) {
  EXPECT_TRUE(ParseToolOptions({"--help"}).Help);
  EXPECT_TRUE(ParseToolOptions({"write", "--help"}).Help);
}

TEST(ToolOptions, RefusesWrongCommandLines) {
  const std::vector<std::vector<std::string>> wrong = {{},
                                                       {"burn"},
                                                       {"check"},
                                                       {"check", "a", "b"},
                                                       {"import", "a"},
                                                       {"import", "--out", "d"},
                                                       {"image", "a"},
                                                       {"identify"},
                                                       {"identify", "a", "--port", "p"},
                                                       {"write", "--port", "p"},
                                                       {"run", "--port"},
                                                       {"run", "--port", "p", "--rate", "fast"},
                                                       {"run", "--port", "p", "--rate", "0"},
                                                       {"run", "--port", "p", "--rate", "-5"},
                                                       {"check", "a", "--quickly"}};
  for (const auto& words : wrong) {
    EXPECT_THROW(ParseToolOptions(words), std::invalid_argument) << (words.empty() ? "" : words.back());
  }
}

TEST(ToolOptions, ExplainsEachCommandAndOption) {
  const std::string usage = ToolUsage();
  for (const char* word : {"check FILE", "import FILE --out DIR", "image FILE --out FILE", "identify",
                           "erase", "write FILE", "verify FILE", "run ", "--port", "--rate", "--device",
                           "--despite-warnings", "--keep-config", "--help"}) {
    EXPECT_NE(usage.find(word), std::string::npos) << word;
  }
}

}  // namespace
