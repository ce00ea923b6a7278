#!/usr/bin/env python3
"""Turns the JSON output of the benchmarks into a table (Markdown) and plots (SVG).

    report.py RESULTS.json BUILD_DIR OUTPUT_DIR

Only the standard library of Python is used. The host name and the paths that the JSON file holds
are left out.
"""

import datetime
import json
import math
import pathlib
import re
import subprocess
import sys

CODES = {0: "Ok", 1: "InvalidArcRadius", 2: "Failed", 20: "PointsTooClose", 23: "NoFit"}

STRATEGIES = ("Mixed", "MixedCells", "SingleArc")

PACKAGES = {
    "Boost": "libboost-dev",
    "CGAL": "libcgal-dev",
    "Eigen": "libeigen3-dev",
    "GEOS": "libgeos-dev",
    "Google Benchmark": "libbenchmark-dev",
}

SHORT_CALLS = (
    ("segment with segment", "BM_GetLineSegmentsIntersection/random_pairs", None),
    ("segment with segment, test only", "BM_AreLineSegmentsIntersect/random_pairs", None),
    ("segment with circle", "BM_GetLineSegmentAndCircleIntersection/random_pairs", None),
    ("circle with circle, as arcs of a full turn",
     "BM_GetCircleArcAndCircleArcIntersection/full_circles", None),
    ("segment with arc", "BM_GetLineSegmentAndCircleArcIntersection/random_pairs", None),
    ("arc with arc", "BM_GetCircleArcAndCircleArcIntersection/random_pairs", None),
    ("linear equations, order 2", "BM_LinearEquationSystemSolve/random_systems/2",
     "BM_EigenPartialPivLu/random_systems/2"),
    ("linear equations, order 3", "BM_LinearEquationSystemSolve/random_systems/3",
     "BM_EigenPartialPivLu/random_systems/3"),
    ("linear equations, order 4", "BM_LinearEquationSystemSolve/random_systems/4",
     "BM_EigenPartialPivLu/random_systems/4"),
    ("rotation from three angles", "BM_MatrixFromAngles/random_rotations",
     "BM_EigenFromAngles/random_rotations"),
    ("matrix product", "BM_MatrixProduct/random_rotations", "BM_EigenProduct/random_rotations"),
    ("matrix times vector", "BM_MatrixTimesVector/random_rotations",
     "BM_EigenTimesVector/random_rotations"),
)

PROGRAM = (
    ("read points, x and y with all digits", "BM_ReadPoints"),
    ("measure points against a polygon of 1,000 sides", "BM_MeasurePoints"),
)

OUTLINES = ("ring", "teeth", "needles")

CHECKS = (
    ("BM_CheckPolySelfIntersection", "contour"),
    ("BM_CheckFlatSelfIntersection", "flat polyline"),
    ("BM_BoostIntersects", "Boost.Geometry"),
    ("BM_GeosIsSimple", "GEOS"),
    ("BM_CgalIsSimple", "CGAL"),
)


class Case:
    """One benchmark of one size, the fastest of its repetitions."""

    def __init__(self, entry):
        self.function, self.profile, size = (entry["run_name"].split("/") + [""])[:3]
        self.size = int(size) if size.isdigit() else 0
        self.error = entry.get("error_message") if entry.get("error_occurred") else None
        self.counters = entry

    def get(self, name):
        return None if self.error else self.counters.get(name)

    @property
    def per_item(self):
        for name in ("seconds_per_point", "seconds_per_element", "seconds_per_call"):
            if self.get(name) is not None:
                return self.get(name)
        return None

    @property
    def total(self):
        return None if self.per_item is None else self.per_item * self.size


def read_cases(results):
    """The cases by name; repetitions are reduced to the fastest, aggregates are left out."""
    cases = {}
    for entry in results["benchmarks"]:
        if entry.get("run_type") == "aggregate":
            continue
        name = re.sub(r"/(repeats:\d+)$", "", entry.get("run_name", entry["name"]))
        entry["run_name"] = name
        case = Case(entry)
        best = cases.get(name)
        if best is None or (case.per_item or math.inf) < (best.per_item or math.inf):
            cases[name] = case
    return cases


