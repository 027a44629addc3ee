#include "web/PageAssets.h"

#include <cstddef>

#include "core/game/TeamColour.h"
#include "core/text/Filled.h"

namespace {

constexpr const char* CommonStyle =
    R"(:root{color-scheme:light dark;--ink:#1b1d21;--paper:#fff;--line:#d5d8de;
--link:#0b57b0;--soft:#f1f3f6}
@media(prefers-color-scheme:dark){:root{--ink:#eceef2;--paper:#14161a;--line:#3a3e46;--link:#8fc0ff;--soft:#20242b}}
*{box-sizing:border-box}
body{margin:0 auto;max-width:40rem;padding:0 .6rem 2rem;background:var(--paper);color:var(--ink);
font:1rem/1.4 system-ui,sans-serif;overflow-wrap:anywhere}
a{color:var(--link)}
nav{display:flex;flex-wrap:wrap;gap:.2rem 1rem;border-bottom:1px solid var(--line)}
nav a{padding:.7rem 0}
h1{font-size:1.5rem;line-height:1.2;margin:.9rem 0 .5rem}
.hits{margin-top:1.2rem}
.lead{font-size:1.2rem;margin:.2rem 0}
table{border-collapse:collapse;width:100%}
th,td{padding:.4rem .2rem;border-bottom:1px solid var(--line);text-align:left;vertical-align:middle}
th{font-weight:600;font-size:.85rem;overflow-wrap:normal;word-break:keep-all}
td:nth-child(n+3),th:nth-child(n+3),.hits td+td,.hits th+th,.figures td{text-align:right;
font-variant-numeric:tabular-nums;overflow-wrap:normal}
.board td:first-child,.ranks td:first-child{overflow-wrap:normal}
.who{width:99%;min-width:7rem}
.figures th{font-size:1rem}
td a{padding:.2rem 0}
.teams{display:flex;flex-wrap:wrap;gap:.4rem 1rem;margin:.4rem 0}
.wide,#new{display:block;padding:.8rem;background:var(--soft);border:1px solid var(--line);border-radius:.4rem;
text-align:center}
#new{position:sticky;top:0;font-weight:600}
#new[hidden]{display:none}
ul{list-style:none;margin:0;padding:0}
.games li{margin:.5rem 0}
.guns{display:grid;grid-template-columns:repeat(auto-fill,minmax(9rem,1fr));gap:.5rem}
.guns a{display:block;height:100%;padding:.8rem .5rem;background:var(--soft);border:1px solid var(--line);
border-radius:.4rem;font-size:1.1rem}
.guns small{display:block}
@media(max-width:25rem){body{padding:0 .4rem 2rem}
td,th{padding:.4rem .15rem}
th{font-size:.7rem}
.ranks td:nth-child(6),.ranks th:nth-child(6){display:none}}
.t1,.t2,.t3{display:inline-block;min-width:1.5em;padding:0 .2em;border-radius:.2em;text-align:center}
)";

/// The letter on a team's colour: white, or black on the bright one.
constexpr const char* LettersOfTeams[] = {"#fff", "#fff", "#000"};

}  // namespace

std::string PageStyle() {
  std::string style = CommonStyle;
  for (std::size_t at = 0; at < TeamRgb.size(); ++at) {
    const Rgb& colour = TeamRgb.at(at);
    style += Filled(".t%1{background:rgb(%2,%3,%4);color:%5}\n",
                    {std::to_string(at + 1), std::to_string(colour.Red), std::to_string(colour.Green),
                     std::to_string(colour.Blue), LettersOfTeams[at]});
  }
  return style;
}

std::string PageScript() {
  return R"((function () {
  "use strict";
  var shown = document.body.getAttribute("data-now");
  var offer = document.getElementById("new");
  function wait() { setTimeout(ask, 3000); }
  function look(now) {
    if (shown === null) { shown = now; }
    if (now === shown) { wait(); } else if (offer) { offer.hidden = false; } else { location.reload(); }
  }
  function ask() {
    if (document.hidden) { wait(); return; }
    var stop = window.AbortController ? new AbortController() : null;
    if (stop) { setTimeout(function () { stop.abort(); }, 10000); }
    fetch("/now", stop ? { signal: stop.signal } : {}).then(function (answer) {
      if (!answer.ok) { throw new Error("no answer"); }
      return answer.text();
    }).then(look).catch(wait);
  }
  wait();
})();
)";
}
