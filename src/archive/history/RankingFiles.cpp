// A ranking as others read it.

#include "archive/history/Rankings.h"
#include "core/text/Pieces.h"
#include "exports/Csv.h"
#include "exports/HtmlPage.h"
#include "exports/HtmlText.h"

namespace {

constexpr std::size_t NameColumn = 1;

void WriteFigures(CsvWriter& csv, const RankedFigures& figures) {
  const auto number = [&csv](const std::optional<double>& value) {
    if (value) {
      csv.Number(*value);
    } else {
      csv.Empty();
    }
  };
  csv.Number(figures.Games);
  csv.Number(figures.Sum);
  csv.Number(figures.Mean());
  number(figures.Best);
  number(figures.Accuracy);
}

std::string RankingRowHtml(const RankedMember& member, bool fullNames, const StringTable& strings) {
  std::string html = "<tr>";
  const std::vector<std::string> texts = RankingTexts(member, strings);
  for (std::size_t column = 0; column < texts.size(); ++column) {
    if (column != NameColumn) {
      html.append(HtmlNumberCell(HtmlText(texts[column])));
      continue;
    }
    html.append(HtmlTextCell(HtmlName(texts[column])));
    if (fullNames) {
      html.append(HtmlTextCell(HtmlName(member.FullName)));
    }
  }
  return html.append("</tr>\n");
}

}  // namespace

std::string RankingCsv(const std::vector<RankedMember>& ranked, bool fullNames, const StringTable& strings) {
  CsvWriter csv(CsvSeparator::Comma, true);
  const std::vector<std::string> captions = PartsOf(strings.Text(OwnText::RankingColumns), '|');
  for (std::size_t column = 0; column < captions.size(); ++column) {
    csv.Text(captions[column]);
    if (column == NameColumn && fullNames) {
      csv.Text(strings.Text(OwnText::PageFullName));
    }
  }
  csv.EndRow();
  for (const RankedMember& member : ranked) {
    csv.Number(std::int64_t{member.Place});
    csv.Text(member.PublicName);
    if (fullNames) {
      csv.Text(member.FullName);
    }
    WriteFigures(csv, member.Figures);
    csv.EndRow();
  }
  return csv.Take();
}

std::string RankingPage(const std::string& title, const std::vector<RankedMember>& ranked, bool fullNames,
                        const StringTable& strings) {
  std::string html = HtmlPageStart(title, strings.TextLanguage());
  html.append("<h2>").append(HtmlText(title)).append("</h2>\n<table>\n<thead><tr>");
  const std::vector<std::string> captions = PartsOf(strings.Text(OwnText::RankingColumns), '|');
  for (std::size_t column = 0; column < captions.size(); ++column) {
    const std::string caption = HtmlText(captions[column]);
    html.append(column == NameColumn ? HtmlTextHead(caption) : HtmlNumberHead(caption));
    if (column == NameColumn && fullNames) {
      html.append(HtmlTextHead(HtmlText(strings.Text(OwnText::PageFullName))));
    }
  }
  html.append("</tr></thead>\n<tbody>\n");
  for (const RankedMember& member : ranked) {
    html.append(RankingRowHtml(member, fullNames, strings));
  }
  return html.append("</tbody>\n</table>\n").append(HtmlPageEnd());
}
