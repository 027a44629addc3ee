#pragma once

#include <QDialog>
#include <memory>
#include <string>

#include "core/text/StringTable.h"
#include "exports/GameExport.h"
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
  struct Parts {
    ExportedGames Games;
    bool HasGames;              ///< false where there is nothing to export
    std::string SuggestedName;  ///< of the files, without folder and ending
    FileDialog& CommonDialog1;
    Files& Disk;
    MessageBoxes& Boxes;
    const StringTable& Strings;
  };

  ExportGames(const Parts& parts, QWidget* parent);
  ~ExportGames() override;

  void reject() override;

 private:
  void Export();
  ExportChoice Choice() const;
  /// False if there is such a file and the operator wants to keep it.
  bool MayReplace(const std::string& path);
  /// Enables only what the chosen format has use for.
  void EnableEntries();
  void Tell(const std::string& text);

  const Parts parts_;
  std::unique_ptr<Ui::ExportGames> ui_;
  Commands commands_;
};
