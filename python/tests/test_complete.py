"""The whole library is there: what the headers declare and what the program can do has a name."""

import pathlib
import re
import subprocess

import pytest
import vorn
from vorn import geometry as g

HEADERS = pathlib.Path(__file__).resolve().parents[2] / "include" / "vorn"


def snake(name):
    words = name.replace("MxV", "Mxv").replace("VxM", "Vxm").replace("3D", "3d")
    return re.sub(r"(?<=[a-z])(?=[A-Z0-9])|(?<=3d)(?=[A-Z])", "_", words).lower()


def public_functions(header, only_static):
    """The names of the public functions of the classes in a header."""
    is_public, names = False, set()
    for line in (HEADERS / header).read_text().splitlines():
        section = re.match(r"\s*(public|protected|private):", line)
        if section:
            is_public = section.group(1) == "public"
        start = r"  static " if only_static else r"  (?:static )?"
        found = re.match(start + r"[\w:<>,&* ]*?\b([A-Z]\w*)\(", line)
        if found and is_public:
            names.add(found.group(1))
    return names


@pytest.mark.parametrize("header, least", [("GeometryUtils.h", 20), ("MathUtils.h", 4)])
def test_every_operation_of_the_core_is_there(header, least):
    names = public_functions(header, only_static=True)
    assert len(names) >= least
    assert {snake(name) for name in names} - set(g.__all__) == set()


def test_every_operation_of_matrices_is_there():
    names = public_functions("Matrix.h", only_static=False) - {"Matrix"}
    assert len(names) > 10
    missing = {snake(name) for name in names if not hasattr(g.Matrix, snake(name))}
    assert missing - set(g.__all__) == set()


def resolve(name):
    """What a dotted name behind "vorn." stands for."""
    value = vorn
    for part in name.split("."):
        value = getattr(value, part)
    return value


#: What the library above the core exports, by the name in Python that it stands behind.
IO_NAMES = {
    "fit": """FitContour FindFineTolerance SuffersFromFineTolerances NeedsSpacing
              IsDeviationRelative NameOf MakeCircuit SharpestCorner IsToleranceStated
              AssignTolerances""",
    "tolerance_per_point": "ToleranceForSpacing",
    "read_points": """ReadPoints ParsePoints ParseColumnChoice ColumnFor IsPointTable PointFile
                      ReadTextFile InputName""",
    "read_outlines": "ReadPointOutlines ParsePointOutlines OutlineSuffix",
    "info": """Analyse CheckRule FindClosePairs FindClosure FindCorners FindDuplicates
               LargestSingleTolerance SpacingOf SuggestTolerance BoxOf PointsBox ReachForNoise""",
    "check": "CheckReport MakeCheckReport SignedDistance IsWithinTolerance AreWithinTolerance",
    "report": "FitReport MeasurePieces Summarise PieceMeasure",
    "summary": "SummaryCsv SummaryHtml SummaryRowOf",
    "simplify": """AverageAlong DropCloseToFirst FindOutliers KeepEvery KeepSpaced Others
                   RuleOfSpacing RuleOfTolerances WithoutLines""",
    "least_squares_line": "FitLine",
    "least_squares_circle": "FitCircle",
    "measure_areas": "MeasureArea MeasureOutlines DepthsOf SenseOf",
    "Areas.net": "NetArea",
    "Areas.to_json": "ToJson",
    "Intersections.to_csv": "ToCsv",
    "Intersections": "Describe Tally",
    "PointsTooCloseError": """SpacingFailure AreTooClose FindClosePair NeededDistance
                              DescribeClosePair""",
    "FileError": "Failure",
    "Contour": "PiecesOf MakeArc MakeCircle MakeLine Joined RemovePiecesWithoutLength",
    "Contour.append_line": "Closed",
    "Contour.area": "SignedAreaOf",
    "Contour.bounds": "ExtentOf",
    "Contour.departure": "DepartureOf",
    "Contour.deviations": "Remeasure DistanceTo Distance",
    "Contour.gaps": "FindGaps DescribeGaps JointTolerance",
    "Contour.intersections": "IntersectionsOf SelfIntersectionsOf",
    "Contour.is_closed": "IsClosed ReturnsToStart",
    "Contour.nearest": "FootOn",
    "Contour.outlines": "OutlinesOf Chained ChainTolerance",
    "Contour.read": """ReadContour ParseContour FormatOf FormatOfContent FormatNamed
                       IsReadAsContour""",
    "Contour.reversed": "Reversed",
    "Contour.runs": "RunsOf",
    "Contour.sample": "PointOnArc",
    "Contour.save": "AtomicFile RequireWritable LockStagedFiles RemoveTemporaries",
    "Contour.to_gcode": "GCodeDecimals",
    "Contour.to_html": "ToHtml",
    "Contour.to_png": "ToPng",
    "Contour.to_svg": "ToSvg Drawing DrawingOf Drawn MakeDrawing DescribeTolerance",
    "Contour.to_text": "ToText ToTextFor MeasureText HoldsContour",
}