# Numbers as text.


def in_units(value, units, digits=3):
    for factor, unit in units:
        if value >= factor:
            break
    return f"{round_to(value / factor, digits)} {unit}"


def round_to(value, digits):
    if value == 0:
        return "0"
    decimals = max(0, digits - 1 - math.floor(math.log10(abs(value))))
    return f"{value:,.{decimals}f}"


def time_text(seconds):
    return in_units(seconds, ((1, "s"), (1e-3, "ms"), (1e-6, "µs"), (1e-9, "ns")))


def memory_text(size):
    return in_units(size, ((1e6, "MB"), (1e3, "kB"), (1, "B")))


def table(header, rows):
    lines = ["| " + " | ".join(header) + " |", "|" + "---|" * len(header)]
    lines += ["| " + " | ".join(row) + " |" for row in rows]
    return "\n".join(lines) + "\n"


# The table.


def left_out(case):
    return "" if case is None else case.error.removeprefix("left out: ") if case.error else ""


def fitting_row(case, plain):
    name = [case.profile.replace("_", " "), f"{case.size:,}"]
    if case.error:
        return name + [f"*left out: {left_out(case)}*"] + [""] * 7
    deviation = case.get("largest_relative_deviation")
    true_pieces = case.get("true_pieces")
    row = name + [
        time_text(case.per_item),
        time_text(case.total),
        CODES.get(int(case.get("code")), str(int(case.get("code")))),
        f"{int(case.get('pieces')):,}",
        "" if true_pieces is None else f"{int(true_pieces):,}",
        "" if deviation is None else f"{deviation:.6g}",
        memory_text(case.get("peak_bytes")),
    ]
    if plain is None or plain.per_item is None:
        return row + ["", ""] if plain is None else row + ["*left out*", ""]
    return row + [time_text(plain.per_item), f"{round_to(plain.per_item / case.per_item, 2)}"]


def fitting_tables(cases):
    text = ""
    for strategy in STRATEGIES:
        rows = []
        for case in cases.values():
            if case.function != f"BM_CreateFittingCurve_{strategy}":
                continue
            if case.size == 0:
                text += f"Measured contours: {case.error}.\n\n"
                continue
            plain = cases.get(f"BM_PlainComposition_{strategy}/{case.profile}/{case.size}")
            rows.append(fitting_row(case, plain))
        header = ["profile", "N", "time per point", "whole fit", "answer", "pieces", "true pieces",
                  "largest deviation", "peak memory", "plain, per point", "ratio"]
        if strategy == "MixedCells":
            header, rows = header[:-2], [row[:9] for row in rows]
        text += f"### Strategy `{strategy}`\n\n" + table(header, rows) + "\n"
    return text


def fewest_rows(cases):
    for case in cases.values():
        manner = case.function.removeprefix("BM_FewestPieces_")
        if manner == case.function:
            continue
        effort, is_closed, _ = manner.partition("_closed")
        closed = ", closed" if is_closed else ""
        row = [case.profile.replace("_", " ") + closed, f"{case.size:,}", effort.lower()]
        if case.error:
            yield row + [f"*left out: {left_out(case)}*"] + [""] * 8
            continue
        true_pieces = case.get("true_pieces")
        arcs = int(case.get("arcs"))
        mixed = cases.get(f"BM_CreateFittingCurve_Mixed/{case.profile}/{case.size}")
        has_mixed = mixed is not None and mixed.per_item is not None and not is_closed
        yield row + [
            time_text(case.per_item),
            CODES.get(int(case.get("code")), str(int(case.get("code")))),
            f"{int(case.get('bound')):,}",
            f"{int(case.get('pieces')):,}",
            "" if true_pieces is None else f"{int(true_pieces):,}",
            f"{int(case.get('pieces')) - arcs:,} + {arcs:,}",
            f"{case.get('largest_relative_deviation'):.3g}",
            memory_text(case.get("peak_bytes_per_point")),
            f"{int(mixed.get('pieces')):,} in {time_text(mixed.per_item)}" if has_mixed else "",
        ]


