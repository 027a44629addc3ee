#include "core/gamefile/CurrentGameFile.h"

#include <filesystem>

#include "core/gamefile/GameFile.h"
#include "platform/RuntimeError.h"

namespace {

constexpr const char* Filter = "XML Files & (*.xml) |*.xml";

/// The file's bytes; empty if it cannot be read, which then fails like any file that is not a game file.
std::string ReadOrNothing(const Files& files, const std::string& path) {
  try {
    return files.Read(path);
  } catch (const RuntimeError&) {
    return {};
  }
}

}  // namespace

bool CurrentGameFile::SaveGame(const Game& game, const std::string& missionName,
                               const std::string& suggestion) {
  savedOnCancel_.clear();
  const auto chosen = suggestion.empty()
                          ? dialog_.ShowSave({.Filter = Filter, .Name = fileName_})
                          : dialog_.ShowSave({.Filter = Filter, .Name = suggestion, .Folder = saveFolder_});
  fileName_ = chosen.value_or(fileName_);
  if (fileName_.empty()) {
    return false;
  }
  files_.Replace(fileName_, WriteGameFile(game, missionName));
  saveFolder_ = std::filesystem::path(fileName_).parent_path().string();
  if (!chosen) {
    savedOnCancel_ = fileName_;
  }
  return true;
}

bool CurrentGameFile::AskForGame() {
  fileName_ = dialog_.ShowOpen({.Filter = Filter}).value_or("");
  return !fileName_.empty();
}

bool CurrentGameFile::LoadGame(Game& game, const std::function<void(const std::string&)>& selectMission) {
  if (ReadGameFile(ReadOrNothing(files_, fileName_), game, selectMission)) {
    return true;
  }
  boxes_.Show("Unable to open Game file.", "Game File Error", BoxIcon::Exclamation);
  return false;
}

std::string CurrentGameFile::TimeOfChange() const {
  try {
    return files_.TimeOfChange(fileName_);
  } catch (const RuntimeError&) {
    return {};
  }
}
