#pragma once

#include <string>
#include <vector>

#include "sheets/SheetProgress.h"

/// Records what a run shows, in order: "Open", "1 of 3 Red 0-Guest", "Close".
class FakeSheetProgress : public SheetProgress {
 public:
  std::vector<std::string> Log;
  int StopAtSheet = 0;  ///< the operator stops the run when this sheet is shown; 0 for never

  void Open() override { Log.emplace_back("Open"); }
  void ShowSheet(int number, int count, const std::string& name) override {
    Log.push_back(std::to_string(number) + " of " + std::to_string(count) + " " + name);
    stopped_ = stopped_ || number == StopAtSheet;
  }
  bool Stopped() const override { return stopped_; }
  void Stop() { stopped_ = true; }
  void Close() override { Log.emplace_back("Close"); }

 private:
  bool stopped_ = false;
};
