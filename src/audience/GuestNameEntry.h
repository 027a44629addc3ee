#pragma once

#include <QDialog>
#include <map>
#include <memory>

#include "core/game/Game.h"
#include "core/game/GuestList.h"
#include "core/text/StringTable.h"

class QLineEdit;

namespace Ui {
class GuestNameEntry;
}

/// Names the players who have no membership: an entry for each active gun without a member.
class GuestNameEntry : public QDialog {
  Q_OBJECT

 public:
  GuestNameEntry(const Game& game, const GuestList& guests, const StringTable& strings, QWidget* parent);
  ~GuestNameEntry() override;

  /// The names that the guns have now: those typed, and those that guns without an entry had before.
  GuestList::Names Names() const;

 private:
  void AddEntry(int index, const std::string& gun);

  std::unique_ptr<Ui::GuestNameEntry> ui_;
  const GuestList& guests_;
  std::map<int, QLineEdit*> entries_;  ///< by the gun's record
};
