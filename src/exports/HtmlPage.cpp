#include "exports/HtmlPage.h"

#include <array>

#include "core/game/PlayerId.h"
#include "core/game/TeamColour.h"
#include "exports/HtmlText.h"

namespace {

constexpr std::string_view Style = R"(
:root { color-scheme: light dark; --ground: #fff; --ink: #1c1f24; --quiet: #59616c; --line: #d6dae0; --band: #f3f5f7; --link: #1f56a8; }
@media screen and (prefers-color-scheme: dark) {
  :root { --ground: #15181c; --ink: #e8ebee; --quiet: #a4acb7; --line: #373d46; --band: #1f242b; --link: #8ab6f4; }
}
* { box-sizing: border-box; }
body { margin: 0; background: var(--ground); color: var(--ink); font: 1rem/1.45 system-ui, "Noto Sans", "Noto Sans CJK SC", sans-serif; }
main { max-width: 64rem; margin: 0 auto; padding: 1.5rem 1rem 3rem; }
h1, h2, h3, h4 { line-height: 1.2; margin: 0; overflow-wrap: anywhere; }
h1 { font-size: 1rem; font-weight: 600; color: var(--quiet); }
h2 { font-size: 2rem; margin-top: .25rem; }
h3 { font-size: 1.25rem; margin: 2rem 0 .5rem; }
h4 { font-size: 1.1rem; }
p { margin: .25rem 0; }
a { color: var(--link); }
.quiet { color: var(--quiet); font-weight: normal; }
.wide { overflow-x: auto; }
table { border-collapse: collapse; width: 100%; }
caption { text-align: start; font-weight: 600; padding: .5rem 0 .25rem; }
th, td { padding: .35rem .6rem; text-align: start; vertical-align: top; border-bottom: 1px solid var(--line); overflow-wrap: anywhere; }
thead th { vertical-align: bottom; font-size: .85rem; color: var(--quiet); overflow-wrap: normal; }
tbody th { font-weight: 600; min-width: 8rem; }
tbody tr:nth-child(even) { background: var(--band); }
.n { text-align: end; font-variant-numeric: tabular-nums; overflow-wrap: normal; white-space: nowrap; }
thead .n { white-space: normal; }
.gun { white-space: nowrap; }
.teams { width: auto; min-width: min(24rem, 100%); }
.t1::before, .t2::before, .t3::before { display: inline-block; width: 1.2em; font-size: .9em; }
article + article { margin-top: 3rem; border-top: 3px solid var(--line); padding-top: 1.5rem; }
.player { border-top: 1px solid var(--line); padding: 1.25rem 0; }
.player dl { display: flex; flex-wrap: wrap; gap: .5rem 1.75rem; margin: .75rem 0; }
.player dt { font-size: .85rem; color: var(--quiet); }
.player dd { margin: 0; font-weight: 600; font-variant-numeric: tabular-nums; overflow-wrap: anywhere; }
.hits { display: grid; grid-template-columns: repeat(auto-fit, minmax(16rem, 1fr)); gap: 0 2rem; align-items: start; }
.hits table { max-width: 30rem; }
.back { font-size: .9rem; }
@page { size: A4; margin: 14mm; }
@media print {
  body { font-size: 9.5pt; }
  main { max-width: none; padding: 0; }
  a { color: inherit; text-decoration: none; }
  th, td { padding: .2rem .35rem; }
  .wide { overflow: visible; }
  .back { display: none; }
  tr, .player dl { break-inside: avoid; }
  h2, h3, h4, caption, .player dl { break-after: avoid; }
  article + article { break-before: page; border: 0; }
}
)";

/// Nothing but the page's own style may be used.
constexpr std::string_view Policy =
    "default-src 'none'; style-src 'unsafe-inline'; base-uri 'none'; form-action 'none'";

/// A badge of the team's colour and shape before its texts, as in the program.
void AddTeamStyle(std::string& style) {
  constexpr std::array<std::string_view, TeamCount> badges = {"\\25CF", "\\25A0", "\\25B2"};
  for (int team = 1; team <= TeamCount; ++team) {
    const Rgb& colour = TeamRgb.at(static_cast<std::size_t>(team - 1));
    const std::string_view badge = badges.at(static_cast<std::size_t>(team - 1));
    style.append(".t").append(std::to_string(team)).append("::before { content: \"").append(badge);
    // Once more without words for a screen reader, which older browsers do not understand.
    style.append("\"; content: \"").append(badge).append("\" / \"\"; color: rgb(");
    style.append(std::to_string(colour.Red)).append(" ").append(std::to_string(colour.Green)).append(" ");
    style.append(std::to_string(colour.Blue)).append("); }\n");
  }
}

}  // namespace

std::string HtmlPageStart(std::string_view title, Language language) {
  std::string page = "<!DOCTYPE html>\n<html lang=\"";
  page.append(language == Language::English ? "en" : "zh-Hans")
      .append("\">\n<head>\n<meta charset=\"utf-8\"/>\n");
  page.append("<meta name=\"viewport\" content=\"width=device-width, initial-scale=1\"/>\n");
  page.append("<meta http-equiv=\"Content-Security-Policy\" content=\"").append(Policy).append("\"/>\n");
  page.append("<title>").append(HtmlText(title)).append("</title>\n<style>").append(Style);
  AddTeamStyle(page);
  return page.append("</style>\n</head>\n<body>\n<main>\n");
}

std::string_view HtmlPageEnd() {
  return "</main>\n</body>\n</html>\n";
}
