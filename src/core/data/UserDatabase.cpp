#include "core/data/UserDatabase.h"

#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

constexpr int UnrecognizedFormat = 3343;
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
                      const DatabaseServices& services) {
  std::string text = Filled(services.Strings.Text(OwnText::OldDatabaseConverted),
                            {database.Path, std::to_string(report.Rows), report.KeptAs});
  if (!report.NotTaken.empty()) {
    text += "\n\n" + services.Strings.Text(OwnText::NotTakenOver);
    for (const NotTakenOver& what : report.NotTaken) {
      text += "\n" + TextOf(what, services.Strings);
    }
  }
  services.Boxes.Show(text, Title, BoxIcon::Information);
}

std::unique_ptr<Database> Open(const std::string& path, const DatabaseServices& services) {
  std::unique_ptr<Database> database = services.Engine.OpenDatabase(path);
  services.Copies.Guard(*database, path);
  return database;
}

std::string FreshPath(const std::string& path) {
  const std::string extension = ".mdb";
  return path.substr(0, path.size() - extension.size()) + "-new" + extension;
}

}  // namespace

std::unique_ptr<Database> OpenUserDatabase(const UserDatabase& database, const DatabaseServices& services) {
  std::string reason;
  try {
    if (services.Old.IsOld(database.Path)) {
      TellOfConversion(database, services.Old.Convert(database.Path, database.Table, database.DefaultPath),
                       services);
    }
    return Open(database.Path, services);
  } catch (const RuntimeError& error) {
    if (error.Number() != UnrecognizedFormat) {
      throw;
    }
    reason = error.what();
  }
  const std::string fresh = FreshPath(database.Path);
  const BoxAnswer answer = services.Boxes.Show(
      Filled(services.Strings.Text(OwnText::DatabaseUnusable), {database.Path, reason, fresh}), Title,
      BoxIcon::Exclamation, BoxButtons::OkCancel);
  if (answer == BoxAnswer::Cancel) {
    return nullptr;
  }
  if (!services.Disk.FileExists(fresh)) {
    services.Disk.Replace(fresh, services.Disk.Read(database.DefaultPath));
  }
  return Open(fresh, services);
}
