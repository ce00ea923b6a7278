#pragma once

/// What 'contour fit --help' says beside the options.
namespace Vorn::Cli {

inline constexpr char const* kFitText =
    "Fit a contour of lines and arcs to measured points, so that it passes every point within\n"
    "its tolerance. Prints a table of the pieces and a summary, or writes the contour to files.";

inline constexpr char const* kFitFooter =
    R"(
Tolerance: at most one of the three options. Without one, the column w of the file counts, and
without that its comment "# tolerance T". Neighbouring points must be more than 1.5 times the
sum of their tolerances apart for the strategies mixed and cells; fewest takes any spacing.

Strategies: fewest, which is used when none is named, takes noisy points and scans that are denser
than their tolerance, does not depend on how the part lies, and proves below which number of pieces
no contour can go: 29 (26 at least). Between neighbouring points that lie far apart its arcs may
bulge; --largest-step and --between limit that. mixed and cells go along the points run by run; arc
makes one arc of them all.

Closed contours: with --closed auto a contour is closed when its last point is the first one
again, or when its ends are no more than 1.5 times as far apart as the five points next to
either end and the contour does not turn back between them (by more than 135 degrees). A thin
body that is open at one end and a contour with its seam in a very sharp corner look alike, and
so do a closed contour and one that is open by a single step: then say --closed yes or no. The
strategy fewest begins where it suits and closes exactly. For the others the contour is cut open at
--start or else where it turns most (without a corner: where two pieces meet) and fitted all the way
round. Both ends are moved to one common point where that keeps every point within its tolerance;
otherwise a short line joins them, and where no line within the tolerance can, the gap is reported
and the exit code is 1. A full circle comes out as two half circles.

Deviations are multiples of the tolerance of the point: up to 1 is within tolerance. They are
printed as the fit reports them, and as measured again by the program over every point; the larger
counts. Up to 1 + 1e-6 counts as within, for the rounding of the measurement. Points are counted
from 0. The strategy arc reports its deviation as a length, and no point.

Outputs: the ending of a file tells its format: .json (the contour with deviations and all),
.csv, .dxf, .nc or .gcode, .wkt, .geojson (the contour; see 'contour convert --help' for what each
keeps), .svg, .png, .html (drawings). --to tells it for - and for other endings. Numbers are written
so that they read back as the same doubles, but for G-code, which is rounded. Every file that holds
the contour is read back and measured before the word "within" is said. With -o - the table is
not printed.

Measurement: below the table stands what the points of each piece say by themselves: radius or
direction of least squares with its standard deviation (+-), the form error (from the outermost
point on one side to that on the other), the standard deviation of the points and the angle at which
the next piece goes on. A fitted radius is one of many that the tolerance admits and no measurement.
The points of a piece are those that are nearest to it.

Many files: each is fitted by itself, several at once, and has a line with its points, pieces,
largest deviation, time and result. Those that fail do not stop the others; their whole messages go
to standard error. Lines come in the order of the files, and the same files give the same bytes
whatever --jobs is (--no-time leaves out what differs from run to run). The exit code is the worst
of all files, in the order 70, 3, 2, 4, 5, 1, 0. With --summary one table tells of all files.

Exit codes:
  0   every point is within its tolerance
  1   the contour, or a file of it, leaves the tolerance of a point, or a closed contour has a gap
      (table and files are written)
  2   wrong usage
  3   a file cannot be read or written, or a line of the points file is wrong
  4   two neighbouring points are too close for their tolerances (strategies mixed and cells), or
      coincide (--tolerance-per-point)
  5   no fit, or a contour that stops before the last point (then table and files are written)
  70  internal error
  130 interrupted

Output files are written whole or not at all.

Examples:
  contour fit part.csv -t 0.02
  contour fit part.csv -t 0.02 -o part.dxf -o part.svg -o part.json
  contour fit part.csv -t 0.02 -o part.nc --feed 600
  contour fit - -t 0.02 -o - --to dxf < part.csv > part.dxf
  contour fit part.csv --tolerance-per-point 0.05 --strategy cells -o part.json
  contour fit part.csv -t 0.02 -o part.html --field part=Cam --field date=2026-11-30
  contour fit outline.csv -t 0.01 --closed yes --strategy mixed --start 120
  contour fit scan.csv -t 0.01 --largest-step 30 --effort wide -o scan.dxf
  contour fit scans/*.csv -t 0.02 --out-dir fitted --to json,dxf -j 8
)";

}  // namespace Vorn::Cli
