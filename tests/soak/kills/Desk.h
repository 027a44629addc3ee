#pragma once

#include <array>
#include <ctime>
#include <filesystem>
#include <stdexcept>
#include <string>

#include "core/game/Session.h"
#include "platform/jet/JetConverter.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/soak/kills/Work.h"

/// A box that nobody expects is a failure: a program that was killed must start again without one.
class ExpectedBoxes : public MessageBoxes {
 public:
  /// The title of the boxes that may come; empty for none.
  std::string Title;

  std::string LatestText;

  BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon /*icon*/,
                 BoxButtons buttons = BoxButtons::Ok) override {
    LatestText = text;
    if (title != Title) {
      throw std::runtime_error("a box came: " + text);
    }
    return buttons == BoxButtons::YesNo || buttons == BoxButtons::YesNoCancel ? BoxAnswer::Yes
                                                                              : BoxAnswer::Ok;
  }
};

/// The operator's session without windows, on real files.
class Desk {
 public:
  Desk(const WorkSources& sources, const std::filesystem::path& folder, const std::string& expectedBoxes = {})
      : old_(Disk, sources.ProgramFolder / "tessarine-jet-reader") {
    Boxes.Title = expectedBoxes;
    Time.DateAndTime = Now();  // backup copies are named by it
    if (!Games.Open({.Engine = engine_,
                     .Old = old_,
                     .Disk = Disk,
                     .UserDataFolder = folder,
                     .ProgramFolder = sources.ProgramFolder})) {
      throw std::runtime_error("the session did not open");
    }
  }

  StringTable Strings{Language::English};
  FakeClock Time;
  ExpectedBoxes Boxes;
  LinuxFiles Disk;

 private:
  static std::string Now() {
    const std::time_t now = std::time(nullptr);
    std::array<char, 32> text{};
    std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S", std::gmtime(&now));
    return text.data();
  }

  SqliteEngine engine_;
  JetConverter old_;

 public:
  Session Games{Strings, Time, Boxes};
};

/// Gives the folder the databases of a new installation.
inline void PutDefaultDatabases(const WorkSources& sources, const std::filesystem::path& folder) {
  for (const std::string name : {"scenarios", "members"}) {
    std::filesystem::copy_file(sources.ProgramFolder / (name + "_default.mdb"), folder / (name + ".mdb"));
  }
}
