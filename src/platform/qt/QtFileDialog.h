#pragma once

#include <QStringList>
#include <QWidget>
#include <functional>
#include <utility>

#include "platform/FileDialog.h"

/// The toolkit's name filters for "description|pattern[|description|pattern...]", with patterns such as
/// "*.bmp;*.jpg". A pattern list at the end of a description is replaced by the actual pattern.
QStringList NameFilters(const std::string& filter);

/// The toolkit's own dialogs, since those of desktops each look and behave differently. They start in the
/// requested folder, else in that of the name, else in that of the last choice, else in the user's documents.
class QtFileDialog : public FileDialog {
 public:
  /// `parent` returns the parent window for a dialog opened now, or null.
  explicit QtFileDialog(std::function<QWidget*()> parent) : parent_(std::move(parent)) {}

  std::optional<std::string> ShowOpen(const FileRequest& request) override;
  std::optional<std::string> ShowSave(const FileRequest& request) override;
  std::optional<std::string> ShowFolder(const FileRequest& request) override;

 private:
  enum class Wanted { OpenFile, SaveFile, Folder };

  std::optional<std::string> Ask(Wanted wanted, const FileRequest& request);

  std::function<QWidget*()> parent_;
  QString lastFolder_;
};
