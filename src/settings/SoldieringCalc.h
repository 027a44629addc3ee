#pragma once

#include <QDialog>
#include <memory>

#include "core/game/SoldieringFactors.h"
#include "core/text/StringTable.h"

namespace Ui {
class SoldieringCalc;
}

/// Edits the factors of the soldiering score. `SaveExit` stores them in `factors`; nothing is written to the
/// ini file here.
class SoldieringCalc : public QDialog {
  Q_OBJECT

 public:
  SoldieringCalc(SoldieringFactors& factors, const StringTable& strings, QWidget* parent);
  ~SoldieringCalc() override;

 private:
  void SaveAndExit();

  std::unique_ptr<Ui::SoldieringCalc> ui_;
  SoldieringFactors& factors_;
};
