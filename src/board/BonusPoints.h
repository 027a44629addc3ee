#pragma once

#include <QDialog>
#include <cstdint>
#include <memory>
#include <string>

#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

namespace Ui {
class BonusPoints;
}

/// Asks for a player's extra soldiering points.
class BonusPoints : public QDialog {
  Q_OBJECT

 public:
  /// `player` is named in the window where it is not empty.
  BonusPoints(std::int32_t value, MessageBoxes& boxes, QWidget* parent, const std::string& player = {});
  ~BonusPoints() override;

  /// The value passed in or, after OK, the one entered: the leading number of the text, 0 if there is none.
  std::int32_t Value() const { return value_; }

 private:
  void TakeValue();

  std::unique_ptr<Ui::BonusPoints> ui_;
  std::int32_t value_;
  Commands commands_;
};
