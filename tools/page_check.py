#!/usr/bin/env python3
"""page_check.py ZBTOOL [--screenshot FILE]: renders the page of `zbtool timers --html` in headless Chromium, with and
without scripts, in light and dark, and checks what a reader sees: rows, their order, bars, and sorting by every column.
With --screenshot it also writes a picture of the page."""

import html
import json
import os
import re
import subprocess
import sys
import tempfile
from pathlib import Path

TITLES = (("Function", 40), ("Count", 10), ("Total", 15), ("Average", 15), ("Maximum", 15), ("Maximum count", 15),
          ("Minimum", 15), ("Suspend total", 15), ("Suspend Max", 15), ("Notes", 24))
ENDS = (48, 63, 78, 93, 108, 123, 138, 153)
# name: count, total, average, maximum, maximum count, minimum, suspended, suspended at most
TIMERS = {
    "render a page": (412, 8_240_000, 20_000, 61_300, 17, 9_120, 41_200, 7_300),
    "copy the folder": (3, 1_938_042, 646_014, 702_118, 2, 588_207, 0, 0),
    "read the <ticket>": (3, 2_811, 937, 1_204, 1, 702, 0, 0),
    "merge variable data": (1_236, 5_401_320, 4_370, 12_880, 903, 1_050, 880_100, 10_022),
    "verify the copy": (3, 411_042, 137_014, 139_810, 3, 135_002, 0, 0),
    "write the log": (9_120, 91_200, 10, 412, 77, 4, 0, 0),
    "never started": (0,) * 8,
}
NO_SCRIPTS = """<meta http-equiv="Content-Security-Policy" content="script-src 'none'">"""
# Behind the page's own script: clicks each head twice, and notes what stands there each time.
PROBE = """<script>
const seen = {}, names = () => [...body.rows].map(row => row.cells[0].textContent);
const note = name => { seen[name] = names(); };
note("first");
heads.forEach((head, i) => { for (const turn of [1, 2]) { head.querySelector("button").click();
  note(`${head.textContent} ${turn} ${head.getAttribute("aria-sort")}`); } });
seen.colors = [getComputedStyle(document.body).color, getComputedStyle(document.body).backgroundColor];
seen.bars = Object.fromEntries([...body.rows].map(row => [row.cells[0].textContent,
  row.querySelector("i").getBoundingClientRect().width / row.querySelector("td.bar").clientWidth]));
seen.fits = document.documentElement.scrollWidth <= innerWidth;
document.body.append(Object.assign(document.createElement("pre"), {id: "seen", textContent: JSON.stringify(seen)}));
</script>"""


def report():
    lines = ["Log timestamp (sec): 1767225600", "Timers (mksec):", "".join(t.ljust(width) for t, width in TITLES)]
    for name, numbers in TIMERS.items():
        row = list(name.ljust(156))
        for number, end in zip(numbers, ENDS):
            text = f"{number:,}"
            if numbers[0] or end == ENDS[0]:
                row[end + 1 - len(text):end + 1] = text
        lines.append("".join(row))
    return "\n".join(lines) + "\n"


def chromium(*arguments):
    with tempfile.TemporaryDirectory() as profile:
        options = ["--headless", "--disable-gpu", "--hide-scrollbars", "--virtual-time-budget=2000",
                   "--window-size=1200,480", f"--user-data-dir={profile}"]
        if os.geteuid() == 0:
            options.append("--no-sandbox")
        return subprocess.run(["chromium", *options, *map(str, arguments)], check=True, capture_output=True, text=True,
                              timeout=120).stdout


def rows_of(dom):
    return [html.unescape(re.sub("<[^>]*>", "", row)) for row in re.findall(r"<tr><td>(.*?)</td>", dom)]


def sorted_names(column, reverse):
    key = (lambda name: name) if column < 0 else (lambda name: TIMERS[name][column])
    return sorted(TIMERS, key=key, reverse=reverse)


class Check:
    def __init__(self):
        self.problems = []

    def equal(self, what, found, expected):
        if found != expected:
            self.problems.append(f"{what}:\n    found    {found}\n    expected {expected}")

    def that(self, what, good):
        self.equal(what, bool(good), True)


def ordered(column, names):
    values = [name if column < 0 else TIMERS[name][column] for name in names]
    return values == sorted(values), values == sorted(values, reverse=True)


def check_sorting(check, seen):
    columns = ["timer", "count", "total", "average", "maximum", "maximum-count", "minimum", "suspended",
               "suspended-maximum"]
    for column, name in enumerate(columns, -1):
        # The first click sorts names from the first and numbers from the largest, the second the other way round.
        first = name == "timer"
        for turn, up in enumerate((first, not first), 1):
            state = f"{name} {turn} {'ascending' if up else 'descending'}"
            check.that(f"no state '{state}'", state in seen)
            names = seen.get(state, [])
            check.equal(f"rows of '{state}'", sorted(names), sorted(TIMERS))
            check.that(f"order of '{state}': {names}", ordered(column, names)[0 if up else 1])


def check_page(check, folder, page):
    by_total = sorted_names(1, reverse=True)
    text = page.read_text()
    check.that("the page refers to another place", not re.search(r"https?:|\bsrc=|\bhref=|@import|url\(", text))
    refusing = folder / "refusing.html"
    refusing.write_text(text.replace("<head>", "<head>" + NO_SCRIPTS))
    plain = chromium("--dump-dom", refusing.as_uri())
    check.equal("rows without scripts", rows_of(plain), by_total)
    check.that("buttons without scripts", "<button" not in plain)
    probed = folder / "probed.html"
    probed.write_text(text.replace("</body>", PROBE + "</body>"))
    colors = {}
    for scheme, number in (("dark", 0), ("light", 1)):
        dom = chromium(f"--blink-settings=preferredColorScheme={number}", "--dump-dom", probed.as_uri())
        found = re.search(r'<pre id="seen">(.*?)</pre>', dom, re.S)
        check.that(f"the page's script runs ({scheme})", found)
        if not found:
            return
        seen = json.loads(html.unescape(found[1]))
        colors[scheme] = seen["colors"]
        check.equal(f"rows with scripts ({scheme})", seen["first"], by_total)
        check_sorting(check, seen)
        check.that("the page is wider than the window", seen["fits"])
        largest = seen["bars"][by_total[0]]
        for name in TIMERS:
            share = seen["bars"][name] / largest
            expected = TIMERS[name][1] / TIMERS[by_total[0]][1]
            check.that(f"bar of {name}: {share:.3f}, not {expected:.3f}", abs(share - expected) < 0.01)
    check.that(f"light and dark look the same: {colors}", colors["dark"] != colors["light"])


def main():
    program = Path(sys.argv[1]).resolve()
    check = Check()
    with tempfile.TemporaryDirectory() as name:
        folder = Path(name)
        (folder / "1767225600_render_0.timer").write_bytes(report().encode())
        subprocess.run([program, "timers", "--html", "page.html", "1767225600_render_0.timer"], check=True, cwd=folder,
                       stdout=subprocess.DEVNULL)
        page = folder / "page.html"
        check_page(check, folder, page)
        if sys.argv[2:3] == ["--screenshot"]:
            chromium("--blink-settings=preferredColorScheme=1", f"--screenshot={Path(sys.argv[3]).resolve()}",
                     page.as_uri())
    for problem in check.problems:
        print(problem)
    print(f"{'FAIL' if check.problems else 'OK'}: page, {len(check.problems)} problems")
    sys.exit(1 if check.problems else 0)


main()
