#include "core/data/OldConversion.h"

#include <algorithm>
#include <string>
#include <vector>

#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

/// As many entries as a box holds on any screen.
constexpr std::size_t MostEntries = 10;

std::string TextOf(const NotTakenOver& what, const StringTable& strings) {
  switch (what.What) {
    case NotTakenOver::Table:
      return Filled(strings.Text(OwnText::TableNotTakenOver), {what.Name, std::to_string(what.Rows)});
    case NotTakenOver::TableRows:
      return Filled(strings.Text(OwnText::TableNotTakenOver),
                    {what.Name, std::to_string(what.Rows) + "/" + std::to_string(what.Counted)});
    case NotTakenOver::Column:
      return Filled(strings.Text(OwnText::ColumnNotTakenOver), {what.Name});
    case NotTakenOver::MissingColumn:
      return Filled(strings.Text(OwnText::MissingColumn), {what.Name});
    case NotTakenOver::OneValue:
      return Filled(strings.Text(OwnText::OldValue), {what.InTable, what.InRow, what.Name});
    case NotTakenOver::TextsOfColumn:
      break;
  }
  return Filled(strings.Text(OwnText::TextsNotTakenOver), {what.Name});
}

/// One line for each, `most` at the most and one that counts the others.
std::string Lines(const std::vector<NotTakenOver>& all, const StringTable& strings,
                  std::size_t most = MostEntries) {
  std::string lines;
  for (std::size_t i = 0; i < std::min(all.size(), most); ++i) {
    lines += (i == 0 ? "" : "\n") + TextOf(all[i], strings);
  }
  if (all.size() > most) {
    lines += "\n" + Filled(strings.Text(OwnText::AndMore), {std::to_string(all.size() - most)});
  }
  return lines;
}

class Steps : public ConversionSteps {
 public:
  Steps(const UserDatabase& database, const DatabaseParts& parts) : database_(database), parts_(parts) {}

  bool GoOnWithout(const std::vector<NotTakenOver>& values) override {
    return Ask(Filled(parts_.Strings.Text(OwnText::OldValuesUnreadable),
                      {database_.Path, Lines(values, parts_.Strings)}));
  }

  bool AddInterimRows(std::int64_t rows) override {
    return Ask(Filled(parts_.Strings.Text(OwnText::InterimRows),
                      {database_.Path, std::to_string(rows), FreshPath(database_)}));
  }

  void BeforeReplacing(const OldDatabaseReport& report) override {
    if (report.NotTaken.empty()) {
      return;
    }
    // An earlier conversion may have left a list of its own.
    const std::string earlier =
        parts_.Disk.FileExists(ListPath()) ? parts_.Disk.Read(ListPath()) + "\n" : std::string();
    parts_.Disk.Replace(ListPath(), earlier + TextOf(report, report.NotTaken.size()) + "\n");
  }

  void Tell(const OldDatabaseReport& report) {
    std::string text = TextOf(report, MostEntries);
    if (report.NotTaken.size() > MostEntries) {
      text += "\n\n" + Filled(parts_.Strings.Text(OwnText::WholeListIn), {ListPath()});
    }
    parts_.Boxes.Show(text, DatabaseBoxTitle, BoxIcon::Information);
  }

 private:
  std::string ListPath() const { return database_.Path + ".txt"; }

  bool Ask(const std::string& question) {
    return parts_.Boxes.Show(question, DatabaseBoxTitle, BoxIcon::Question, BoxButtons::YesNo) ==
           BoxAnswer::Yes;
  }

  std::string TextOf(const OldDatabaseReport& report, std::size_t most) const {
    std::string text = Filled(parts_.Strings.Text(OwnText::OldDatabaseConverted),
                              {database_.Path, std::to_string(report.Rows), report.KeptAs});
    if (!report.NotTaken.empty()) {
      text += "\n\n" + parts_.Strings.Text(OwnText::NotTakenOver) + "\n" +
              Lines(report.NotTaken, parts_.Strings, most);
    }
    return text;
  }

  const UserDatabase& database_;
  const DatabaseParts& parts_;
};

}  // namespace

std::string ReasonOf(const OldDatabaseRefused& error, const StringTable& strings) {
  if (!error.Parts().empty()) {
    return Filled(strings.Text(OwnText::OldDatabaseRefused), {Lines(error.Parts(), strings)});
  }
  if (!error.Failure().empty()) {
    return Filled(strings.Text(OwnText::OldDatabaseRefused), {error.Failure()});
  }
  return strings.Text(OwnText::OldDatabaseDamaged);
}

std::string LinesOf(const std::vector<NotTakenOver>& all, const StringTable& strings) {
  return Lines(all, strings);
}

void ConvertOldDatabase(const UserDatabase& database, const DatabaseParts& parts) {
  Steps steps(database, parts);
  OldDatabaseReport report;
  try {
    report =
        parts.Old.Convert({database.Path, database.Table, database.DefaultPath, FreshPath(database)}, steps);
  } catch (const OldDatabaseRefused& error) {
    throw RuntimeError(Fault::UnrecognizedDatabase, ReasonOf(error, parts.Strings));
  }
  steps.Tell(report);
}
