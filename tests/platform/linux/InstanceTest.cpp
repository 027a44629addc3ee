#include "platform/linux/Instance.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <functional>
#include <memory>

#include "platform/linux/ChildProcess.h"
#include "platform/linux/InstanceCall.h"
#include "platform/linux/InstanceSocket.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/TemporaryFolder.h"

namespace {

using namespace std::chrono_literals;

constexpr int Limit = 30'000;  ///< milliseconds that a test waits for what must come

/// A process of its own that runs `body` and exits with its result.
class Forked {
 public:
  explicit Forked(const std::function<int()>& body) : id_(fork()) {
    if (id_ == 0) {
      _exit(body());
    }
  }
  ~Forked() {
    if (id_ > 0) {
      kill(id_, SIGKILL);
      waitpid(id_, nullptr, 0);
    }
  }
  Forked(const Forked&) = delete;
  Forked& operator=(const Forked&) = delete;

  void Signal(int number) const { kill(id_, number); }

  /// Waits for its end; its exit code, or -1.
  int ExitCode() {
    int status = 0;
    waitpid(id_, &status, 0);
    id_ = 0;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  }

 private:
  pid_t id_;
};

bool Readable(int descriptor, int milliseconds = Limit) {
  pollfd watched{descriptor, POLLIN, 0};
  return poll(&watched, 1, milliseconds) == 1;
}

class InstanceOfAProgram : public testing::Test {
 protected:
  InstancePlace Place(const std::string& name = "program") const { return {{folder.Path()}, name}; }

  std::string LockPath() const { return Instance::LockPath(Place(), 0); }
  std::string SocketPath() const { return Instance::SocketPath(Place(), 0); }

  /// Starts in a process of its own; its outcome is the exit code.
  Forked StartElsewhere(InstanceRequest request, std::chrono::milliseconds patience = 30s,
                        const std::string& name = "program") const {
    return StartAt(Place(name), std::move(request), patience);
  }
  static Forked StartAt(InstancePlace place, InstanceRequest request = {},
                        std::chrono::milliseconds patience = 0ms) {
    return Forked([place = std::move(place), request = std::move(request), patience] {
      return static_cast<int>(Instance(place).Start(request, patience));
    });
  }

  /// A first one in a process of its own, which holds the place until that is killed.
  std::unique_ptr<Forked> HoldElsewhere() const {
    Pipe ready;
    auto holder = std::make_unique<Forked>([this, &ready] {
      Instance instance(Place());
      const bool isFirst = instance.Start({}, 0ms) == InstanceOutcome::First;
      if (isFirst && write(ready.WriteEnd.Number(), "1", 1) == 1) {
        pause();
      }
      return 0;
    });
    EXPECT_TRUE(Readable(ready.ReadEnd.Number()));
    return holder;
  }

  /// A call from this process at the listener of `first`.
  InstanceCall CallWith(const Instance& first, const std::string& bytes) {
    caller = Descriptor(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    const InstanceAddress address(SocketPath());
    EXPECT_EQ(connect(caller.Number(), address.Get(), InstanceAddress::Size), 0);
    Send(bytes);
    bool failed = false;
    std::optional<InstanceCall> call = InstanceCall::Accept(first.Listener(), failed);
    EXPECT_FALSE(failed);
    return std::move(call.value());
  }
  void Send(const std::string& bytes) {
    EXPECT_EQ(send(caller.Number(), bytes.data(), bytes.size(), MSG_NOSIGNAL),
              static_cast<ssize_t>(bytes.size()));
  }

  TemporaryFolder folder;
  Descriptor caller;
};

constexpr int First = static_cast<int>(InstanceOutcome::First);
constexpr int Told = static_cast<int>(InstanceOutcome::Told);
constexpr int NoAnswer = static_cast<int>(InstanceOutcome::NoAnswer);

/// Takes the next call as the running program does.
InstanceRequest TakeCall(const Instance& first) {
  bool failed = false;
  EXPECT_TRUE(Readable(first.Listener()));
  std::optional<InstanceCall> call = InstanceCall::Accept(first.Listener(), failed);
  EXPECT_TRUE(call);
  InstanceCall::State state = InstanceCall::State::Pending;
  while (state == InstanceCall::State::Pending && Readable(call->Number())) {
    state = call->Read();
  }
  EXPECT_EQ(state, InstanceCall::State::Complete);
  EXPECT_TRUE(call->Answer());
  return call->Request();
}

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

/// Programs with one data folder, which may have different runtime folders.
class InstanceInTwoFolders : public InstanceOfAProgram {
 protected:
  InstanceInTwoFolders() {
    for (const std::string& each : {Runtime, Other, Data}) {
      EXPECT_EQ(mkdir(each.c_str(), 0755), 0);
    }
  }

