#pragma once

#include <string_view>

namespace wp::host {

/// The page's style. Nothing in it is fetched; colours follow the viewer's choice of light and dark, and paper is always
/// light. What a colour says is said by a word or a shape as well.
inline constexpr std::string_view kPageStyle = R"(
:root { color-scheme: light dark; --ground: #fff; --text: #1c1c1e; --quiet: #5b5b62; --line: #d3d3d9; --card: #f5f5f8;
  --own: #0a58b8; --bad: #a81a12; --warn: #8a5300; }
@media (prefers-color-scheme: dark) {
  :root { --ground: #131316; --text: #ececf0; --quiet: #a6a6b0; --line: #3c3c44; --card: #1e1e23;
    --own: #7db7ff; --bad: #ff8d85; --warn: #ffc06a; }
}
* { box-sizing: border-box; }
body { margin: 0 auto; padding: 1.5rem 1rem 3rem; max-width: 46rem; background: var(--ground); color: var(--text);
  font: 1rem/1.5 system-ui, sans-serif; overflow-wrap: anywhere; }
h1 { font-size: 1.1rem; margin: 0; color: var(--quiet); font-weight: 600; }
h2 { font-size: 1.25rem; margin: 2.25rem 0 .75rem; }
h3 { font-size: 1.05rem; margin: 0; }
table + h3 { margin-top: 1.1rem; }
p { margin: .25rem 0; }
.summary { font-size: 1.45rem; line-height: 1.3; font-weight: 600; margin: .35rem 0 0; }
ol.findings { list-style: none; margin: 0; padding: 0; }
.finding { border: 1px solid var(--line); border-left: .4rem double var(--line); border-radius: .4rem; background: var(--card);
  padding: .8rem 1rem; margin: 0 0 .9rem; break-inside: avoid; }
.finding.broken { border-left: .4rem solid var(--bad); }
.finding.problem { border-left: .4rem solid var(--warn); }
.finding.advice { border-left: .4rem dashed var(--warn); }
.where { color: var(--quiet); font-size: .9rem; margin: .1rem 0 .5rem; }
.severity { font-weight: 700; }
.broken .severity { color: var(--bad); }
.problem .severity { color: var(--warn); }
dl { margin: 0; }
dl > div { margin: .3rem 0; }
dt { color: var(--quiet); font-size: .85rem; }
dd { margin: 0; }
.advise { border-top: 1px solid var(--line); padding-top: .45rem; margin-top: .55rem; }
.advise dd { font-weight: 600; }
ul { margin: .3rem 0; padding-left: 1.3rem; }
figure { margin: 0 0 1.75rem; break-inside: avoid; }
figcaption { font-weight: 600; margin-bottom: .25rem; }
.legend { color: var(--quiet); font-size: .9rem; margin-bottom: 1rem; }
table { border-collapse: collapse; width: 100%; font-size: .9rem; }
th, td { text-align: start; padding: .3rem .5rem .3rem 0; border-bottom: 1px solid var(--line); vertical-align: top; }
td { min-width: 6.5rem; }
th { color: var(--quiet); font-weight: 600; overflow-wrap: normal; }
th[scope=row] { width: 9.5rem; }
th[scope=col] { white-space: nowrap; }
figure table { margin-top: .5rem; }
td.figure, th.figure { text-align: end; }
td.figure { min-width: 0; font-variant-numeric: tabular-nums; white-space: nowrap; }
tr.own td { font-weight: 700; }
svg { display: block; width: 100%; height: auto; color: var(--text); }
svg.pings { max-width: 24rem; }
svg text { fill: currentColor; font: 13px system-ui, sans-serif; text-anchor: middle; }
svg .scale { fill: var(--quiet); text-anchor: end; }
svg .channel { fill: var(--quiet); }
svg .note { fill: var(--quiet); text-anchor: start; }
svg .grid { stroke: var(--line); stroke-width: 1; }
svg .base { stroke: currentColor; stroke-width: 1.5; }
svg .radar { fill: currentColor; fill-opacity: .06; }
svg .network { stroke: currentColor; stroke-width: 1.5; fill: currentColor; fill-opacity: .1; }
svg .network.selected { stroke: var(--own); stroke-width: 3; stroke-dasharray: 8 5; fill: var(--own); }
svg .network.joined { stroke: var(--own); stroke-width: 3.5; fill-opacity: 1; }
svg .hatch { stroke: var(--own); stroke-width: 2; }
svg .label { paint-order: stroke; stroke: var(--ground); stroke-width: 4; stroke-linejoin: round; }
svg .number, svg .own { font-weight: 700; }
svg .answer { fill: var(--own); }
svg .lost { fill: none; stroke: var(--bad); stroke-width: 3; }
@media (min-width: 34rem) {
  dl > div { display: grid; grid-template-columns: 8.5rem 1fr; column-gap: .75rem; }
  dd { grid-column: 2; }
}
@media (max-width: 34rem) {
  svg.channels text { font-size: 24px; }
  svg.channels .name, svg.channels .between { display: none; }
  figure table { font-size: .82rem; }
  figure td { min-width: 5rem; }
}
@media print {
  :root { color-scheme: light; --ground: #fff; --text: #000; --quiet: #444; --line: #999; --card: #fff; --own: #003d87;
    --bad: #8c0f08; --warn: #6d4100; }
  body { max-width: none; padding: 0; font-size: 10.5pt; }
  h2, h3 { break-after: avoid; }
  tr { break-inside: avoid; }
}
)";

}  // namespace wp::host