#: Texts of messages and tables, which Python has its own functions for.
TEXTS = set("""Counted FormatExact FormatFixed FormatRelative FormatShort LowerCase ParseNumber
               Printable Quoted ShellQuoted""".split())


def exported():
    """The names of the exported functions and classes of the library above the core."""
    pattern = re.compile(r"^(?:class|struct) VORN_IO_EXPORT (\w+)"
                         r"|^VORN_IO_EXPORT [\w:<>, ]+?[ &*]+([A-Z]\w*)\(", re.MULTILINE)
    texts = (path.read_text() for path in sorted((HEADERS / "io").glob("*.h")))
    return {a or b for text in texts for a, b in pattern.findall(text)}


def test_everything_above_the_core_is_there():
    named = {name for names in IO_NAMES.values() for name in names.split()} | TEXTS
    found = exported()
    assert len(found) > 90
    assert found - named == set(), "these have no name in Python"
    assert named - found == set(), "these are no longer in the headers"
    assert all(resolve(name) is not None for name in IO_NAMES)


#: Options that several commands have.
POINTS_FROM = "--tolerance-column --columns --points-from --flatten"
WRITING = """--dxf-entities --dxf-version --svg-plain --chords --feed --gcode-decimals --r-words
             --plane --end --header --footer --safe-height --cut-height --plunge-feed"""

#: The options of the commands, by what says the same in Python.
OPTIONS = {
    "fit": {
        "fit": """--tolerance --tolerance-per-point --units --strategy --effort
                  --largest-step --min-radius --max-radius --between --closed
                  --start --quiet""",
        "read_points": POINTS_FROM,
        "read_outlines": "--outline",
        "fit_many": "--jobs",
        "summary": "--summary",
        "report": "--field --no-time --digits",
        "Contour.save": "--output --to --out-dir --json --svg",
        "Contour.to_text": WRITING,
    },
    "check": {
        "check": "--tolerance --units --closed --all",
        "tolerance_per_point": "--tolerance-per-point",
        "read_points": POINTS_FROM,
        "Contour.read": "--from",
        "Contour.outlines": "--outline",
        "CheckReport.to_csv": "--table",
        "CheckReport.to_json": "--json",
    },
    "info": {
        "info": "--tolerance --units --closed --json",
        "tolerance_per_point": "--tolerance-per-point",
        "read_points": POINTS_FROM,
        "read_outlines": "--outline",
    },
    "plot": {
        "Contour.to_svg": "--tolerance --units --magnify --output --to",
        "Contour.to_html": "--field",
        "Contour.to_png": "--dpi --width",
        "tolerance_per_point": "--tolerance-per-point",
        "read_points": POINTS_FROM,
        "Contour.outlines": "--outline",
    },
    "convert": {
        "Contour.read": "--from --flatten",
        "Contour": "--units",
        "Contour.outlines": "--outline",
        "Contour.save": "--output --to",
        "Contour.departure": "--tolerance",
        "Contour.to_text": WRITING,
    },
    "area": {
        "measure_areas": "--close",
        "Areas.to_json": "--json",
        "Contour.read": "--from --flatten",
        "Contour": "--points --units",
        "read_points": "--columns",
        "Contour.outlines": "--outline",
    },
    "intersect": {
        "Contour.intersections": "--fail-if-any",
        "Contour.read": "--from --flatten",
        "Contour.outlines": "--outline --outline-b",
        "Intersections.to_csv": "--output",
        "Intersections.to_json": "--json",
    },
    "simplify": {
        "simplify": """--tolerance --tolerance-per-point --units --closed --drop-close --spacing
                       --average --outliers""",
        "read_points": POINTS_FROM,
        "read_outlines": "--outline",
        "write_points": "--output",
        "Simplified.dropped": "--dropped",
    },
}


def help_of(program, *words):
    return subprocess.run([program, *words, "--help"], check=True, capture_output=True,
                          text=True).stdout


def test_every_command_of_the_program_is_there(program):
    commands = re.findall(r"^  ([a-z]+)  ", help_of(program), re.MULTILINE)
    assert set(commands) == set(OPTIONS)


@pytest.mark.parametrize("command", OPTIONS)
def test_every_option_of_the_program_is_there(program, command):
    options = re.findall(r"^  (?:-\w,)?(--[a-z-]+)", help_of(program, command), re.MULTILINE)
    said = {option for names in OPTIONS[command].values() for option in names.split()}
    assert set(options) - {"--help"} == said
    assert all(resolve(name) is not None for name in OPTIONS[command])
