#pragma once

#include <QDialog>
#include <memory>
#include <optional>

#include "core/text/StringTable.h"
#include "sheets/SheetProgress.h"
#include "ui/WaitCursor.h"

namespace Ui {
class SheetProgressWindow;
}

/// The small window shown during a run of score sheets. Its Stop button and its close box stop the run after
/// the current sheet, and the window and the hourglass stay until then; Escape does nothing.
class SheetProgressWindow : public QDialog, public SheetProgress {
  Q_OBJECT

 public:
  SheetProgressWindow(const StringTable& strings, QWidget* parent);
  ~SheetProgressWindow() override;

  void Open() override;
  void ShowSheet(int number, int count, const std::string& name) override;
  bool Stopped() const override { return stopped_; }
  void Close() override;

  void reject() override;

 protected:
  void keyPressEvent(QKeyEvent* event) override;

 private:
  std::unique_ptr<Ui::SheetProgressWindow> ui_;
  const StringTable& strings_;
  bool stopped_ = false;
  std::optional<WaitCursor> cursor_;
};
