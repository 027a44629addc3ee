#pragma once

class QAbstractItemView;
class QTableView;

/// The looks of the window's tables, once they have their models.
void SetUpMonthTable(QTableView& table);
void SetUpGameTable(QTableView& table);
void SetUpBoardTable(QTableView& table);

/// Ctrl+C copies the selected rows as text.
void CopiesRows(QAbstractItemView& list);
