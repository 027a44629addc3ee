#include "platform/qt/QtFileDialog.h"

#include <QAbstractButton>
#include <QDialogButtonBox>
#include <QDir>
#include <QEvent>
#include <QFileDialog>
#include <QFileInfo>
#include <QFileSystemModel>
#include <QGuiApplication>
#include <QLineEdit>
#include <QListView>
#include <QPointer>
#include <QRegularExpression>
#include <QStandardPaths>

namespace {

/// Patterns of one filter; "*.*" means all files, including those without a dot.
QStringList PatternsOf(const QString& text) {
  QStringList patterns;
  for (const QString& pattern : text.split(QLatin1Char(';'), Qt::SkipEmptyParts)) {
    const QString trimmed = pattern.trimmed();
    patterns << (trimmed == QStringLiteral("*.*") ? QStringLiteral("*") : trimmed);
  }
  return patterns;
}

/// Suffix that `nameFilter` adds to a file name typed without one; empty for all files.
QString SuffixOf(const QString& nameFilter) {
  static const QRegularExpression first(QStringLiteral("\\(\\*\\.([^ *?)]+)[^(]*\\)$"));
  return first.match(nameFilter).captured(1);
}

/// The toolkit's dialog, except that it always takes the name that stands in its entry.
class NamingDialog : public QFileDialog {
 public:
  explicit NamingDialog(QWidget* parent) : QFileDialog(parent) {}

  /// To be called once the dialog has its controls.
  void WatchButtons() {
    for (QAbstractButton* button : findChild<QDialogButtonBox*>()->buttons()) {
      button->installEventFilter(this);
    }
  }

 protected:
  // A button that a screen reader presses acts on a timer, which can overtake keys that were typed before.
  bool eventFilter(QObject* watched, QEvent* event) override {
    if (event->type() == QEvent::Timer && qobject_cast<QAbstractButton*>(watched) != nullptr) {
      const QPointer<QObject> button(watched);
      QGuiApplication::sync();
      return button.isNull();
    }
    return QFileDialog::eventFilter(watched, event);
  }

  void accept() override {
    LeaveOtherFile();
    QFileDialog::accept();
  }

 private:
  /// The toolkit prefers the file that is selected in the list, and takes the selection from it only while
  /// the entry has the keyboard's focus.
  void LeaveOtherFile() const {
    const auto* entry = findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
    const auto* list = findChild<QListView*>(QStringLiteral("listView"));
    for (const QModelIndex& row : list->selectionModel()->selectedRows()) {
      const QFileInfo file(row.data(QFileSystemModel::FilePathRole).toString());
      if (!file.isDir() && file.fileName() != entry->text()) {
        list->selectionModel()->clear();
        return;
      }
    }
  }
};

QString StartFolder(const FileRequest& request, const QString& lastFolder) {
  QString folder = QString::fromStdString(request.Folder);
  if (!folder.isEmpty() && QDir(folder).exists()) {
    return folder;
  }
  const QFileInfo file(QString::fromStdString(request.Name));
  if (file.isAbsolute() && file.dir().exists()) {
    return file.absolutePath();
  }
  if (!lastFolder.isEmpty()) {
    return lastFolder;
  }
  const QString documents = QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
  return QDir(documents).exists() ? documents : QDir::homePath();
}

}  // namespace

QStringList NameFilters(const std::string& filter) {
  static const QRegularExpression ownPatterns(QStringLiteral("\\s*\\([^()]*\\)\\s*$"));
  const QStringList parts = QString::fromStdString(filter).split(QLatin1Char('|'));
  QStringList filters;
  for (qsizetype i = 0; i + 1 < parts.size(); i += 2) {
    QString description = parts[i];
    description.remove(ownPatterns);
    const QString patterns = PatternsOf(parts[i + 1]).join(QLatin1Char(' '));
    filters << description.trimmed() + QStringLiteral(" (") + patterns + QLatin1Char(')');
  }
  return filters;
}

std::optional<std::string> QtFileDialog::ShowOpen(const FileRequest& request) {
  return Ask(Wanted::OpenFile, request);
}

std::optional<std::string> QtFileDialog::ShowSave(const FileRequest& request) {
  return Ask(Wanted::SaveFile, request);
}

std::optional<std::string> QtFileDialog::ShowFolder(const FileRequest& request) {
  return Ask(Wanted::Folder, request);
}

std::optional<std::string> QtFileDialog::Ask(Wanted wanted, const FileRequest& request) {
  const bool save = wanted == Wanted::SaveFile;
  const bool folder = wanted == Wanted::Folder;
  // Not on the stack: its parent may be destroyed, and the dialog with it, while it is open.
  const QPointer<NamingDialog> dialog = new NamingDialog(parent_());
  dialog->setObjectName(QStringLiteral("CommonDialog1"));
  dialog->setAcceptMode(save ? QFileDialog::AcceptSave : QFileDialog::AcceptOpen);
  // The caller decides what to do if there is no such file, even when opening.
  dialog->setFileMode(folder ? QFileDialog::Directory : QFileDialog::AnyFile);
  dialog->setOption(QFileDialog::ShowDirsOnly, folder);
  dialog->setOption(QFileDialog::DontUseNativeDialog);
  dialog->setOption(QFileDialog::DontConfirmOverwrite, save);
  if (!request.Title.empty()) {
    dialog->setWindowTitle(QString::fromStdString(request.Title));
  }
  if (!folder) {
    dialog->setNameFilters(NameFilters(request.Filter));
  }
  dialog->setDirectory(StartFolder(request, lastFolder_));
  if (!request.Name.empty()) {
    dialog->selectFile(QFileInfo(QString::fromStdString(request.Name)).fileName());
  }
  if (save) {
    const auto setSuffix = [dialog = dialog.data()](const QString& chosen) {
      dialog->setDefaultSuffix(SuffixOf(chosen));
    };
    setSuffix(dialog->selectedNameFilter());
    QObject::connect(dialog, &QFileDialog::filterSelected, dialog, setSuffix);
  }
  dialog->WatchButtons();
  const bool accepted = dialog->exec() == QDialog::Accepted;
  const QStringList chosen = accepted ? dialog->selectedFiles() : QStringList();
  delete dialog;
  if (chosen.isEmpty()) {
    return std::nullopt;
  }
  lastFolder_ = folder ? chosen.first() : QFileInfo(chosen.first()).absolutePath();
  return chosen.first().toStdString();
}
