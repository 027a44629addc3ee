#pragma once

#include <QStyledItemDelegate>
#include <QTableView>
#include <vector>

// The board as it was before its letters grew with the window: what the board of today is measured by.

/// A list whose columns keep their share of the width as long as their contents fit.
class FormerView : public QTableView {
 public:
  explicit FormerView(QWidget* parent = nullptr);

  /// Shares of the list's width, one per column, adding up to 1.
  void SetColumnShares(std::vector<double> shares);

  /// Keeps the height at which `rows` rows and the header are seen without scrolling.
  void ShowWholeRows(int rows);

  void reset() override;

 protected:
  void resizeEvent(QResizeEvent* event) override;

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

/// Shows a player with the member's name in small letters below.
class FormerDelegate : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override;

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override;
};
