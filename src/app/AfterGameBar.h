#pragma once

#include <QFrame>
#include <array>

#include "core/game/GameProgress.h"
#include "core/text/StringTable.h"

class QAction;
class QToolButton;

/// The steps after a game as buttons, in the order in which one takes them, with a tick once done. Each
/// presses its menu item and is enabled exactly when that is. Where the captions do not fit there are signs
/// alone.
class AfterGameBar : public QFrame {
 public:
  explicit AfterGameBar(QWidget* parent = nullptr);

  /// Adds a button for each step that presses its item, in the order of GameStep. Both must outlive the bar.
  void SetUp(const StringTable& strings, const std::array<QAction*, GameStepCount>& items);

  void SetDone(GameStep step, bool done);

  /// The button of a step.
  QToolButton& Button(GameStep step) const { return *steps_[static_cast<std::size_t>(step)].Button; }

  /// A widget at the right end, shown while it is wanted and has room beside the captions. The bar owns it.
  void SetEnd(QWidget* end);
  void SetEndWanted(bool isWanted);

  QSize minimumSizeHint() const override;

 protected:
  void resizeEvent(QResizeEvent* event) override;
  void changeEvent(QEvent* event) override;

 private:
  struct Step {
    QToolButton* Button = nullptr;
    QAction* Item = nullptr;
    bool IsDone = false;
  };

  void ShowStep(GameStep step);
  /// Shows captions, or signs alone where they do not fit.
  void FitCaptions();
  /// Width of the bar with captions or with signs alone.
  int NeededWidth(bool captions) const;
  void ShowEnd();

  const StringTable* strings_ = nullptr;
  std::array<Step, GameStepCount> steps_{};
  QWidget* end_ = nullptr;
  bool isEndWanted_ = false;
};
