#pragma once

#include <QStringList>
#include <QWidget>
#include <functional>
#include <utility>

#include "platform/FileDialog.h"

/// The toolkit's name filters for "description|pattern[|description|pattern...]", with patterns such as
/// "*.bmp;*.jpg". A pattern list at the end of a description is replaced by the pattern's own.
QStringList NameFilters(const std::string& filter);

/// The toolkit's own dialogs, not those of a desktop, which look and behave differently from one to the
/// other. They begin in the folder asked for, else in that of the name, else in the one last chosen from,
/// else in the user's documents.
class QtFileDialog : public FileDialog {
 public:
  /// `parent` tells the window that one opened now belongs to; it may be none.
  explicit QtFileDialog(std::function<QWidget*()> parent) : parent_(std::move(parent)) {}

  std::optional<std::string> ShowOpen(const FileRequest& request) override;
  std::optional<std::string> ShowSave(const FileRequest& request) override;

 private:
  std::optional<std::string> Ask(bool save, const FileRequest& request);

  std::function<QWidget*()> parent_;
  QString lastFolder_;
};
