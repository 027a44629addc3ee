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

/// What a window that works on the operator's data stands on: a data folder of its own with real databases
/// and files; boxes, file dialogs, clock and reader are faked.
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

  /// Another program changes one of the databases.
  void ChangeDatabase(const std::string& file, const std::string& sql) const {
    OtherConnection(DataFile(file)).Execute(sql);
  }

  /// What another program reads of one of the databases: the first column of the first row, "NULL" or "none".
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
  /// The reader of membership buttons; none as long as it is empty.
  std::function<std::string()> ButtonSwipe;
};
