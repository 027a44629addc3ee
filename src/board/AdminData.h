#pragma once

#include <QDialog>
#include <memory>

#include "core/game/Game.h"
#include "core/text/StringTable.h"

namespace Ui {
class AdminData;
}

/// Run time and admin kills of all guns.
class AdminData : public QDialog {
  Q_OBJECT

 public:
  AdminData(const Game& game, const StringTable& strings, QWidget* parent);
  ~AdminData() override;

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void ShowPlayers(const Game& game);
  /// Copies the selected rows, or all if none is selected, to the clipboard as tab-separated text, headers
  /// first.
  void Copy() const;

  std::unique_ptr<Ui::AdminData> ui_;
};
