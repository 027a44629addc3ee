#pragma once

#include <QObject>
#include <array>
#include <string>

#include "core/game/Game.h"
#include "core/text/StringTable.h"

class QLabel;
class QLineEdit;
class QPlainTextEdit;
class QTabBar;

/// What the mission editor says beside its entries while they are typed: the length of the description and
/// what a save would lose of it, and the entries that would be saved as another number than they show.
class ScenarioNotes : public QObject {
 public:
  /// The controls of the window, which outlive this object.
  struct Controls {
    QPlainTextEdit* Description;
    QLabel* DescriptionCount;
    QLabel* DescriptionNote;
    QLineEdit* RespawnPenalty;
    QLabel* RespawnNote;
    QLineEdit* HealPenalty;
    QLabel* HealNote;
    std::array<QLineEdit*, TeamCount> PrimaryPoints;
    QLabel* PrimaryNote;
    std::array<QLineEdit*, TeamCount> SecondaryPoints;
    QLabel* SecondaryNote;
    QTabBar* Tabs;
  };

  ScenarioNotes(const Controls& controls, const StringTable& strings, QObject* parent);

 private:
  void ShowDescription();
  void MarkLostCharacters();
  void ShowPenalty(QLineEdit& entry, QLabel& note);
  void ShowPoints();

  const Controls controls_;
  const StringTable& strings_;
};

/// The contents of a box with CR LF line breaks, as missions have always been stored.
std::string TextIn(const QPlainTextEdit& box);
