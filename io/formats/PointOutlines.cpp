#include "vorn/io/PointOutlines.h"

#include <algorithm>
#include <utility>

#include "io/formats/Text.h"
#include "io/pieces/Chains.h"
#include "io/pieces/Flattening.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Outlines.h"

namespace Vorn::IO {

namespace {

/// Pieces that follow each other.
using Run = std::vector<Piece>;

/// The pieces in runs without a gap; one that is back at its start ends.
std::vector<Run> RunsOf(std::vector<Piece> const& pieces) {
  double const tolerance = JointTolerance(pieces);
  std::vector<Run> runs;
  for (Piece const& piece : pieces) {
    bool const goesOn = !runs.empty() &&
                        Distance(runs.back().back().end, piece.start) <= tolerance &&
                        !AreEqual(runs.back().back().end, runs.back().front().start);
    if (!goesOn) runs.emplace_back();
    runs.back().push_back(piece);
  }
  return runs;
}

Run Reversed(Run run) {
  std::reverse(run.begin(), run.end());
  for (Piece& piece : run) piece = Reversed(piece);
  return run;
}

/// Runs that go on with one another as one.
std::vector<Run> Chained(std::vector<Run> runs, double tolerance) {
  if (runs.size() < 2 || !(tolerance > 0.0)) return runs;
  std::vector<Ends> ends;
  ends.reserve(runs.size());
  for (Run const& run : runs) ends.push_back({run.front().start, run.back().end});
  std::vector<Run> outlines;
  for (LinkChain const& chain : ChainsOf(ends, tolerance)) {
    Run& outline = outlines.emplace_back();
    for (Link const& link : chain.links) {
      Run const run = link.isReversed ? Reversed(runs[link.index]) : std::move(runs[link.index]);
      outline.insert(outline.end(), run.begin(), run.end());
    }
  }
  return outlines;
}

/// Takes the points of outlines.
class Taker {
 public:
  Taker(ContourFile const& contour, PointReading const& reading)
      : contour_(contour), flattening_{reading.flattening} {}

  std::vector<PointFile> Take() {
    std::vector<Run> const outlines =
        Chained(RunsOf(contour_.pieces), ChainTolerance(contour_.pieces));
    std::vector<PointFile> files;
    for (std::size_t i = 0; i < outlines.size(); ++i) {
      PointFile file;
      file.outline = outlines.size() > 1 ? i + 1 : 0;
      file.path = contour_.path + OutlineSuffix(file.outline);
      file.units = contour_.units;
      file.hadHeights = contour_.hadHeights;
      file.points = PointsOf(outlines[i], file.path);
      files.push_back(std::move(file));
    }
    return files;
  }

 private:
  std::vector<WPoint> PointsOf(Run const& outline, std::string const& path) {
    std::vector<XY> places = {outline.front().start};
    for (Piece const& piece : outline) {
      piece.IsArc() ? TakeArc(piece, path, &places) : places.push_back(piece.end);
    }
    std::vector<WPoint> points;
    points.reserve(places.size());
    for (XY const& place : places) points.push_back({place.x, place.y, 0.0});
    return points;
  }

  void TakeArc(Piece const& arc, std::string const& path, std::vector<XY>* places) {
    std::size_t const before = places->size();
    // Without a tolerance the reader has refused them where they stand in the file.
    if (!AppendChords(arc, flattening_.tolerance.value_or(0.0), flattening_.chordsLeft, places)) {
      RefuseFile(path, "arcs flattened so finely have more than " + std::to_string(kMostChords) +
                           " chords");
    }
    flattening_.chordsLeft -= places->size() - before;
  }

  ContourFile const& contour_;
  Flattening flattening_;
};

}  // namespace

bool IsPointTable(std::string_view text, std::string const& path, std::optional<Format> format) {
  if (!format) format = FormatOf(path);
  if (format) return *format == Format::Csv;
  std::optional<Format> const byContent = FormatOfContent(text);
  // A preamble of an instrument may look like G-code, and a header like that of pieces.
  return !byContent || *byContent == Format::GCode || *byContent == Format::Csv;
}

std::vector<PointFile> ParsePointOutlines(std::string_view text, std::string const& path,
                                          PointReading const& reading) {
  if (IsPointTable(text, path, reading.format)) {
    return {ParsePoints(text, path, reading.tolerance, reading.columns)};
  }
  bool const asksForColumn =
      reading.columns.IsGiven() || reading.tolerance.use == ToleranceColumn::Use::Required;
  if (asksForColumn) {
    throw Failure(FailureKind::BadArgument, {InputName(path)}, "is no table that has columns");
  }
  ArcUse const arcs = reading.flattening ? ArcUse::Keep : ArcUse::Refuse;
  ContourFile const contour =
      ParseContour(text, InputName(path), ReadOptions{reading.format, reading.flattening, arcs});
  return Taker(contour, reading).Take();
}

PointFile Joined(std::vector<PointFile> const& outlines) {
  PointFile file = outlines.front();
  file.path = file.path.substr(0, file.path.size() - OutlineSuffix(file.outline).size());
  file.outline = 0;
  for (std::size_t i = 1; i < outlines.size(); ++i) {
    std::vector<WPoint> const& points = outlines[i].points;
    file.points.insert(file.points.end(), points.begin(), points.end());
  }
  return file;
}

std::vector<PointFile> ReadPointOutlines(std::string const& path, std::istream& in,
                                         PointReading const& reading) {
  return ParsePointOutlines(ReadTextFile(path, in), path, reading);
}

}  // namespace Vorn::IO
