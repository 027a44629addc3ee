#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <random>
#include <thread>

#include "takeover/TakeOverResume.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/takeover/TakeOverSite.h"

namespace {

constexpr std::array<const char*, 2> Labels = {"Eve", "Zachary"};

/// Takes over one installation after the other until it is killed.
[[noreturn]] void TakeOverForEver(TakeOverSite& site) {
  for (std::size_t turn = 0;; turn = 1 - turn) {
    site.Open();
    TakeOverWork work(site.Parts());
    site.Look(work, Labels[turn]);
    if (TakeOverSite::TakeAll(work).What != TakenOver::Done) {
      _exit(1);
    }
  }
}

TEST(TakeOverKilled, LeavesAllFilesOldOrAllNewAfterTheNextStart) {
  constexpr int kills = 30;
  constexpr int longestMicroseconds = 400'000;
  const unsigned seed = std::random_device()();
  SCOPED_TRACE("seed " + std::to_string(seed));
  std::mt19937 random(seed);
  TakeOverSite site;
  FakeMessageBoxes boxes;
  for (const char* label : Labels) {
    site.PutInstallation(label, label);
  }
  int exchanged = 0;
  for (int kill = 0; kill < kills; ++kill) {
    site.Members.reset();
    site.Missions.reset();
    const pid_t child = fork();
    if (child == 0) {
      TakeOverForEver(site);
    }
    std::this_thread::sleep_for(
        std::chrono::microseconds(std::uniform_int_distribution<int>(0, longestMicroseconds)(random)));
    ::kill(child, SIGKILL);
    int status = 0;
    waitpid(child, &status, 0);
    ASSERT_TRUE(WIFSIGNALED(status)) << "ended by itself";
    EXPECT_TRUE(ResumeTakeOver(site.Disk, site.Data(), boxes, site.Strings).GoOn);
    EXPECT_TRUE(boxes.Boxes.empty());
    EXPECT_TRUE(site.Disk.FileNames(TakeOverFolder(site.Data())).empty());
    for (const std::string& name : site.Disk.FileNames(site.Data())) {
      EXPECT_FALSE(name.starts_with(".")) << name;
    }
    const std::string labels = site.Labels();
    EXPECT_TRUE(labels == TakeOverSite::LabelsOf("Now") || labels == TakeOverSite::LabelsOf(Labels[0]) ||
                labels == TakeOverSite::LabelsOf(Labels[1]))
        << labels;
    exchanged += labels != TakeOverSite::LabelsOf("Now") ? 1 : 0;
    for (const char* file : {"/members.mdb", "/scenarios.mdb"}) {
      EXPECT_EQ(OtherConnection(site.Data() + file).Query("PRAGMA integrity_check"), "ok") << file;
      EXPECT_FALSE(std::filesystem::exists(site.Data() + file + "-journal")) << file;
    }
    ASSERT_FALSE(HasFailure());
  }
  EXPECT_GT(exchanged, 0);
  site.Open();
  TakeOverWork work(site.Parts());
  site.Look(work, Labels[0]);
  EXPECT_EQ(TakeOverSite::TakeAll(work).What, TakenOver::Done);
}

}  // namespace
