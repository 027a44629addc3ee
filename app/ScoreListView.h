#pragma once

#include <QTableView>
#include <vector>

/// A score list on the screen: whole rows, large figures, columns that keep their share of the width.
class ScoreListView : public QTableView {
  Q_OBJECT

 public:
  explicit ScoreListView(QWidget* parent = nullptr);

  /// Shares of the list's width, one for each column, together 1.
  void SetColumnShares(std::vector<double> shares);

  /// Height that shows `rows` rows and the header without scrolling, in pixels.
  int HeightForRows(int rows) const;

 protected:
  void resizeEvent(QResizeEvent* event) override;
  void paintEvent(QPaintEvent* event) override;

 private:
  void ShareWidth();

  std::vector<double> shares_;
};
