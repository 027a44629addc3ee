#pragma once

#include <QDialog>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "exports/ExportRun.h"
#include "exports/ExportSource.h"
#include "exports/GameExport.h"
#include "platform/Clock.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

namespace Ui {
class ExportGames;
}

/// Writes games into files of other programs, as often as the operator wants. What it tells of persons is
/// ticked anew each time that it opens.
class ExportGames : public QDialog {
  Q_OBJECT

 public:
  /// Hands over the game on the board.
  using ThisGame = std::function<void(const std::function<void(const ExportedGame&)>& take)>;

  /// All but the functions and texts must outlive the window.
  struct Parts {
    ThisGame Game;              ///< none where there is no game on the board
    std::string SuggestedName;  ///< of the files of that game, without folder and ending
    ExportSource& Past;
    std::vector<std::int64_t> Chosen;  ///< past games that the operator chose before, if any
    FileDialog& CommonDialog1;
    Files& Disk;
    MessageBoxes& Boxes;
    EventPump& Events;
    const Clock& Time;
    const StringTable& Strings;
  };

  ExportGames(const Parts& parts, QWidget* parent);
  ~ExportGames() override;

  void reject() override;

 private:
  void SetUpGames();
  void SetUpForms();

  void Export();
  /// Writes the game on the board.
  void ExportThis(const std::string& path, const ExportChoice& choice);
  void ExportPast(const std::string& path, const ExportChoice& choice,
                  const std::vector<std::int64_t>& games);
  /// The past games that are chosen, the earliest first.
  std::vector<std::int64_t> PastChosen();
  std::string SuggestedName() const;
  ExportChoice Choice() const;
  FileReaders Readers(const ExportChoice& choice) const;
  /// False if there is such a file and the operator wants to keep it.
  bool MayReplace(const std::string& path);
  /// Enables only what has a use for what is chosen.
  void EnableEntries();
  /// While past games are being written, nothing else may be chosen.
  void EnableAll(bool enabled);
  void Tell(const std::string& text);

  const Parts parts_;
  std::unique_ptr<Ui::ExportGames> ui_;
  Commands commands_;
  bool stopped_ = false;
};
