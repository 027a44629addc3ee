#pragma once

#include <QElapsedTimer>
#include <QProgressDialog>
#include <chrono>
#include <memory>

#include "core/text/StringTable.h"
#include "platform/jet/JetConverter.h"

/// Converts old databases, and shows in a window how far it is where that takes more than a moment.
class ConversionWithProgress : public OldDatabases {
 public:
  /// `moment` is the time after which the window comes up, and from one text in it to the next.
  explicit ConversionWithProgress(const StringTable& strings,
                                  std::chrono::milliseconds moment = std::chrono::milliseconds(90),
                                  const std::string& reader = JetReaderPath());

  bool IsOld(const std::string& path) const override { return converter_.IsOld(path); }
  OldDatabaseReport Convert(const std::string& path, const std::string& table,
                            const std::string& emptyDatabase) override;

 private:
  void ShowRows(std::int64_t rows);

  const StringTable& strings_;
  JetConverter converter_;
  std::chrono::milliseconds moment_;
  QString file_;  ///< that is being converted, without its folder
  QElapsedTimer sinceShown_;
  std::unique_ptr<QProgressDialog> window_;  ///< once it took more than a moment
};
