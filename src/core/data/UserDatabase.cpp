#include "core/data/UserDatabase.h"

#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

constexpr const char* Title = "Database status";

std::string TextOf(const NotTakenOver& what, const StringTable& strings) {
  switch (what.What) {
    case NotTakenOver::Table:
      return Filled(strings.Text(OwnText::TableNotTakenOver), {what.Name, std::to_string(what.Rows)});
    case NotTakenOver::Column:
      return Filled(strings.Text(OwnText::ColumnNotTakenOver), {what.Name});
    case NotTakenOver::TextsOfColumn:
      break;
  }
  return Filled(strings.Text(OwnText::TextsNotTakenOver), {what.Name});
}

void TellOfConversion(const UserDatabase& database, const OldDatabaseReport& report,
                      const DatabaseParts& parts) {
  std::string text = Filled(parts.Strings.Text(OwnText::OldDatabaseConverted),
                            {database.Path, std::to_string(report.Rows), report.KeptAs});
  if (!report.NotTaken.empty()) {
    text += "\n\n" + parts.Strings.Text(OwnText::NotTakenOver);
    for (const NotTakenOver& what : report.NotTaken) {
      text += "\n" + TextOf(what, parts.Strings);
    }
  }
  parts.Boxes.Show(text, Title, BoxIcon::Information);
}

std::unique_ptr<Database> Open(const std::string& path, const DatabaseParts& parts) {
  std::unique_ptr<Database> database = parts.Engine.OpenDatabase(path);
  parts.Copies.Guard(*database, path);
  return database;
}

std::string FreshPath(const std::string& path) {
  const std::string extension = ".mdb";
  return path.substr(0, path.size() - extension.size()) + "-new" + extension;
}

}  // namespace

std::unique_ptr<Database> OpenUserDatabase(const UserDatabase& database, const DatabaseParts& parts) {
  std::string reason;
  try {
    if (parts.Old.IsOld(database.Path)) {
      TellOfConversion(database, parts.Old.Convert(database.Path, database.Table, database.DefaultPath),
                       parts);
    }
    return Open(database.Path, parts);
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::UnrecognizedDatabase) {
      throw;
    }
    reason = error.what();
  }
  const std::string fresh = FreshPath(database.Path);
  const BoxAnswer answer =
      parts.Boxes.Show(Filled(parts.Strings.Text(OwnText::DatabaseUnusable), {database.Path, reason, fresh}),
                       Title, BoxIcon::Exclamation, BoxButtons::OkCancel);
  if (answer == BoxAnswer::Cancel) {
    return nullptr;
  }
  if (!parts.Disk.FileExists(fresh)) {
    parts.Disk.Replace(fresh, parts.Disk.Read(database.DefaultPath));
  }
  return Open(fresh, parts);
}