def fewest_table(cases):
    rows = list(fewest_rows(cases))
    if not rows:
        return ""
    header = ["profile", "N", "effort", "time per point", "answer", "bound", "pieces",
              "true pieces", "lines + arcs", "largest deviation", "peak memory per point",
              "strategy `Mixed`"]
    return "### The fewest pieces\n\n" + table(header, rows) + "\n"


def outline_rows(cases, sizes):
    for outline in OUTLINES + tuple(f"{name}_arcs" for name in OUTLINES):
        for size in sizes:
            row = [outline.replace("_arcs", ", with arcs"), f"{size:,}"]
            for function, _ in CHECKS:
                case = cases.get(f"{function}/{outline}/{size}")
                if case is None:
                    row.append("")
                else:
                    row.append("*left out*" if case.error else time_text(case.per_item))
            yield row


def area_rows(cases, sizes):
    for size in sizes:
        row = [f"{size:,}"]
        for name in ("BM_GetArea/ring", "BM_GetArea/ring_arcs", "BM_GetFlatArea/ring"):
            case = cases.get(f"{name}/{size}")
            row.append("" if case is None else
                       "*left out*" if case.error else time_text(case.per_item))
        yield row


def short_call_rows(cases):
    for title, ours, other in SHORT_CALLS:
        case = cases.get(ours)
        if case is None:
            continue
        meets = case.get("share_that_meets")
        yield [title, f"`{case.function.removeprefix('BM_')}`", time_text(case.per_item),
               "" if meets is None else f"{100 * meets:.0f} %",
               time_text(cases[other].per_item) if other in cases else ""]


def program_rows(cases):
    for title, function in PROGRAM:
        for case in cases.values():
            if case.function == function and case.per_item is not None:
                yield [title, f"{case.size:,}", time_text(case.per_item), time_text(case.total)]


def command_output(*command):
    try:
        return subprocess.run(command, capture_output=True, text=True, check=True).stdout.strip()
    except (OSError, subprocess.CalledProcessError):
        return ""


def cache_entry(build, name):
    match = re.search(rf"^{name}:\w+=(.*)$", (build / "CMakeCache.txt").read_text(), re.M)
    return match.group(1) if match else ""


def first_match(path, pattern):
    try:
        match = re.search(pattern, pathlib.Path(path).read_text(), re.M)
    except OSError:
        return "unknown"
    return match.group(1) if match else "unknown"


def machine_rows(results, build):
    memory = first_match("/proc/meminfo", r"^MemTotal:\s+(\d+) kB")
    compiler = command_output(cache_entry(build, "CMAKE_CXX_COMPILER"), "--version").split("\n")[0]
    versions = []
    for name, package in PACKAGES.items():
        version = command_output("dpkg-query", "--show", "--showformat=${Version}", package)
        if version:
            versions.append(f"{name} {version}")
    load = ", ".join(f"{value:.1f}" for value in results["context"].get("load_avg", []))
    yield ["date", datetime.datetime.now().astimezone().strftime("%Y-%m-%d")]
    yield ["processor", first_match("/proc/cpuinfo", r"^model name\s*:\s*(.*)$")]
    yield ["cores", f"{results['context']['num_cpus']}; one is used"]
    if memory != "unknown":
        yield ["memory", f"{int(memory) / 2**20:.0f} GiB"]
    yield ["system", first_match("/etc/os-release", r'^PRETTY_NAME="?([^"\n]*)')]
    yield ["compiler", compiler]
    yield ["flags", f"`{cache_entry(build, 'CMAKE_CXX_FLAGS_RELEASE')} -ffp-contract=off`"]
    yield ["beside", "; ".join(versions)]
    yield ["load average at the start", load or "unknown"]


