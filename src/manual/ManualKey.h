#pragma once

#include <QObject>
#include <memory>

#include "core/text/StringTable.h"
#include "manual/ManualWindow.h"

/// Opens the manual at the window in front when F1 is pressed in any window of the program.
class ManualKey : public QObject {
 public:
  /// `folder` holds the manual. `mainWindow` stands for the window in front where there is none; it and
  /// `strings` must outlive this object.
  ManualKey(const StringTable& strings, QString folder, const QWidget& mainWindow);

  /// Opens the manual as the key does.
  void Open();
  /// Opens it at the page of this title.
  void OpenPage(const QString& title);

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  ManualWindow& Window();

  const StringTable& strings_;
  const QString folder_;
  const QWidget& mainWindow_;
  std::unique_ptr<ManualWindow> window_;  ///< once opened
};
