#pragma once

#include <chrono>
#include <filesystem>
#include <functional>
#include <string>
#include <utility>

#include "core/text/StringTable.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"

/// The surroundings of a window that works on the operator's data: a temporary data folder with real
/// databases and files; boxes, file dialogs, clock and reader are fakes.
class DataSite {
 public:
  explicit DataSite(Language language = Language::English) : Strings(language) {}

  std::string DataFolder() const { return Folder / "Orvalin/Tessarine"; }
  std::string DataFile(const std::string& name) const { return DataFolder() + '/' + name; }

  /// Fills the data folder as the first start does.
  void PutDefaultFiles() const {
    std::filesystem::create_directories(DataFolder());
    for (const auto& [file, source] : {std::pair{"scenarios.mdb", "scenarios_default.mdb"},
                                       {"members.mdb", "members_default.mdb"},
                                       {"score_card.doc", "score_card_default.doc"},
                                       {"tessarine.ini", "tessarine.ini"}}) {
      std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER + std::string("/") + source, DataFile(file),
                                 std::filesystem::copy_options::skip_existing);
    }
  }

  /// Changes one of the databases, as another program would.
  void ChangeDatabase(const std::string& file, const std::string& sql) const {
    OtherConnection(DataFile(file)).Execute(sql);
  }

  /// What another program reads in one of the databases: the first column of the first row, "NULL" or "none".
  std::string QueryDatabase(const std::string& file, const std::string& sql) const {
    return OtherConnection(DataFile(file)).Query(sql);
  }

  TemporaryFolder Folder;
  StringTable Strings;
  FakeClock Time;
  SqliteEngine Databases{std::chrono::milliseconds(50)};
  FakeFileDialog Dialog;
  LinuxFiles Disk;
  FakeMessageBoxes Boxes;
  /// The reader of membership buttons; if it is empty, there is none.
  std::function<std::string()> ButtonSwipe;
};
