#pragma once

#include <QTableView>
#include <vector>

/// A score list on the screen: whole rows, large figures, columns that keep their share of the width. When
/// the Tab key reaches it with nothing selected, it selects its current row, so that keyboard commands have a
/// row to act on.
class ScoreListView : public QTableView {
  Q_OBJECT

 public:
  explicit ScoreListView(QWidget* parent = nullptr);

  /// Shares of the list's width, one per column, adding up to 1.
  void SetColumnShares(std::vector<double> shares);

  /// Height that shows `rows` rows and the header without scrolling, in pixels.
  int HeightForRows(int rows) const;

 protected:
  void resizeEvent(QResizeEvent* event) override;
  void paintEvent(QPaintEvent* event) override;
  void focusInEvent(QFocusEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;

 private:
  void ShareWidth();

  std::vector<double> shares_;
};
