#pragma once

#include <QPointer>
#include <QStringList>
#include <QWidget>

#include "platform/FileDialog.h"

/// The toolkit's name filters for "description|pattern[|description|pattern...]", with patterns such as
/// "*.bmp;*.jpg". A pattern list at the end of a description is replaced by the pattern's own.
QStringList NameFilters(const std::string& filter);

/// The toolkit's own dialogs, not those of a desktop, which look and behave differently from one to the
/// other. They begin in the folder asked for, else in that of the name, else in the one last chosen from,
/// else in the user's documents.
class QtFileDialog : public FileDialog {
 public:
  /// Window that dialogs belong to while no window of the program is active.
  void SetMainWindow(QWidget* mainWindow) { mainWindow_ = mainWindow; }

  std::optional<std::string> ShowOpen(const FileRequest& request) override;
  std::optional<std::string> ShowSave(const FileRequest& request) override;

 private:
  std::optional<std::string> Ask(bool save, const FileRequest& request);

  QPointer<QWidget> mainWindow_;
  QString lastFolder_;
};
