#include "platform/linux/KeptProgram.h"

#include <dlfcn.h>
#include <gtest/gtest.h>

#include <filesystem>

#include "platform/linux/ChildProcess.h"
#include "tests/support/TemporaryFolder.h"

namespace {

class KeptProgramTest : public testing::Test {
 protected:
  /// As a package does it: beside, then under its name.
  void Install(const std::string& word) const {
    WriteFile(path + ".new", "#!/bin/sh\necho " + word + "\n");
    std::filesystem::permissions(path + ".new", std::filesystem::perms::owner_all);
    std::filesystem::rename(path + ".new", path);
  }

  static std::string SaidBy(const std::string& program) {
    Pipe output;
    ChildProcess child({program}, {.Output = output.WriteEnd.Number()});
    output.WriteEnd.Close();
    std::string said;
    char byte = 0;
    while (read(output.ReadEnd.Number(), &byte, 1) == 1 && byte != '\n') {
      said += byte;
    }
    return said;
  }

  const TemporaryFolder folder;
  const std::string path = folder / "helper";
};

TEST_F(KeptProgramTest, HasItsNameAsLongAsThatIsTheSameFile) {
  Install("old");
  const KeptProgram program(path);
  EXPECT_EQ(program.Path(), path);
}

TEST_F(KeptProgramTest, RunsAsItWasWhenAnotherHasTakenItsName) {
  Install("old");
  const KeptProgram program(path);
  Install("new");
  EXPECT_EQ(SaidBy(path), "new");
  EXPECT_EQ(SaidBy(program.Path()), "old");
  EXPECT_EQ(program.Name(), path);
}

TEST_F(KeptProgramTest, RunsWhenItHasBeenRemoved) {
  Install("old");
  const KeptProgram program(path);
  std::filesystem::remove(path);
  EXPECT_EQ(SaidBy(program.Path()), "old");
}

TEST_F(KeptProgramTest, IsWhateverIsThereWhenThereWasNoneAtFirst) {
  const KeptProgram program(path);
  EXPECT_EQ(program.Path(), path);
  Install("later");
  EXPECT_EQ(SaidBy(program.Path()), "later");
}

TEST_F(KeptProgramTest, CanBeAModuleOfThisProcess) {
  std::filesystem::copy_file("/usr/lib/x86_64-linux-gnu/libsqlite3.so.0", path);
  const KeptProgram module(path);
  std::filesystem::remove(path);
  void* const loaded = dlopen(module.Path().c_str(), RTLD_NOW | RTLD_LOCAL);
  ASSERT_NE(loaded, nullptr) << dlerror();
  EXPECT_NE(dlsym(loaded, "sqlite3_libversion"), nullptr);
  dlclose(loaded);
}

}  // namespace
