#pragma once

#include <QDialog>
#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/MessageBoxes.h"
#include "takeover/FoundModel.h"
#include "takeover/TakeOverWork.h"
#include "ui/Commands.h"

namespace Ui {
class TakeOver;
}

/// Whose member numbers stand in the game files of an old installation.
enum class FilesOfMembers {
  Taken,  ///< those of the members that were taken over
  Others
};

/// How the import of game files ended.
struct ImportedGames {
  std::size_t Imported = 0;
  std::size_t Known = 0;
  std::size_t Refused = 0;
  bool Whole = true;  ///< false if it was stopped
  /// For the operator: a line for each refused file, with the line in it and why.
  std::vector<std::string> RefusedFiles = {};
};

/// Takes over the data of an old installation: the operator chooses its folder, sees what it has beside what
/// is in use, and ticks what is wanted.
class TakeOver : public QDialog {
  Q_OBJECT

 public:
  /// Asked often, with how much of an import is done, from 0 to 1; false stops it.
  using OnImport = std::function<bool(double done)>;
  /// Imports the game files of a folder.
  using GameImporter =
      std::function<ImportedGames(const std::string& folder, FilesOfMembers members, const OnImport& keepOn)>;

  struct Parts {
    TakeOverWork::Parts Work;  ///< its question is asked by the window
    EventPump& Events;
    MessageBoxes& Boxes;
    ::FileDialog& FileDialog;
    /// What forbids a take-over at the moment; nothing if it is allowed.
    std::function<std::optional<OwnText>()> Busy;
    /// Clears the board and opens anew what was replaced; called after a take-over.
    std::function<void(const std::set<OldItem>& taken)> Reopen;
    /// Ends the program, since the next start finishes what could not be.
    std::function<void()> EndProgram;
    /// Empty if there is no archive that takes games in.
    GameImporter ImportGames = {};
  };

  TakeOver(Parts parts, QWidget* parent);
  ~TakeOver() override;

  void reject() override;

 private:
  void SetUpTable();
  void ConnectCommands();
  void ChooseFolder();
  /// Shows what is in the folder; tells why if that is nothing.
  void LookInto(const std::string& folder);
  void LeaveOutGames(std::vector<FoundItem>& found) const;
  void Take();
  bool MayTake();
  void TakeTicked();
  void Tell(const TakenOver& taken, const std::set<OldItem>& items);
  /// Opens what was exchanged, imports the game files, and tells the result.
  void TellDone(const TakenOver& taken, const std::set<OldItem>& items);
  /// What became of the game files, for the operator.
  std::string ImportGames(FilesOfMembers members);
  /// In the place of what was found, if there are any.
  void ListRefused(const std::vector<std::string>& files);
  std::string TitlesOf(const std::set<OldItem>& items) const;
  void EnableEntries(bool enabled);
  void ShowStatus(const std::string& text);
  const std::string& Words(OwnText text) const { return parts_.Work.Strings.Text(text); }

  std::unique_ptr<Ui::TakeOver> ui_;
  const Parts parts_;
  TakeOverWork work_;
  FoundModel found_;
  std::optional<OldInstallation> old_;
  Commands commands_;
  bool stopped_ = false;
};
