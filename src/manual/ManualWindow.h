#pragma once

#include <QUrl>
#include <QWidget>
#include <memory>
#include <vector>

#include "core/text/StringTable.h"
#include "manual/ManualPages.h"

namespace Ui {
class ManualWindow;
}

/// The operator's manual in the language of the texts, a page at a time, with its pictures. It stands beside
/// the other windows and can be read while any of them is open, also one that must be answered first.
class ManualWindow : public QWidget {
  Q_OBJECT

 public:
  /// `folder` holds the editions and their pictures.
  ManualWindow(const StringTable& strings, const QString& folder);
  ~ManualWindow() override;

  /// Shows the page about `window`, or about the nearest of its parents that has one, in front of it.
  void ShowPageOf(const QWidget& window);

  /// Shows the page of this title; the first one if there is none.
  void ShowPageTitled(const QString& title);

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void ShowPage(int page);
  void ShowInFront(std::size_t page);
  void FollowLink(const QUrl& link);
  /// A window that must be answered first blocks all others but those that belong to it.
  void BelongToModalWindow();

  std::unique_ptr<Ui::ManualWindow> ui_;
  const QString folder_;
  const std::vector<ManualPage> pages_;
};