def write_table(results, cases, build, path):
    sizes = sorted({case.size for case in cases.values() if case.profile == "ring"})
    text = "# Benchmark results\n\n"
    text += "Written by `./bench`; [README.md](README.md) says what is measured and how.\n"
    text += "Times are processor time of one core.\n\n"
    text += table(["", ""], machine_rows(results, build)) + "\n"
    text += "## Fitting\n\n![Time of a fit against the number of points](fitting.svg)\n\n"
    text += fitting_tables(cases)
    text += fewest_table(cases)
    text += "## Self-intersection, time per element\n\n"
    text += "![Time of the test against the number of elements](self_intersection.svg)\n\n"
    text += table(["outline", "N"] + [title for _, title in CHECKS], outline_rows(cases, sizes))
    text += "\n## Area of a ring, time per element\n\n"
    text += table(["N", "contour", "contour with arcs", "flat polyline"], area_rows(cases, sizes))
    text += "\n## Short calls\n\n"
    text += table(["what", "function", "time per call", "pairs that meet", "Eigen"],
                  short_call_rows(cases))
    program = list(program_rows(cases))
    if program:
        text += "\n## The program on large files\n\n"
        text += table(["what", "N", "time per point", "whole"], program)
    path.write_text(text)


# The plots.

BLUE, ORANGE, GREEN, RED, PURPLE = "#0072b2", "#e69f00", "#009e73", "#d55e00", "#9467bd"

PANEL_WIDTH, PANEL_HEIGHT = 300, 300
LEFT, TOP, GAP, BOTTOM, LEGEND_ROW = 66, 66, 48, 54, 20


class Series:
    """A line of a panel: points (N, seconds), and how to draw it."""

    def __init__(self, title, points, color, dash="", marker="disc"):
        self.title = title
        self.points = sorted(points)
        self.color = color
        self.dash = dash
        self.marker = marker


class Guide:
    """A line of constant time per item."""

    def __init__(self, title, per_item):
        self.title = title
        self.per_item = per_item


class LogScale:
    """Maps decades to pixels."""

    def __init__(self, low, high, start, end):
        self.low, self.high = math.floor(math.log10(low)), math.ceil(math.log10(high))
        self.start, self.end = start, end

    def __call__(self, value):
        share = (math.log10(value) - self.low) / (self.high - self.low)
        return self.start + share * (self.end - self.start)

    def decades(self):
        return range(self.low, self.high + 1)


def svg_text(x, y, content, size=12, anchor="middle", color="#30343b", weight="normal"):
    return (f'<text x="{x:.1f}" y="{y:.1f}" font-size="{size}" text-anchor="{anchor}" '
            f'fill="{color}" font-weight="{weight}">{content}</text>')


def svg_line(x1, y1, x2, y2, color, width=1.0, dash=""):
    dashes = f' stroke-dasharray="{dash}"' if dash else ""
    return (f'<line x1="{x1:.1f}" y1="{y1:.1f}" x2="{x2:.1f}" y2="{y2:.1f}" '
            f'stroke="{color}" stroke-width="{width}"{dashes}/>')


def svg_marker(x, y, series):
    if series.marker == "square":
        return (f'<rect x="{x - 3:.1f}" y="{y - 3:.1f}" width="6" height="6" fill="white" '
                f'stroke="{series.color}" stroke-width="1.5"/>')
    fill = series.color if series.marker == "disc" else "white"
    return (f'<circle cx="{x:.1f}" cy="{y:.1f}" r="3.4" fill="{fill}" stroke="{series.color}" '
            f'stroke-width="1.5"/>')


