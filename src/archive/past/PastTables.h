#pragma once

#include <functional>

class QAbstractItemView;
class QTableView;

/// The looks of the window's tables, once they have their models.
void SetUpMonthTable(QTableView& table);
void SetUpGameTable(QTableView& table);
void SetUpBoardTable(QTableView& table);

/// Ctrl+C runs `copy`.
void OnCopyKey(QAbstractItemView& list, std::function<void()> copy);
