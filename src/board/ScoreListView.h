#pragma once

#include <QTableView>
#include <optional>
#include <vector>

#include "board/ColumnContents.h"

class ScoreListHeader;

/// A score list on the screen: whole rows, large figures, columns that keep their share of the width as long
/// as their contents fit or as the operator has dragged them. Selected rows stay selected, and the current
/// one in view, when the rows get another order or are calculated anew. When the Tab key reaches it with
/// nothing selected, it selects its current row, so that keyboard commands have a row to act on.
class ScoreListView : public QTableView {
  Q_OBJECT

 public:
  explicit ScoreListView(QWidget* parent = nullptr);

  void setModel(QAbstractItemModel* model) override;

  /// Shares of the list's width, one per column, adding up to 1.
  void SetColumnShares(std::vector<double> shares);

  /// The shares that the operator has given the columns, none if they have their own. Of a wrong number, or
  /// with one that is not above 0, they are ignored.
  const std::vector<double>& DraggedShares() const { return draggedShares_; }
  void SetDraggedShares(std::vector<double> shares);

  /// Keeps the height at which `rows` rows and the header are seen without scrolling.
  void ShowWholeRows(int rows);

  /// How much larger the letters are than the smallest, and how high the rows.
  void SetLetters(double growth, int rowHeight);
  double Growth() const { return growth_; }
  /// Size of a gun's name above the name of its member, relative to the letters.
  double SizeOfGuns() const { return gunSize_; }

  /// Size of the smallest letters in pixels, height of their capitals and of their rows.
  int LeastLetters() const { return leastLetters_; }
  double LeastCapitals() const { return leastCapitals_; }
  int LeastRow() const { return leastRow_; }

  /// Height of the largest captions, relative to the smallest letters. The header has room for them.
  void SetLargestCaptions(double size);
  /// Height of header and frame.
  int HeightWithoutRows() const;

  /// Whether there is room for the members' names or only for their guns.
  enum class Names { Whole, Cut };
  enum class Captions { Largest, Smallest };
  /// Width that the list needs in letters of that growth, nearly exact.
  double WidthAt(double growth, Names names, Captions captions) const;

  /// Width that the list needs in its present letters with the largest captions, each column its own or all
  /// that of the widest.
  enum class Columns { Own, Equal };
  int FittingWidth(Columns columns) const;

  /// Selects the row with this key, and no other.
  void SelectKey(int key);
  /// The selection ends, also that of rows that are not there at the moment.
  void ForgetSelection();

  void reset() override;

 signals:
  /// The operator wants to see more of the selected row: by a double click or the Return key.
  void RowChosen();
  /// The operator has dragged columns to other widths.
  void WidthsDragged();

 protected:
  void resizeEvent(QResizeEvent* event) override;
  void paintEvent(QPaintEvent* event) override;
  void focusInEvent(QFocusEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void mousePressEvent(QMouseEvent* event) override;
  void mouseDoubleClickEvent(QMouseEvent* event) override;
  void selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) override;
  void currentChanged(const QModelIndex& current, const QModelIndex& previous) override;

 private:
  int ColumnCount() const { return static_cast<int>(shares_.size()); }
  void ShareWidth();
  void TakeDraggedWidths();
  /// Makes the captions smaller where they do not fit into their shares or take room that figures need.
  void FitCaptions();
  /// True if captions in this font fit into their shares of `room` pixels.
  bool CaptionsFit(const QFont& captions, int room) const;
  void KeepHeight();
  void SetRowHeight(int height);
  QString SomeLetters() const { return model()->headerData(0, Qt::Horizontal).toString(); }
  void MeasureTexts();
  /// Width at which nothing in the column is cut, its caption of this width included. Names of members may be
  /// cut.
  int NeededWidth(int column, int caption) const;
  /// Width at which all names are whole, for a column that has too little room for names in large letters
  /// with this share; 0 for any other.
  int WantedWidth(int column, double share) const;
  /// What the cells of a column need beside their texts.
  int Margins(int column, double growth) const;
  double FigureWidthAt(int column, double growth, Names names) const;
  void Remember();
  void RestoreSelection();
  int KeyAt(int row) const;

  ScoreListHeader* header_;
  std::vector<double> shares_;
  std::vector<double> draggedShares_;
  int wholeRows_ = 0;  ///< 0: the layout chooses the height
  QFont leastFont_;
  int leastLetters_ = 0;
  double leastCapitals_ = 0;
  int leastRow_ = 0;
  double growth_ = 1;
  double gunSize_ = 1;
  double largestCaptions_;

  ColumnContents contents_;
  std::vector<int> selectedKeys_;
  std::optional<int> currentKey_;
  int currentColumn_ = 0;
};