def decade_text(exponent):
    names = {-9: "1 ns", -8: "10 ns", -7: "100 ns", -6: "1 µs", -5: "10 µs", -4: "100 µs",
             -3: "1 ms", -2: "10 ms", -1: "100 ms", 0: "1 s", 1: "10 s", 2: "100 s"}
    return names.get(exponent, f"1e{exponent} s")


def draw_guide(guide, xscale, yscale):
    """The part of the line within the panel, and its name in the corner."""
    low = max(10.0 ** xscale.low, 10.0 ** yscale.low / guide.per_item)
    high = min(10.0 ** xscale.high, 10.0 ** yscale.high / guide.per_item)
    if low >= high:
        return []
    x1, y1 = xscale(low), yscale(low * guide.per_item)
    x2, y2 = xscale(high), yscale(high * guide.per_item)
    return [svg_line(x1, y1, x2, y2, "#a3a8b0", 1.3, "2 3"),
            svg_text(xscale.end - 8, yscale.start - 9, f"dotted grey: {guide.title}", 10, "end",
                     "#8a8f98")]


def draw_panel(title, series, guide, xscale, yscale, has_labels, xlabel):
    parts = [f'<rect x="{xscale.start}" y="{yscale.end}" width="{PANEL_WIDTH}" '
             f'height="{PANEL_HEIGHT}" fill="#fbfbfc" stroke="#c4c8cf"/>',
             svg_text(xscale.start + PANEL_WIDTH / 2, yscale.end - 10, title, 13, weight="bold")]
    for exponent in xscale.decades():
        x = xscale(10.0 ** exponent)
        parts.append(svg_line(x, yscale.start, x, yscale.end, "#e4e6ea"))
        parts.append(svg_text(x, yscale.start + 17, f"{10 ** exponent:,}", 11))
    for exponent in yscale.decades():
        y = yscale(10.0 ** exponent)
        parts.append(svg_line(xscale.start, y, xscale.end, y, "#e4e6ea"))
        if has_labels:
            parts.append(svg_text(xscale.start - 8, y + 4, decade_text(exponent), 11, "end"))
    parts.append(svg_text(xscale.start + PANEL_WIDTH / 2, yscale.start + 37, xlabel, 12))
    parts += draw_guide(guide, xscale, yscale)
    for line in series:
        places = [(xscale(n), yscale(seconds)) for n, seconds in line.points]
        path = " ".join(f"{x:.1f},{y:.1f}" for x, y in places)
        dashes = f' stroke-dasharray="{line.dash}"' if line.dash else ""
        parts.append(f'<polyline points="{path}" fill="none" stroke="{line.color}" '
                     f'stroke-width="1.9"{dashes}/>')
        parts += [svg_marker(x, y, line) for x, y in places]
    return parts


