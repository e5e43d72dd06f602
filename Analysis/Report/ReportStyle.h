#pragma once

namespace spectrel {

/// The page's style: light, dark as the reader's system is, and always light on paper. Colours of cells are told apart
/// in both, also by letters; text keeps a contrast of 4.5 to 1, lines of 3 to 1.
inline constexpr const char* ReportStyle = R"css(
:root{color-scheme:light dark;--back:#fff;--text:#1b1f24;--soft:#59636e;--line:#d5dae0;--lost:#c92a2a;
--c0:#1864ab;--c1:#c2410c;--c2:#2b7a3b;--c3:#a61e6b;--c4:#6741d9;--c5:#8a6100;--c6:#0b7285;--c7:#c92a2a;--c8:#495057;--c9:#5f6f00;--on:#fff}
@media screen and (prefers-color-scheme:dark){:root{--back:#14171a;--text:#e6e9ec;--soft:#9aa5b1;--line:#343b43;--lost:#ff8787;
--c0:#74c0fc;--c1:#ffa94d;--c2:#8ce99a;--c3:#faa2c1;--c4:#b197fc;--c5:#ffd43b;--c6:#66d9e8;--c7:#ff8787;--c8:#ced4da;--c9:#c0eb75;--on:#14171a}}
*{box-sizing:border-box}
body{margin:0 auto;max-width:78rem;padding:1rem 1.25rem 3rem;background:var(--back);color:var(--text);font:15px/1.45 system-ui,sans-serif}
h1{font-size:1.6rem;margin:.5rem 0 0}h2{font-size:1.2rem;margin:2.2rem 0 .5rem;border-bottom:1px solid var(--line);padding-bottom:.2rem}
h3{font-size:1rem;margin:1.2rem 0 .3rem}p{margin:.3rem 0}small,.soft{color:var(--soft)}
figure{margin:0 0 1rem;min-width:0}svg{display:block;width:100%;height:auto;font:11px system-ui,sans-serif;fill:var(--text)}
.side{display:grid;gap:0 2rem;grid-template-columns:repeat(auto-fit,minmax(min(100%,26rem),1fr))}
.wide{overflow-x:auto}.k{white-space:nowrap}.small{font-size:.8rem}.small th,.small td{padding-right:.6rem}table{border-collapse:collapse;font-variant-numeric:tabular-nums}
caption{text-align:left;color:var(--soft);font-size:.85rem}th,td{text-align:left;vertical-align:top;padding:.2rem .9rem .2rem 0;border-bottom:1px solid var(--line)}
thead th{color:var(--soft);font-weight:600;white-space:nowrap}tbody th{font-weight:600;white-space:nowrap}
ul{margin:.2rem 0;padding-left:1.1rem}code{font-size:.85em}details{font-size:.9rem}summary{color:var(--soft);cursor:pointer}
.swatch{display:inline-block;width:.75em;height:.75em;margin-right:.4em;border-radius:2px;background:var(--c,transparent)}
.grid path{stroke:var(--line);fill:none}.grid text{fill:var(--soft)}.end{text-anchor:end}.mid{text-anchor:middle}
.f{fill:var(--c)}.on{fill:var(--on);font-weight:600}.l{fill:none;stroke:var(--c,var(--soft));stroke-width:1.5;stroke-linejoin:round;stroke-linecap:round}
.b{fill:var(--c,var(--soft));opacity:.22}.move{stroke:var(--soft);fill:none}
.note{stroke:var(--text);fill:var(--text);stroke-width:1}.lost{fill:var(--lost);opacity:.22}
.d1{stroke-dasharray:7 3}.d2{stroke-dasharray:2 3}.d3{stroke-dasharray:8 3 2 3}
.c0{--c:var(--c0)}.c1{--c:var(--c1)}.c2{--c:var(--c2)}.c3{--c:var(--c3)}.c4{--c:var(--c4)}.c5{--c:var(--c5)}.c6{--c:var(--c6)}.c7{--c:var(--c7)}.c8{--c:var(--c8)}.c9{--c:var(--c9)}
@media print{body{max-width:none;padding:0;font-size:10pt}figure,tr,h2,h3{break-inside:avoid}h2,h3{break-after:avoid}
*{print-color-adjust:exact;-webkit-print-color-adjust:exact}.wide{overflow:visible}.pair{grid-template-columns:1fr 1fr}details:not([open]){display:none}}
)css";

} // namespace spectrel
