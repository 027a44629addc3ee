#pragma once

#include <QStringList>
#include <QTableView>

/// The list of sound events. Double click and Return activate a row; files dropped on a row are told.
class SoundListView : public QTableView {
  Q_OBJECT

 public:
  explicit SoundListView(QWidget* parent = nullptr);

  /// Row of the selection, counted from 0; -1 without rows.
  int SelectedRow() const;
  /// Selects a row and scrolls it into view.
  void SelectRow(int row);

 signals:
  void RowActivated(int row);
  /// Full paths of local files. Emitted once the drop is over, so that a box may be opened.
  void FilesDropped(int row, const QStringList& paths);

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  void resizeEvent(QResizeEvent* event) override;
  void dragEnterEvent(QDragEnterEvent* event) override;
  void dragMoveEvent(QDragMoveEvent* event) override;
  void dropEvent(QDropEvent* event) override;

 private:
  void ShareWidth();
};