def draw_legend(entries, y, width):
    parts = []
    column_width = (width - LEFT) / 3
    for i, line in enumerate(entries):
        x = LEFT + column_width * (i % 3)
        row = y + LEGEND_ROW * (i // 3)
        parts.append(svg_line(x, row, x + 34, row, line.color, 1.9, line.dash))
        parts.append(svg_marker(x + 17, row, line))
        parts.append(svg_text(x + 42, row + 4, line.title, 12, "start"))
    return parts


def draw_figure(path, title, xlabel, panels):
    """Panels are (title, series, guide); they share both scales and the legend."""
    points = [p for _, series, _ in panels for line in series for p in line.points]
    if not points:
        return
    xs, ys = [n for n, _ in points], [seconds for _, seconds in points]
    legend = {}
    for _, series, _ in panels:
        for line in series:
            legend.setdefault(line.title, line)
    legend_rows = math.ceil(len(legend) / 3)
    width = LEFT + len(panels) * PANEL_WIDTH + (len(panels) - 1) * GAP + 34
    height = TOP + PANEL_HEIGHT + BOTTOM + legend_rows * LEGEND_ROW + 12
    parts = [f'<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 {width} {height}" '
             f'width="{width}" height="{height}" '
             'font-family="DejaVu Sans, Helvetica, Arial, sans-serif">',
             f'<rect width="{width}" height="{height}" fill="white"/>',
             svg_text(LEFT, 26, title, 16, "start", weight="bold")]
    yscale = LogScale(min(ys), max(ys), TOP + PANEL_HEIGHT, TOP)
    for i, (panel_title, series, guide) in enumerate(panels):
        start = LEFT + i * (PANEL_WIDTH + GAP)
        xscale = LogScale(min(xs), max(xs) * 1.0001, start, start + PANEL_WIDTH)
        xscale.high = max(xscale.low + 1, round(math.log10(max(xs))))
        parts += draw_panel(panel_title, series, guide, xscale, yscale, i == 0, xlabel)
    parts += draw_legend(legend.values(), TOP + PANEL_HEIGHT + BOTTOM + 6, width)
    parts.append("</svg>\n")
    path.write_text("\n".join(parts))


def points_of(cases, function, profile):
    return [(case.size, case.total) for case in cases.values()
            if case.function == function and case.profile == profile and case.total]


def write_fitting_plot(cases, path):
    profiles = (("line", "line", BLUE), ("arc", "arc", ORANGE),
                ("mixed", "8 lines and 8 fillets", GREEN))
    panels = []
    for strategy in STRATEGIES:
        series = []
        for suffix, noise, dash, marker in (("_noisy", "with noise", "", "disc"),
                                            ("", "without noise", "6 4", "ring")):
            for profile, title, color in profiles:
                points = points_of(cases, f"BM_CreateFittingCurve_{strategy}", profile + suffix)
                series.append(Series(f"{title}, {noise}", points, color, dash, marker))
        for profile, title, color in profiles:
            points = points_of(cases, f"BM_PlainComposition_{strategy}", profile + "_noisy")
            series.append(Series(f"{title}, with noise, plain", points, color, "1.5 3", "square"))
        panels.append((f"strategy {strategy}", [line for line in series if line.points],
                       Guide("10 µs per point", 10e-6)))
    draw_figure(path, "Time of one fit", "points", panels)


def write_outline_plot(cases, path):
    panels = []
    for outline in OUTLINES:
        series = [
            Series("contour of segments",
                   points_of(cases, "BM_CheckPolySelfIntersection", outline), BLUE),
            Series("contour with arcs",
                   points_of(cases, "BM_CheckPolySelfIntersection", outline + "_arcs"), BLUE,
                   "6 4", "ring"),
            Series("flat polyline", points_of(cases, "BM_CheckFlatSelfIntersection", outline),
                   PURPLE, "1.5 3", "ring"),
            Series("Boost.Geometry", points_of(cases, "BM_BoostIntersects", outline), ORANGE, "",
                   "square"),
            Series("GEOS", points_of(cases, "BM_GeosIsSimple", outline), GREEN, "", "square"),
            Series("CGAL", points_of(cases, "BM_CgalIsSimple", outline), RED, "", "square"),
        ]
        guide = Guide("500 ns per element", 500e-9) if outline == "needles" else Guide(
            "150 ns per element", 150e-9)
        panels.append((outline, [line for line in series if line.points], guide))
    draw_figure(path, "Time to find that an outline does not cross itself", "elements", panels)


def main():
    results_path, build, output = (pathlib.Path(argument) for argument in sys.argv[1:4])
    results = json.loads(results_path.read_text())
    cases = read_cases(results)
    output.mkdir(parents=True, exist_ok=True)
    write_table(results, cases, build, output / "results.md")
    write_fitting_plot(cases, output / "fitting.svg")
    write_outline_plot(cases, output / "self_intersection.svg")
    failures = [f"{name}: {case.error}" for name, case in cases.items()
                if case.error and not case.error.startswith("left out")]
    for failure in failures:
        print(f"WRONG ANSWER  {failure}", file=sys.stderr)
    return 1 if failures else 0


if __name__ == "__main__":
    sys.exit(main())
