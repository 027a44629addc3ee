#pragma once

#include <QStringList>
#include <QWidget>
#include <functional>
#include <utility>

#include "platform/FileDialog.h"

/// The toolkit's name filters for "description|pattern[|description|pattern...]", with patterns such as
/// "*.bmp;*.jpg". A pattern list at the end of a description is replaced by the pattern's own.
QStringList NameFilters(const std::string& filter);

/// Opens in the folder of the file name handed in, else in the folder last chosen from, else in the user's
/// documents.
class QtFileDialog : public FileDialog {
 public:
  /// `parent` tells the window that one opened now belongs to; it may be none.
  explicit QtFileDialog(std::function<QWidget*()> parent) : parent_(std::move(parent)) {}

  std::string ShowOpen(const std::string& filter, const std::string& fileName) override;
  std::string ShowSave(const std::string& filter, const std::string& fileName) override;

 private:
  std::string Ask(bool save, const std::string& filter, const std::string& fileName);

  std::function<QWidget*()> parent_;
  QString lastFolder_;
};
