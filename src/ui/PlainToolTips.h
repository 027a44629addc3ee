#pragma once

#include <QObject>

/// As long as it exists, tool tips show their text as it stands. The toolkit would take what looks like
/// markup for markup, and names and descriptions may look like anything. A long text is wrapped, so that it
/// does not leave the screen.
class PlainToolTips : public QObject {
 public:
  /// Needs a QApplication.
  PlainToolTips();

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;
};