  const std::string Runtime = folder / "runtime";
  const std::string Other = folder / "other";
  const std::string Data = folder / "data";
  const InstancePlace Both{{Runtime, Data}, "program"};
  const InstancePlace DataAlone{{Data}, "program"};
};

TEST_F(InstanceInTwoFolders, IsNoSecondFirstWithoutTheRuntimeFolderOfTheFirst) {
  Instance first(Both);
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  EXPECT_EQ(StartAt(DataAlone).ExitCode(), NoAnswer);
  EXPECT_EQ(StartAt({{Other, Data}, "program"}).ExitCode(), NoAnswer);
}

TEST_F(InstanceInTwoFolders, IsNoSecondFirstWithARuntimeFolderThatTheFirstDidNotHave) {
  Instance first(DataAlone);
  ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
  Forked second = StartAt(Both, {"/a", ""}, 30s);
  EXPECT_EQ(TakeCall(first).Path, "/a");
  EXPECT_EQ(second.ExitCode(), Told);
}

TEST_F(InstanceInTwoFolders, LocksInOneWhereTheOtherCannotTakeAFile) {
  for (const std::string& refuses : {Runtime, Data}) {
    ASSERT_EQ(rmdir(refuses.c_str()), 0);  // as a disk without room does
    Instance first(Both);
    ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First) << refuses;
    Forked second = StartAt(Both, {"/a", ""}, 30s);
    EXPECT_EQ(TakeCall(first).Path, "/a") << refuses;
    EXPECT_EQ(second.ExitCode(), Told);
    EXPECT_EQ(StartAt(Both).ExitCode(), NoAnswer) << refuses;
    ASSERT_EQ(mkdir(refuses.c_str(), 0755), 0);
  }
}

TEST_F(InstanceInTwoFolders, DropsOneLockWhenTheOtherIsHeld) {
  const InstancePlace runtimeAlone{{Runtime}, "program"};
  auto first = std::make_unique<Instance>(runtimeAlone);
  ASSERT_EQ(first->Start({}, 0ms), InstanceOutcome::First);
  Instance second(Both);
  EXPECT_EQ(second.Start({}, 0ms), InstanceOutcome::NoAnswer);
  EXPECT_TRUE(std::filesystem::is_empty(Data));
  first.reset();
  EXPECT_EQ(second.Start({}, 0ms), InstanceOutcome::First);
  EXPECT_EQ(StartAt(DataAlone).ExitCode(), NoAnswer);
}

TEST_F(InstanceInTwoFolders, TakesItsFilesAwayFromBoth) {
  {
    Instance first(Both);
    ASSERT_EQ(first.Start({}, 0ms), InstanceOutcome::First);
    EXPECT_EQ(access(Instance::LockPath(Both, 0).c_str(), F_OK), 0);
    EXPECT_EQ(access(Instance::LockPath(Both, 1).c_str(), F_OK), 0);
    EXPECT_EQ(access(Instance::SocketPath(Both, 1).c_str(), F_OK), -1) << "one is enough";
  }
  EXPECT_TRUE(std::filesystem::is_empty(Runtime));
  EXPECT_TRUE(std::filesystem::is_empty(Data));
}

TEST_F(InstanceInTwoFolders, IsBarredByALockOfAnotherUser) {
  if (geteuid() != 0) {  // nobody else can make a file of another user: what it is for an own file
    WriteFile(Instance::LockPath(Both, 1), "");
    EXPECT_EQ(StartAt(Both).ExitCode(), First);
    return;
  }
  WriteFile(Instance::LockPath(Both, 1), "");
  ASSERT_EQ(chmod(Instance::LockPath(Both, 1).c_str(), 0600), 0);
  for (const std::string& each : {folder.Path(), Runtime, Data}) {
    ASSERT_EQ(chmod(each.c_str(), 0777), 0);
  }
  const OrdinaryUser user;
  Instance barred(Both);
  EXPECT_EQ(barred.Start({}, 0ms), InstanceOutcome::Barred);
  EXPECT_EQ(barred.BarredBy(), Instance::LockPath(Both, 1));
}

TEST_F(InstanceInTwoFolders, LeavesTheLockOfTheAdministratorToTheOwnerOfTheData) {
  if (geteuid() == 0) {
    ASSERT_EQ(chmod(folder.Path().c_str(), 0777), 0);
    ASSERT_EQ(chown(Data.c_str(), 65534, 65534), 0);
  }
  auto first = std::make_unique<Instance>(DataAlone);
  ASSERT_EQ(first->Start({}, 0ms), InstanceOutcome::First);
  const OrdinaryUser user;
  EXPECT_EQ(Instance(DataAlone).Start({}, 0ms), InstanceOutcome::NoAnswer) << "it is held";
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
