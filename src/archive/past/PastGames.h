#pragma once

#include <QDialog>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "archive/ArchiveAccess.h"
#include "archive/past/PastBoardModel.h"
#include "archive/past/PastGameModel.h"
#include "archive/past/PastMonthModel.h"
#include "platform/Clock.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

class QAbstractItemView;
class QLineEdit;
class QTableView;

namespace Ui {
class PastGames;
}

/// The games of the archive: listed by months, searched, shown without loading them, opened, saved, deleted
/// and brought back. What fails is told in a line of the window, and the next attempt starts anew.
class PastGames : public QDialog {
  Q_OBJECT

 public:
  /// A game that the operator wants on the board.
  struct Opened {
    std::int64_t GameId;
    std::int64_t State;  ///< 0 for the last one, else an earlier one
    std::string Bytes;   ///< of its file
    GuestList::Names Guests = {};
  };

  /// All references must outlive the window.
  struct Parts {
    ArchiveAccess& Archive;
    const Clock& Time;
    MessageBoxes& Boxes;
    ::FileDialog& CommonDialog1;
    Files& Disk;
    EventPump& Events;
    const StringTable& Strings;
    /// The members whose nickname, first or last name begins with this text, all of them.
    std::function<std::vector<std::int32_t>(const std::string& text)> MembersCalled;
    /// True if the game on the board is in no file as it is.
    std::function<bool()> BoardIsUnsaved;
    /// What forbids to open a game at the moment; nothing if it is allowed.
    std::function<std::optional<OwnText>()> Busy;
    std::function<void(const PastGame& game)> ShowCharts;
    std::function<void(const std::vector<std::int64_t>& games)> Export;
    /// Takes game files into the archive; without it there is no such button.
    std::function<void()> Import = {};
  };

  PastGames(Parts parts, QWidget* parent);
  ~PastGames() override;

  /// The game to open, once the window was closed by Open.
  const std::optional<Opened>& Chosen() const { return chosen_; }

  void reject() override;

 private:
  void SetTexts();
  void SetUpSearch();
  void FillMissions();
  void SetUpTables();
  void ConnectCommands();

  /// Reads everything anew. `stay` is the game to select, if it is still there.
  void Refresh(std::int64_t stay);
  void ListGames(std::int64_t stay);
  /// Shows the board of the current game.
  void ShowGame();
  void ShowBoard();
  void FillStates(const ListedGame* game);
  void EnableButtons();

  /// What the entries say; nothing, which is told, if one of them makes no sense.
  std::optional<PastSearch> SearchOfEntries();
  /// False, which is told, for a text that is neither empty nor a date.
  bool ReadDay(QLineEdit& entry, std::string& day);
  void Search();
  void ShowAll();

  void OpenGame();
  void SaveFile();
  void ShowCharts();
  void Export();
  void Delete();
  void BringBack();
  void Import();
  void Copy(const QAbstractItemView& list);

  /// Asked between steps with the part done, 0 to 1; false stops the run.
  using Step = std::function<bool(double done)>;
  /// Runs `act`. Where that takes long, the window is painted meanwhile, shows how far it is, and takes
  /// nothing but Stop. What `act` throws ends the run.
  void RunInSteps(bool takesLong, const std::function<void(const Step& goOn)>& act);
  /// True for so many rows that what is done with each of them takes long.
  static bool AreMany(std::size_t rows);
  /// How a change of games ended; %1 is how many were changed, %2 how many were not.
  struct ChangeTexts {
    OwnText Done;
    OwnText DoneInPart;
    OwnText Stopped;
  };
  struct Change {
    /// Changes these, all together and durably. Returns how many it changed.
    std::function<int(const std::vector<std::int64_t>& some)> Act;
    /// How many of the first of these games are changed at a time; at least one.
    std::function<std::size_t(std::span<const std::int64_t> games)> AtOnce;
  };
  /// Changes these games, some at a time, and then reads the lists anew. Tells how many were changed. Throws
  /// RuntimeError 61 if the disk has no room; nothing is changed then.
  void ChangeInSteps(const std::vector<std::int64_t>& games, const Change& change, const ChangeTexts& texts);

  /// Runs `action`, and tells in the window if it fails. False then.
  bool Try(const std::function<void()>& action);
  void Tell(const std::string& text);
  void TellFailure(const std::string& reason);
  void TellOfEmptyList();

  const PastMonthModel::Entry& Listed() const;
  /// The current game's number, 0 if there is none.
  std::int64_t CurrentGame() const;
  std::int64_t CurrentState() const;
  /// In the order of the list.
  std::vector<std::int64_t> SelectedGames() const;

  std::unique_ptr<Ui::PastGames> ui_;
  const Parts parts_;
  PastMonthModel months_;
  PastGameModel games_;
  PastBoardModel board_;
  PastSearch search_;
  std::optional<Opened> chosen_;
  bool stopped_ = false;
  bool listing_ = false;  ///< lists are being filled, so what is selected in them is no choice
  Commands commands_;
};
