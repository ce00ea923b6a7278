#include "vorn/io/JoinedFit.h"

#include <algorithm>
#include <cstdint>
#include <limits>
#include <optional>
#include <set>

#include "vorn/io/Failure.h"
#include "vorn/io/Outlines.h"
#include "vorn/io/PointOutlines.h"

namespace Vorn::IO {

namespace {

PointFile JoinedPoints(std::vector<FitReport> const& reports) {
  std::vector<PointFile> files;
  files.reserve(reports.size());
  for (FitReport const& report : reports) files.push_back(report.file);
  return Joined(files);
}

void AppendRanges(FitReport const& report, std::size_t firstPoint, FitReport* joined) {
  if (!report.ranges) joined->ranges.reset();
  if (!joined->ranges) return;
  for (PointRange range : *report.ranges) {
    range.first += firstPoint;
    joined->ranges->push_back(range);
  }
}

void AppendDeviations(FitReport const& report, std::size_t firstPiece, FitReport* joined) {
  for (PointDeviation deviation : report.remeasured.points) {
    deviation.piece += firstPiece;
    joined->remeasured.points.push_back(deviation);
  }
}

/// What no fit of an outline can go below adds up, if it is known for each of them.
void AppendBound(FitReport const& report, FitReport* joined) {
  std::optional<std::size_t>& bound = joined->fit.fewestPossible;
  if (!bound) return;
  if (report.fit.fewestPossible) {
    *bound += *report.fit.fewestPossible;
  } else {
    bound.reset();
  }
}

/// What the fit itself says is a multiple of a tolerance; of one arc it is a length, and left out.
void AppendAnswer(FitReport const& report, std::size_t firstPoint, FitReport* joined) {
  joined->fit.seconds += report.fit.seconds;
  bool const isLarger =
      report.fit.deviationIndex >= 0 && !(report.fit.deviation <= joined->fit.deviation);
  if (!isLarger) return;
  joined->fit.deviation = report.fit.deviation;
  joined->fit.deviationIndex = static_cast<std::int32_t>(firstPoint) + report.fit.deviationIndex;
}

void Append(FitReport const& report, FitReport* joined) {
  std::size_t const firstPoint = joined->remeasured.points.size();
  std::size_t const firstPiece = joined->pieces.size();
  joined->pieces.insert(joined->pieces.end(), report.pieces.begin(), report.pieces.end());
  AppendRanges(report, firstPoint, joined);
  AppendDeviations(report, firstPiece, joined);
  AppendAnswer(report, firstPoint, joined);
  AppendBound(report, joined);
  joined->verdict = std::max(joined->verdict, report.verdict);
}

/// The outline nearest to the first point of each report; nothing when two have the same one.
std::optional<std::vector<std::size_t>> OutlineOfEach(std::vector<ContourFile> const& outlines,
                                                      std::vector<FitReport> const& reports) {
  std::vector<Piece> pieces;
  std::vector<std::size_t> outlineOfPiece;
  for (std::size_t i = 0; i < outlines.size(); ++i) {
    pieces.insert(pieces.end(), outlines[i].pieces.begin(), outlines[i].pieces.end());
    outlineOfPiece.resize(pieces.size(), i);
  }
  std::vector<WPoint> firsts;
  firsts.reserve(reports.size());
  for (FitReport const& report : reports) firsts.push_back(report.file.points.front());
  std::vector<std::size_t> found;
  std::set<std::size_t> taken;
  for (PointDeviation const& deviation : Remeasure(firsts, pieces).points) {
    found.push_back(outlineOfPiece[deviation.piece]);
    if (!taken.insert(found.back()).second) return {};
  }
  return found;
}

FileMeasure MeasuredOutlines(std::vector<ContourFile> const& outlines,
                             std::vector<std::size_t> const& outlineOf,
                             std::vector<FitReport> const& reports) {
  FileMeasure measure;
  measure.isWithin = true;
  std::size_t firstPoint = 0;
  for (std::size_t i = 0; i < reports.size(); ++i) {
    std::vector<WPoint> const& points = reports[i].file.points;
    Remeasured const remeasured = Remeasure(points, outlines[outlineOf[i]].pieces);
    measure.isWithin = measure.isWithin && AreWithinTolerance(remeasured, points);
    // Written so that what is not a number counts as the largest.
    if (i == 0 || !(remeasured.Worst().relative <= measure.relative)) {
      measure.relative = remeasured.Worst().relative;
      measure.point = firstPoint + remeasured.worst;
    }
    firstPoint += points.size();
  }
  return measure;
}

}  // namespace

FitReport Joined(std::vector<FitReport> const& reports) {
  FitReport joined = reports.front();
  joined.file = JoinedPoints(reports);
  joined.fit = {};
  joined.fit.code = ErrorCode::Ok;
  joined.fit.fewestPossible = 0;
  joined.fit.deviation = std::numeric_limits<double>::quiet_NaN();
  joined.closure = {};
  joined.closure.reason = std::to_string(reports.size()) + " outlines";
  joined.seam = 0;
  joined.isFullCircle = false;
  joined.pieces.clear();
  joined.ranges.emplace();
  joined.remeasured = {};
  for (FitReport const& report : reports) Append(report, &joined);
  auto const& points = joined.remeasured.points;
  auto const worst =
      std::max_element(points.begin(), points.end(),
                       [](auto const& a, auto const& b) { return a.relative < b.relative; });
  joined.remeasured.worst = static_cast<std::size_t>(worst - points.begin());
  return joined;
}

FileMeasure MeasureText(std::string_view text, Format format,
                        std::vector<FitReport> const& reports) {
  try {
    std::vector<ContourFile> const outlines = OutlinesOf(ParseContour(text, "the file", format));
    auto const outlineOf = OutlineOfEach(outlines, reports);
    if (outlineOf) return MeasuredOutlines(outlines, *outlineOf, reports);
  } catch (Failure const&) {
    // The measure below says what is wrong.
  }
  return MeasureText(text, format, Joined(reports).file.points);
}

}  // namespace Vorn::IO
