#pragma once

#include <QElapsedTimer>
#include <QProgressDialog>
#include <chrono>
#include <memory>

#include "core/text/StringTable.h"
#include "platform/jet/JetConverter.h"

/// Converts old databases, and shows the progress in a window if that takes more than a moment, unless
/// another window shows it.
class ConversionWithProgress : public OldDatabases {
 public:
  /// `moment` is the time until the window appears, and between updates of its text.
  explicit ConversionWithProgress(const StringTable& strings, Files& disk,
                                  std::chrono::milliseconds moment = std::chrono::milliseconds(90),
                                  const std::string& reader = JetReaderPath());

  bool IsOld(const std::string& path) const override { return converter_.IsOld(path); }
  OldDatabaseReport Convert(const OldDatabase& old, ConversionSteps& steps) override;

 private:
  void ShowRows(std::int64_t rows);

  const StringTable& strings_;
  JetConverter converter_;
  std::chrono::milliseconds moment_;
  QString file_;  ///< being converted, without its folder
  bool isShownElsewhere_ = false;
  QElapsedTimer sinceShown_;
  std::unique_ptr<QProgressDialog> window_;  ///< set once it has taken more than a moment
};
