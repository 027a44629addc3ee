#include "platform/qt/QtFileDialog.h"

#include <QDir>
#include <QFileDialog>
#include <QFileInfo>
#include <QPointer>
#include <QRegularExpression>
#include <QStandardPaths>

namespace {

/// Patterns of one filter; "*.*" stands for all files, also those without a dot.
QStringList PatternsOf(const QString& text) {
  QStringList patterns;
  for (const QString& pattern : text.split(QLatin1Char(';'), Qt::SkipEmptyParts)) {
    const QString trimmed = pattern.trimmed();
    patterns << (trimmed == QStringLiteral("*.*") ? QStringLiteral("*") : trimmed);
  }
  return patterns;
}

/// Suffix that a file name typed without one gets under `nameFilter`; empty for all files.
QString SuffixOf(const QString& nameFilter) {
  static const QRegularExpression first(QStringLiteral("\\(\\*\\.([^ *?)]+)[^(]*\\)$"));
  return first.match(nameFilter).captured(1);
}

QString StartFolder(const QString& fileName, const QString& lastFolder) {
  const QFileInfo file(fileName);
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

std::string QtFileDialog::ShowOpen(const std::string& filter, const std::string& fileName) {
  return Ask(false, filter, fileName);
}

std::string QtFileDialog::ShowSave(const std::string& filter, const std::string& fileName) {
  return Ask(true, filter, fileName);
}

std::string QtFileDialog::Ask(bool save, const std::string& filter, const std::string& fileName) {
  const QString name = QString::fromStdString(fileName);
  // Not on the stack: its parent may be destroyed, and the dialog with it, while it is open.
  const QPointer<QFileDialog> dialog = new QFileDialog(parent_());
  dialog->setObjectName(QStringLiteral("CommonDialog1"));
  dialog->setAcceptMode(save ? QFileDialog::AcceptSave : QFileDialog::AcceptOpen);
  // A name without a file is for the caller to judge, also when opening.
  dialog->setFileMode(QFileDialog::AnyFile);
  dialog->setOption(QFileDialog::DontConfirmOverwrite, save);
  dialog->setNameFilters(NameFilters(filter));
  dialog->setDirectory(StartFolder(name, lastFolder_));
  if (!name.isEmpty()) {
    dialog->selectFile(QFileInfo(name).fileName());
  }
  if (save) {
    const auto setSuffix = [dialog = dialog.data()](const QString& chosen) {
      dialog->setDefaultSuffix(SuffixOf(chosen));
    };
    setSuffix(dialog->selectedNameFilter());
    QObject::connect(dialog, &QFileDialog::filterSelected, dialog, setSuffix);
  }
  const bool accepted = dialog->exec() == QDialog::Accepted;
  const QStringList chosen = accepted ? dialog->selectedFiles() : QStringList();
  delete dialog;
  if (chosen.isEmpty()) {
    return fileName;
  }
  lastFolder_ = QFileInfo(chosen.first()).absolutePath();
  return chosen.first().toStdString();
}
