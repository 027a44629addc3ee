#include "members/ImportTexts.h"

#include "core/text/Filled.h"
#include "core/text/Pieces.h"

namespace {

std::string PartOfText(const StringTable& strings, OwnText list, std::size_t place) {
  return PartsOf(strings.Text(list), '|').at(place);
}

std::string ChangesOf(const PlannedRow& row, const StringTable& strings) {
  const std::vector<std::string> titles = MemberColumnTitles(strings);
  std::string changes;
  for (std::size_t column = 0; column < titles.size(); ++column) {
    if (row.Changes[column]) {
      changes.append(changes.empty() ? "" : ", ").append(titles[column]);
    }
  }
  return changes;
}

std::string TextOfTrouble(const RowTrouble& trouble, const StringTable& strings) {
  const auto place = static_cast<std::size_t>(trouble.Fault) - 1;  // behind None
  return Filled(PartOfText(strings, OwnText::RowFaults, place),
                {MemberColumnTitles(strings).at(trouble.Column), std::to_string(trouble.Line)});
}

}  // namespace

std::string TextOfRow(const PlannedRow& row, const StringTable& strings) {
  std::string text = PartOfText(strings, OwnText::RowFates, static_cast<std::size_t>(row.Fate));
  switch (row.Fate) {
    case RowFate::Changed:
      return Filled(text, {ChangesOf(row, strings)});
    case RowFate::Refused:
      return Filled(text, {TextOfTrouble(row.Trouble, strings)});
    default:
      return text;
  }
}

std::string TextOfPlan(const ImportPlan& plan, const StringTable& strings) {
  if (plan.Fault) {
    return Filled(PartOfText(strings, OwnText::CsvFaults, static_cast<std::size_t>(*plan.Fault)),
                  {std::to_string(plan.FaultLine)});
  }
  if (plan.Rows.empty()) {
    return strings.Text(OwnText::NoMembersInFile);
  }
  const auto count = [&plan](RowFate fate) { return std::to_string(plan.Count(fate)); };
  std::string text = Filled(strings.Text(OwnText::ImportCounts),
                            {count(RowFate::New), count(RowFate::Changed), count(RowFate::Unchanged),
                             count(RowFate::Skipped), count(RowFate::Refused)});
  return plan.KeepsNumbers ? text + "\n" + strings.Text(OwnText::NumbersAreKept) : text;
}

std::string TextOfDates(const DateFinding& finding, const StringTable& strings) {
  if (finding.IsOpen) {
    return strings.Text(OwnText::DatesOpen);
  }
  const std::size_t line = finding.DayFirst + finding.MonthFirst;  // one of them is 0
  return line == 0 ? strings.Text(OwnText::DatesAreClear)
                   : Filled(strings.Text(OwnText::DatesSettled), {std::to_string(line)});
}
