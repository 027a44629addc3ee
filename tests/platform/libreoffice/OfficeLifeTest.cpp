#include <gmock/gmock.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <cstdlib>
#include <filesystem>

#include "platform/libreoffice/LibreOffice.h"
#include "tests/platform/libreoffice/OfficeStart.h"
#include "tests/platform/libreoffice/Writer.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Thrown.h"

namespace {

using testing::IsEmpty;
using testing::SizeIs;

const std::string Template = DefaultSheetTemplate;

TEST_F(Writer, CannotEndTheProgramByEndingInACall) {
  struct sigaction onLostPipe {};
  ASSERT_EQ(sigaction(SIGPIPE, nullptr, &onLostPipe), 0);
  EXPECT_EQ(onLostPipe.sa_handler, SIG_IGN);
}

TEST_F(Writer, IsStartedAfreshWhenItWasKilled) {
  const std::vector<pid_t> hosts = Hosts();
  ASSERT_THAT(hosts, SizeIs(1));
  const std::vector<pid_t> offices = ChildrenOf(hosts[0], "soffice.bin");
  ASSERT_THAT(offices, SizeIs(1));
  const auto document = Office().Add(Template);
  kill(offices[0], SIGKILL);
  EXPECT_TRUE(WaitUntil([] { return Office().State() == WordState::Ended; }));
  EXPECT_EQ(NumberThrownBy([&] { document->SetBookmark("PlayerName", "x"); }), 440);
  EXPECT_EQ(NumberThrownBy([&] { Office().Add(Template); }), 429);
  ASSERT_TRUE(StartAndWait(Office()));
  EXPECT_THAT(Hosts(), SizeIs(1));
  EXPECT_EQ(Profiles(), 1u);
  Office().Add(Template)->Close();
}

TEST_F(Writer, IsStartedOnce) {
  Office().Start();
  Office().Start();
  EXPECT_THAT(Hosts(), SizeIs(1));
}

TEST_F(Writer, IsStartedByTheFilesThatWereThereAtFirst) {
  for (const char* name : {"/libtessarine-office.so", "/tessarine-office-host"}) {
    std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER + std::string(name), folder / name);
  }
  LibreOffice office(folder.Path());
  for (const char* name : {"/libtessarine-office.so", "/tessarine-office-host"}) {
    std::filesystem::remove(folder / name);
    WriteFile(folder / name, "of another release");
  }
  ASSERT_TRUE(StartAndWait(office));
  office.Add(Template)->Close();
  office.Quit();
  EXPECT_EQ(office.State(), WordState::Ended);
}

TEST_F(Writer, EndsWithAProgramThatCrashes) {
  const std::size_t profiles = Profiles();
  int ready[2];
  ASSERT_EQ(pipe(ready), 0);
  const pid_t program = fork();
  if (program == 0) {
    execl(TESSARINE_PROGRAM_FOLDER "/office-runner", "office-runner", TESSARINE_PROGRAM_FOLDER,
          std::to_string(ready[1]).c_str(), nullptr);
    _exit(1);
  }
  close(ready[1]);
  char byte = 0;
  ASSERT_EQ(read(ready[0], &byte, 1), 1);
  close(ready[0]);
  const std::vector<pid_t> hosts = Hosts(program);
  ASSERT_THAT(hosts, SizeIs(1));
  const std::vector<pid_t> offices = ChildrenOf(hosts[0], "soffice.bin");
  ASSERT_THAT(offices, SizeIs(1));
  kill(program, SIGKILL);
  waitpid(program, nullptr, 0);
  const auto runs = [](pid_t id) {
    for (const ProcessInfo& process : Processes()) {
      if (process.Id == id) {
        return true;
      }
    }
    return false;
  };
  EXPECT_TRUE(WaitUntil([&] { return !runs(hosts[0]) && !runs(offices[0]); }));
  EXPECT_EQ(Profiles(), profiles);
}

class LibreOfficeInLocale : public testing::TestWithParam<const char*> {};

TEST_P(LibreOfficeInLocale, ReadsAndSavesFilesNamedInAnyScript) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "目录");
  std::filesystem::copy(Template, folder / "目录/样张.doc");
  setenv("LC_ALL", GetParam(), 1);
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  const bool ready = StartAndWait(office);
  unsetenv("LC_ALL");
  ASSERT_TRUE(ready);
  const auto document = office.Add(folder / "目录/样张.doc");
  document->SaveAs(folder / "目录/Red 5-王小明 é.doc");
  document->Close();
  EXPECT_TRUE(std::filesystem::exists(folder / "目录/Red 5-王小明 é.doc"));
}

INSTANTIATE_TEST_SUITE_P(OfAnyKind, LibreOfficeInLocale, testing::Values("C", "C.UTF-8", "tlh_XX.UTF-8"));

TEST(LibreOfficeThatHangs, EndsAndLeavesNoFiles) {
  const TemporaryFolder folder;
  setenv("TMPDIR", folder.Path().c_str(), 1);
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  const bool ready = StartAndWait(office);
  unsetenv("TMPDIR");
  ASSERT_TRUE(ready);
  const std::vector<pid_t> hosts = Hosts();
  ASSERT_THAT(hosts, SizeIs(1));
  const std::vector<pid_t> offices = ChildrenOf(hosts[0], "soffice.bin");
  ASSERT_THAT(offices, SizeIs(1));
  office.Add(Template)->Close();
  kill(offices[0], SIGSTOP);
  office.Quit();
  EXPECT_EQ(office.State(), WordState::Ended);
  EXPECT_THAT(Hosts(), IsEmpty());
  EXPECT_TRUE(std::filesystem::is_empty(folder.Path()));
}

TEST(LibreOfficeThatIsNotThere, IsAFailureOfTheStart) {
  const TemporaryFolder folder;
  LibreOffice office(folder.Path());
  EXPECT_EQ(NumberThrownBy([&] { office.Start(); }), 429);
  EXPECT_EQ(office.State(), WordState::Ended);
  office.Quit();
}

}  // namespace
