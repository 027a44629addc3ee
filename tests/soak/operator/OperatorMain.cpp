#include <QApplication>
#include <QImage>
#include <QTimer>
#include <algorithm>
#include <cstdio>
#include <fstream>
#include <optional>

#include "app/Program.h"
#include "tests/soak/Options.h"
#include "tests/soak/operator/Field.h"
#include "tests/soak/operator/RandomHand.h"
#include "tests/soak/operator/Watchdog.h"
#include "tests/support/TestDatabase.h"

namespace {

using SteadyClock = std::chrono::steady_clock;

constexpr const char* Usage =
    "usage: soak-operator --commands N --folder FOLDER [--seed S] [--seconds N] [--patience SECONDS]\n"
    "                     [--stumble crash|hang]\n"
    "Gives the program N commands at random, or as many as the time allows, with its data in FOLDER, which "
    "is new.\n"
    "--stumble has it crash or hang on purpose, to show that it is noticed.\n";

struct Options {
  unsigned Seed = 1;
  int Commands = 0;
  double Seconds = 1e9;
  std::chrono::seconds Patience{60};
  std::filesystem::path Folder;
  std::string Stumble;
};

Options OptionsIn(int argc, char** argv) {
  Options options;
  ReadOptions(
      argc, argv,
      {{"--seed", [&](const std::string& value) { options.Seed = static_cast<unsigned>(std::stoul(value)); }},
       {"--commands", [&](const std::string& value) { options.Commands = std::stoi(value); }},
       {"--seconds", [&](const std::string& value) { options.Seconds = std::stod(value); }},
       {"--patience",
        [&](const std::string& value) { options.Patience = std::chrono::seconds(std::stoi(value)); }},
       {"--folder", [&](const std::string& value) { options.Folder = value; }},
       {"--stumble", [&](const std::string& value) { options.Stumble = value; }}},
      Usage, [&] { return options.Commands > 0 && !options.Folder.empty(); });
  return options;
}

/// The data folder of a club with some members, and files for the file dialogs.
std::filesystem::path PrepareFolder(const std::filesystem::path& folder) {
  const std::filesystem::path data = folder / "Orvalin/Tessarine";
  const std::filesystem::path program = std::filesystem::read_symlink("/proc/self/exe").parent_path();
  std::filesystem::create_directories(data);
  std::filesystem::create_directories(folder / "files/folder");
  for (const auto& [file, source] : {std::pair{"scenarios.mdb", "scenarios_default.mdb"},
                                     {"members.mdb", "members_default.mdb"},
                                     {"score_card.doc", "score_card_default.doc"},
                                     {"tessarine.ini", "tessarine.ini"}}) {
    std::filesystem::copy_file(program / source, data / file);
  }
  OtherConnection members(data / "members.mdb");
  for (int id = 1; id <= 30; ++id) {
    members.Execute("INSERT INTO Members (FirstName, LastName, NickName, DallasID) VALUES ('Ann', 'Lee " +
                    std::to_string(id) + "', '<b>', '" + std::to_string(1000000000000000 + id) + "')");
  }
  QImage photo(120, 160, QImage::Format_RGB32);
  photo.fill(Qt::blue);
  photo.save(QString::fromStdString((folder / "files/photo.png").string()));
  std::ofstream(folder / "files/noise.bin") << std::string(200'000, '\x7E');
  std::ofstream(folder / "files/empty").flush();
  return data;
}

/// Keeps giving commands, whatever windows and waits are on the stack.
class RandomOperator : public QObject {
 public:
  RandomOperator(const Options& options, const std::filesystem::path& data)
      : options_(options),
        random_(options.Seed),
        trace_(options.Folder / "commands.log"),
        field_(data, options.Seed),
        watchdog_(options.Patience),
        hand_(options.Folder / "files", options.Seed, [this](const std::string& command) { Note(command); }) {
    Note("devices: " + field_.Change());
    Schedule();
  }

  bool IsDone() const {
    return given_ >= options_.Commands ||
           SteadyClock::now() - start_ > std::chrono::duration<double>(options_.Seconds);
  }
  int Given() const { return given_; }

 private:
  /// What nested windows and waits may take of the stack. Nobody presses a button a thousand times in a wait.
  static constexpr std::ptrdiff_t MostStack = 2 << 20;
  static constexpr int CommandsWithADevice = 150;
  static constexpr int CommandsBeforeStumbling = 20;

  void Note(const std::string& command) {
    std::string line = command;
    std::ranges::replace(line, '\n', ' ');  // a command may name a text of several lines
    trace_ << given_ << " " << line << std::endl;
    watchdog_.NoteCommand(command);
  }

  void Schedule() {
    QTimer::singleShot(static_cast<int>(random_() % 8), this, [this] { Tick(); });
  }

  void Tick() {
    Schedule();  // first, since a command may not return for long
    if (IsDone()) {
      End();
      return;
    }
    watchdog_.Beat();
    Stumble();
    if (StackIsDeep()) {
      Unwind();
      return;
    }
    ++given_;
    if (given_ % CommandsWithADevice == 0) {
      Note("devices: " + field_.Change());
    } else if (random_() % 40 == 0) {
      Note("a button at the reader");
      field_.TouchOrLeave();
    } else {
      hand_.DoSomething();
    }
  }

  /// Beats no more: whatever has not come to its end when the watchdog's patience has, hangs.
  void End() { hand_.Leave(); }

  bool StackIsDeep() const {
    const char here = 0;
    return std::abs(bottom_ - &here) > MostStack;
  }

  /// Leaves windows until the stack is short again. Jobs that wait for a device get the time to end.
  void Unwind() { hand_.Leave(); }

  void Stumble() const {
    if (given_ < CommandsBeforeStumbling) {
      return;
    }
    if (options_.Stumble == "crash") {
      std::abort();
    }
    while (options_.Stumble == "hang") {
      std::this_thread::sleep_for(std::chrono::seconds(1));
    }
  }

  const char* const bottom_ = static_cast<const char*>(__builtin_frame_address(0));
  const Options options_;
  const SteadyClock::time_point start_ = SteadyClock::now();
  int given_ = 0;
  std::mt19937 random_;
  std::ofstream trace_;
  Field field_;
  Watchdog watchdog_;
  RandomHand hand_;
};

/// Whatever the operator did, the files are sound.
void CheckDatabases(const std::filesystem::path& data) {
  for (const char* name : {"scenarios.mdb", "members.mdb"}) {
    if (const std::string found = OtherConnection(data / name).Query("PRAGMA integrity_check");
        found != "ok") {
      throw std::runtime_error(std::string("loss: ") + name + " is damaged: " + found);
    }
  }
}

int Run(const Options& options) {
  const std::filesystem::path data = PrepareFolder(options.Folder);
  std::filesystem::current_path(options.Folder / "files");
  RandomOperator hand(options, data);
  int starts = 0;
  while (!hand.IsDone()) {
    const int before = hand.Given();
    Program().Run();
    ++starts;
    CheckDatabases(data);
    if (hand.Given() == before) {
      throw std::runtime_error("crash: the program does not start");
    }
  }
  std::printf("operator: seed %u: %d commands, %d starts\n", options.Seed, hand.Given(), starts);
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  const Options options = OptionsIn(argc, argv);
  for (const char* name : {"XDG_DATA_HOME", "XDG_CONFIG_HOME", "XDG_RUNTIME_DIR", "HOME", "TMPDIR"}) {
    qputenv(name, QByteArray::fromStdString(options.Folder.string()));
  }
  if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
  }
  QApplication application(argc, argv);
  try {
    return Run(options);
  } catch (const std::exception& failure) {
    std::printf("operator: seed %u: %s\n", options.Seed, failure.what());
    return 1;
  }
}
