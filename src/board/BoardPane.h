#pragma once

#include <QWidget>

class QBoxLayout;
class ScoreListView;

/// The part of the window that holds both score lists. It gives them the largest letters with which twelve
/// rows fill the height and nothing but names is cut; with more rows smaller ones, down to the smallest. On a
/// wide screen the list of teams stands beside that of the players.
class BoardPane : public QWidget {
  Q_OBJECT

 public:
  using QWidget::QWidget;

  /// `parts` is the pane's layout, which holds one column of label and list for the players and one for the
  /// teams.
  void SetLists(ScoreListView& players, ScoreListView& teams, QBoxLayout& parts);

  /// The operator's wish in percent of the size that the board would choose.
  int Letters() const { return letters_; }
  void SetLetters(int percent);
  /// The next size in this direction that looks different.
  void MakeLettersLarger();
  void MakeLettersSmaller();
  void MakeLettersUsual();

 signals:
  void LettersChosen();

 protected:
  void resizeEvent(QResizeEvent* event) override;

 private:
  struct Size {
    double Growth;
    int RowHeight;
    bool operator==(const Size&) const = default;
  };
  void Arrange();
  void ShowTeamsBeside(bool beside);
  /// Height for the rows of the list or lists that share it.
  int RoomForRows(bool beside) const;
  Size ChosenSize(bool beside, int percent) const;
  /// Width for all columns, with rows of that height.
  double RoomAcross(bool beside, int rowHeight) const;
  /// Rows of which the height is to be filled.
  int RowsToShow(bool beside) const;
  void LimitTeams();
  void Choose(int percent);

  ScoreListView* players_ = nullptr;
  ScoreListView* teams_ = nullptr;
  QBoxLayout* parts_ = nullptr;
  bool beside_ = false;
  int letters_ = 100;
};
