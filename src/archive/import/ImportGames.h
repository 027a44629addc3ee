#pragma once

#include <QDialog>
#include <chrono>
#include <memory>
#include <optional>
#include <string>

#include "archive/ArchiveAccess.h"
#include "archive/import/GameImport.h"
#include "archive/import/RefusedFilesModel.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/MessageBoxes.h"
#include "platform/MonotonicClock.h"
#include "ui/Commands.h"

namespace Ui {
class ImportGames;
}

/// Imports a folder of game files into the archive, and lists which files were refused and why.
class ImportGames : public QDialog {
  Q_OBJECT

 public:
  /// All must outlive the window.
  struct Parts {
    ArchiveAccess& Archives;
    Database& Members;
    Files& Disk;
    FileDialog& CommonDialog1;
    MessageBoxes& Boxes;
    EventPump& Events;
    const MonotonicClock& Elapsed;
    const Clock& Time;
    const StringTable& Strings;
    SoldieringFactors Factors;
    std::string UserDataFolder;
  };

  ImportGames(const Parts& parts, QWidget* parent);
  ~ImportGames() override;

  /// True once a game was imported or brought back.
  bool HasImported() const { return hasImported_; }

  void reject() override;

 private:
  void SetUpTable();
  void ChooseFolder();
  void Import();
  /// Imports from the folder and shows how it ended.
  void ImportFrom(const std::string& folder);
  void EnableEntries(bool enabled);
  void ShowStep(const GameImport::State& state);
  void ShowTimeLeft(const GameImport::State& state);
  /// `import` is none if it could not begin, `failure` empty if nothing failed.
  void ShowEnd(const std::optional<GameImport>& import, bool complete, const std::string& failure);
  void ShowStatus(const std::string& text);

  const Parts parts_;
  std::unique_ptr<Ui::ImportGames> ui_;
  RefusedFilesModel refused_;
  Commands commands_;
  std::chrono::microseconds begun_{0};  ///< when the first file was begun
  bool stopped_ = false;
  bool hasImported_ = false;
};
