#pragma once

#include <string>
#include <vector>

#include "devices/baseunit/BaseUnitDownload.h"

/// Records what a download shows, in order: "Open", "Status Requesting Data...", "Maximum 3", "Progress 1",
/// "Animate", "Close".
class FakeDownloadProgress : public DownloadProgress {
 public:
  std::vector<std::string> Log;
  bool Closed = false;  ///< set by a test: the operator closed the window

  void Open() override { Log.emplace_back("Open"); }
  void Close() override { Log.emplace_back("Close"); }
  bool ClosedByOperator() const override { return Closed; }
  void SetStatusText(const std::string& text) override { Log.push_back("Status " + text); }
  void SetMaximum(int maximum) override { Log.push_back("Maximum " + std::to_string(maximum)); }
  void SetProgress(int value) override { Log.push_back("Progress " + std::to_string(value)); }
  void StartTransferAnim() override { Log.emplace_back("Animate"); }
};
