#include "platform/linux/Instance.h"

#include <gmock/gmock.h>
#include <sys/socket.h>
#include <sys/stat.h>

#include <filesystem>
#include <memory>

#include "tests/platform/linux/InstanceVenue.h"

namespace {

using namespace std::chrono_literals;

TEST_F(InstanceOfAProgram, IsTheFirstOrTellsTheFirst) {
  Instance first(Place());
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  Forked second = StartElsewhere({"/games/1.game.xml", "token"});
  EXPECT_EQ(TakeCall(first), (InstanceRequest{"/games/1.game.xml", "token"}));
  EXPECT_EQ(second.ExitCode(), Told);
}

TEST_F(InstanceOfAProgram, OfAnotherPlaceIsNotMet) {
  Instance first(Place());
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  EXPECT_EQ(StartElsewhere({}, 0ms, "other").ExitCode(), First);
  EXPECT_FALSE(Readable(first.Listener(), 0));
}

TEST_F(InstanceOfAProgram, LeavesFilesForThisUserAlone) {
  const mode_t before = umask(0);
  Instance first(Place());
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  umask(before);
  for (const std::string& path : {LockPath(), SocketPath()}) {
    struct stat info {};
    ASSERT_EQ(stat(path.c_str(), &info), 0) << path;
    EXPECT_EQ(info.st_mode & 07777, 0600u) << path;
  }
}

TEST_F(InstanceOfAProgram, IsNeverASecondFirstWhenTheFirstDoesNotAnswer) {
  const std::unique_ptr<Forked> first = HoldElsewhere();
  EXPECT_EQ(StartElsewhere({}, 100ms).ExitCode(), NoAnswer);
  first->Signal(SIGSTOP);
  EXPECT_EQ(StartElsewhere({}, 100ms).ExitCode(), NoAnswer);
}

TEST_F(InstanceOfAProgram, IsTheFirstAfterOneThatCrashed) {
  for (int time = 0; time < 3; ++time) {
    const std::unique_ptr<Forked> crashed = HoldElsewhere();
    crashed->Signal(SIGKILL);
    crashed->ExitCode();
    ASSERT_EQ(access(SocketPath().c_str(), F_OK), 0) << "the stale socket";
  }
  Instance first(Place());
  EXPECT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  Forked second = StartElsewhere({});
  EXPECT_EQ(TakeCall(first), InstanceRequest());
  EXPECT_EQ(second.ExitCode(), Told);
}

TEST_F(InstanceOfAProgram, WaitsForOneThatIsAboutToEnd) {
  const std::unique_ptr<Forked> ending = HoldElsewhere();
  Forked next = StartElsewhere({"/a", ""});
  ending->Signal(SIGKILL);
  EXPECT_EQ(next.ExitCode(), First);
}

TEST_F(InstanceOfAProgram, TakesItsFilesAwayAtItsEnd) {
  {
    Instance first(Place());
    first.Start({}, 0ms);
    EXPECT_FALSE(std::filesystem::is_empty(folder.Path()));
  }
  EXPECT_TRUE(std::filesystem::is_empty(folder.Path()));
  EXPECT_EQ(Instance(Place()).Start({}, 0ms), InstanceOutcome::First);
}

TEST_F(InstanceOfAProgram, IsOneOfTwoThatStartAtOnce) {
  for (int time = 0; time < 200; ++time) {
    Pipe go;
    Pipe outcomes;
    Pipe hold;
    const auto race = [&] {
      go.WriteEnd.Close();
      hold.WriteEnd.Close();
      Readable(go.ReadEnd.Number());
      Instance instance(Place());
      const char outcome = instance.Start({}, 0ms) == InstanceOutcome::First ? 'F' : 'n';
      const bool told = write(outcomes.WriteEnd.Number(), &outcome, 1) == 1;
      Readable(hold.ReadEnd.Number());  // until both have tried
      return told ? 0 : 1;
    };
    Forked one(race);
    Forked other(race);
    go.WriteEnd.Close();
    std::string told(2, ' ');
    for (char& outcome : told) {
      ASSERT_TRUE(Readable(outcomes.ReadEnd.Number()));
      ASSERT_EQ(read(outcomes.ReadEnd.Number(), &outcome, 1), 1);
    }
    hold.WriteEnd.Close();
    EXPECT_EQ(one.ExitCode() + other.ExitCode(), 0);
    ASSERT_EQ(std::count(told.begin(), told.end(), 'F'), 1) << told << " at time " << time;
  }
}

TEST_F(InstanceOfAProgram, IsOneOfManyThatStartAndEndAllTheTime) {
  constexpr int runs = 200;
  const std::string mark = folder / "runs";
  const auto run = [&] {
    int clashes = 0;
    for (int time = 0; time < runs; ++time) {
      Instance instance(Place());
      if (instance.Start({}, 0ms) == InstanceOutcome::First) {
        // Only one at a time gets here.
        clashes += mkdir(mark.c_str(), 0700) == 0 ? 0 : 1;
        rmdir(mark.c_str());
      }
    }
    return clashes > 100 ? 100 : clashes;
  };
  Forked one(run);
  Forked two(run);
  Forked three(run);
  EXPECT_EQ(one.ExitCode(), 0);
  EXPECT_EQ(two.ExitCode(), 0);
  EXPECT_EQ(three.ExitCode(), 0);
}

TEST_F(InstanceOfAProgram, MeetsOthersInAFolderWithALongPath) {
  const std::string deep = folder / std::string(120, 'a');
  ASSERT_EQ(mkdir(deep.c_str(), 0700), 0);
  const InstancePlace place{{deep}, "program"};
  Instance first(place);
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  Forked second([&] { return static_cast<int>(Instance(place).Start({"/a", ""}, 30s)); });
  EXPECT_EQ(TakeCall(first).Path, "/a");
  EXPECT_EQ(second.ExitCode(), Told);
}

TEST_F(InstanceOfAProgram, IsTheFirstWhereNoFileCanBeMadeAndNobodyAnswers) {
  EXPECT_EQ(Instance({{folder / "missing"}, "program"}).Start({}, 0ms), InstanceOutcome::First);
  // A listener without a lock, as where the system allows none.
  ASSERT_EQ(mkdir(LockPath().c_str(), 0700), 0);
  Instance first(Place());
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  Forked second = StartElsewhere({"/a", ""});
  EXPECT_EQ(TakeCall(first).Path, "/a");
  EXPECT_EQ(second.ExitCode(), Told);
}

TEST_F(InstanceOfAProgram, DoesNotFollowALinkInPlaceOfItsLock) {
  const std::string victim = folder / "victim";
  Instance first(Place());
  ASSERT_EQ(symlink(victim.c_str(), LockPath().c_str()), 0);
  first.Start({}, 0ms);
  EXPECT_NE(access(victim.c_str(), F_OK), 0);
}

TEST_F(InstanceOfAProgram, MeetsInTheRuntimeFolderOnlyIfThatIsThisUsersAlone) {
  using testing::ElementsAre;
  const std::string data = folder / "data/Orvalin/Tessarine";
  const std::string runtime = folder / "runtime";
  ASSERT_EQ(mkdir(runtime.c_str(), 0700), 0);
  EXPECT_THAT(InstanceFolders(runtime, data), ElementsAre(runtime, data));
  EXPECT_EQ(access(data.c_str(), F_OK), 0) << "the place is there";
  ASSERT_EQ(chmod(runtime.c_str(), 0770), 0);
  EXPECT_THAT(InstanceFolders(runtime, data), ElementsAre(data));
  EXPECT_THAT(InstanceFolders("", data), ElementsAre(data));
  EXPECT_THAT(InstanceFolders("runtime", data), ElementsAre(data));
  EXPECT_THAT(InstanceFolders(folder / "missing", data), ElementsAre(data));
}

TEST_F(InstanceOfAProgram, ReadsALineThatComesInPieces) {
  Instance first(Place());
  first.Start({}, 0ms);
  InstanceCall call = CallWith(first, "");
  for (const char byte : std::string("open\t/a\tb")) {
    Send(std::string(1, byte));
    EXPECT_EQ(call.Read(), InstanceCall::State::Pending);
  }
  Send("\n");
  EXPECT_EQ(call.Read(), InstanceCall::State::Complete);
  EXPECT_EQ(call.Request(), (InstanceRequest{"/a", "b"}));
}

TEST_F(InstanceOfAProgram, HangsUpOnWhoSendsAnythingElse) {
  Instance first(Place());
  first.Start({}, 0ms);
  const std::string longest = "open\t/" + std::string(LongestInstanceLine - 8, 'a') + "\t";
  for (const std::string& bytes :
       {std::string("\n"), std::string("open\ta\t\n"), std::string("show\t\t\nshow\t\t\n"),
        std::string("show\t\t\n "), std::string(LongestInstanceLine + 1, 'a'), longest + "a\n",
        std::string("\0\xFF\x16\x03\n", 5)}) {
    InstanceCall call = CallWith(first, bytes);
    EXPECT_EQ(call.Read(), InstanceCall::State::Refused) << bytes.substr(0, 20);
  }
  EXPECT_EQ(CallWith(first, longest + "\n").Read(), InstanceCall::State::Complete);
}

TEST_F(InstanceOfAProgram, HangsUpOnWhoEndsWithoutALineBreak) {
  Instance first(Place());
  first.Start({}, 0ms);
  InstanceCall call = CallWith(first, "show\t\t");
  EXPECT_EQ(call.Read(), InstanceCall::State::Pending);
  caller.Close();
  EXPECT_EQ(call.Read(), InstanceCall::State::Refused);
}

TEST_F(InstanceOfAProgram, CannotAnswerWhoHasGone) {
  Instance first(Place());
  first.Start({}, 0ms);
  InstanceCall call = CallWith(first, "show\t\t\n");
  caller.Close();
  EXPECT_EQ(call.Read(), InstanceCall::State::Complete);
  EXPECT_FALSE(call.Answer());
}

TEST_F(InstanceOfAProgram, WantsItsOwnAnswer) {
  const std::unique_ptr<Forked> holder = HoldElsewhere();
  const InstanceAddress address(SocketPath());
  unlink(SocketPath().c_str());
  Descriptor stranger(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
  ASSERT_EQ(bind(stranger.Number(), address.Get(), InstanceAddress::Size), 0);
  ASSERT_EQ(listen(stranger.Number(), 5), 0);
  Forked second = StartElsewhere({}, 1s);
  ASSERT_TRUE(Readable(stranger.Number()));
  Descriptor connection(accept4(stranger.Number(), nullptr, nullptr, SOCK_CLOEXEC));
  ASSERT_EQ(write(connection.Number(), "taken?", 6), 6);
  EXPECT_EQ(second.ExitCode(), NoAnswer);
}

TEST_F(InstanceOfAProgram, KnowsTheUserAtTheOtherEnd) {
  const bool isRoot = geteuid() == 0;
  int ends[2] = {-1, -1};
  ASSERT_EQ(socketpair(AF_UNIX, SOCK_STREAM, 0, ends), 0);
  const Descriptor one(ends[0]);
  const Descriptor two(ends[1]);
  EXPECT_TRUE(IsOfThisUser(one.Number()));
  const OrdinaryUser user;  // another one than root
  EXPECT_EQ(IsOfThisUser(one.Number()), !isRoot);
  EXPECT_FALSE(IsOfThisUser(-1));
}

}  // namespace
