#pragma once

#include <string>
#include <vector>

#include "core/data/IniReader.h"

/// What the program remembers of the board from one run to the next, in its file of places and sizes. What
/// cannot be read counts as not there, and a failure to write is silent.
class BoardState {
 public:
  /// `state` must outlive this.
  explicit BoardState(IniReader& state) : state_(state) {}

  /// Percent of the usual size of the letters.
  int Letters() const;
  void SetLetters(int percent);

  /// Shares of the columns of a list in its width; empty where the operator has not dragged any.
  std::vector<double> ColumnShares(const std::string& list) const;
  void SetColumnShares(const std::string& list, const std::vector<double>& shares);

 private:
  IniReader& state_;
};
