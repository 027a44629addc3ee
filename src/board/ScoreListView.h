#pragma once

#include <QTableView>
#include <vector>

/// A score list on the screen: whole rows, large figures, columns that keep their share of the width as long
/// as their contents fit. When the Tab key reaches it with nothing selected, it selects its current row, so
/// that keyboard commands have a row to act on.
class ScoreListView : public QTableView {
  Q_OBJECT

 public:
  explicit ScoreListView(QWidget* parent = nullptr);

  /// Shares of the list's width, one per column, adding up to 1.
  void SetColumnShares(std::vector<double> shares);

  /// Keeps the height at which `rows` rows and the header are seen without scrolling.
  void ShowWholeRows(int rows);

  void reset() override;

 protected:
  void resizeEvent(QResizeEvent* event) override;
  void paintEvent(QPaintEvent* event) override;
  void focusInEvent(QFocusEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;

 private:
  int ColumnCount() const { return static_cast<int>(shares_.size()); }
  void ShareWidth();
  /// Makes the captions smaller where they do not fit into their shares.
  void FitCaptions();
  /// True if captions in this font fit into their shares of `room` pixels.
  bool CaptionsFit(const QFont& captions, int room) const;
  void KeepHeight();
  /// Width at which nothing in the column is cut, its header included.
  int NeededWidth(int column) const;

  std::vector<double> shares_;
  int wholeRows_ = 0;  ///< 0: the layout chooses the height
};
