#pragma once

#include <QStringList>
#include <QTableWidget>

/// A list of what was done, the newest row at the top. Rows of failures are tinted.
class ResultList : public QTableWidget {
  Q_OBJECT

 public:
  explicit ResultList(QWidget* parent = nullptr);

  /// Must be called before the first row is added. Column `widest` takes the room that is left.
  void SetCaptions(const QStringList& captions, int widest);

  /// Adds a row at the top and makes it the current one, but selects none. Keeps at most `most` rows.
  void AddRow(const QStringList& cells, bool success, int most);
};
