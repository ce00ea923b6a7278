#include "io/drawing/HtmlPoints.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "io/drawing/Band.h"
#include "io/drawing/Feet.h"
#include "io/drawing/Layout.h"
#include "io/drawing/PackedColumn.h"
#include "vorn/io/CheckReport.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

/// What is measured here need not be told to the last bit, and large files stay smaller.
constexpr int kDigits = 9;

/// The cursor tells multiples of a tolerance to four digits.
constexpr double kStepOfTolerance = 1e-5;

/// For points without tolerances.
constexpr double kStepOfSize = 1e-9;

Json Rounded(double value) {
  std::optional<double> const rounded = ParseNumber(FormatShort(value, kDigits));
  if (!rounded) return nullptr;
  return *rounded;
}

template <typename Get>
std::vector<double> Column(std::vector<WPoint> const& points, Get get) {
  std::vector<double> column;
  column.reserve(points.size());
  for (WPoint const& point : points) column.push_back(get(point));
  return column;
}

std::vector<double> SignedDistances(Drawing const& drawing) {
  std::vector<double> distances;
  distances.reserve(drawing.deviations.size());
  for (PointDeviation const& deviation : drawing.deviations) {
    distances.push_back(SignedDistance(deviation));
  }
  return distances;
}

bool IsPackable(double number) { return std::fabs(number) <= kLargestPacked; }

bool IsPacked(Drawing const& drawing) {
  return drawing.points.size() > kMostExactPoints &&
         std::all_of(drawing.points.begin(), drawing.points.end(),
                     [](WPoint const& p) { return IsPackable(p.x) && IsPackable(p.y); }) &&
         std::all_of(drawing.deviations.begin(), drawing.deviations.end(),
                     [](PointDeviation const& d) { return IsPackable(d.distance); });
}

/// What rounded numbers are a multiple of, at most.
double LargestStep(Drawing const& drawing) {
  if (drawing.HasTolerances()) return kStepOfTolerance * drawing.SmallestTolerance();
  Svg::Box const box = Svg::BoxAround(drawing);
  double const size = std::max(box.Width(), box.Height());
  return kStepOfSize * (size > 0.0 ? size : 1.0);
}

Json ToJson(PackedColumn const& column) {
  return {{"decimals", column.decimals},
          {"order", column.order},
          {"count", column.count},
          {"bytes", column.bytes}};
}

Json PackedJson(std::vector<double> const& numbers, double step) {
  double largest = 0.0;
  for (double const number : numbers) largest = std::max(largest, std::fabs(number));
  return ToJson(Pack(numbers, std::min(DecimalsOfStep(step), MostDecimals(largest))));
}

Json TolerancesJson(Drawing const& drawing, bool isPacked) {
  if (!drawing.HasTolerances()) return nullptr;
  if (drawing.IsToleranceUniform()) return drawing.LargestTolerance();
  std::vector<double> const tolerances =
      Column(drawing.points, [](WPoint const& point) { return point.w; });
  return isPacked ? PackedJson(tolerances, LargestStep(drawing)) : Json(tolerances);
}

Json PiecesOfPoints(Drawing const& drawing, bool isPacked) {
  std::vector<double> pieces;
  pieces.reserve(drawing.deviations.size());
  for (PointDeviation const& deviation : drawing.deviations) {
    pieces.push_back(static_cast<double>(deviation.piece));
  }
  if (isPacked) return PackedJson(pieces, 1.0);
  return std::vector<std::size_t>(pieces.begin(), pieces.end());
}

Json OutsideJson(Drawing const& drawing) {
  Json outside = Json::array();
  if (!drawing.HasTolerances()) return outside;
  for (std::size_t i = 0; i < drawing.points.size(); ++i) {
    if (!IsWithinTolerance(drawing.deviations[i], drawing.points[i])) outside.push_back(i);
  }
  return outside;
}

/// The index of the worst point of each piece that has points, over its tolerance if there is one.
std::vector<std::size_t> WorstOfPieces(Drawing const& drawing) {
  bool const isRelative = drawing.HasTolerances();
  auto const sizeOf = [&](std::size_t i) {
    return isRelative ? drawing.deviations[i].relative : drawing.deviations[i].distance;
  };
  constexpr std::size_t kNone = std::numeric_limits<std::size_t>::max();
  std::vector<std::size_t> worst(drawing.pieces.size(), kNone);
  for (std::size_t i = 0; i < drawing.deviations.size(); ++i) {
    std::size_t& found = worst[drawing.deviations[i].piece];
    if (found == kNone || sizeOf(i) > sizeOf(found)) found = i;
  }
  worst.erase(std::remove(worst.begin(), worst.end(), kNone), worst.end());
  return worst;
}

/// A deviation and a tolerance are each rounded by half a step at most, so those farther apart than
/// a step stay on their sides of each other.
bool IsNearItsTolerance(Drawing const& drawing, std::size_t i, double step) {
  return std::fabs(drawing.deviations[i].distance - drawing.points[i].w) <= 2.0 * step;
}

std::vector<std::size_t> KeptExact(Drawing const& drawing) {
  std::vector<std::size_t> kept = WorstOfPieces(drawing);
  if (!drawing.HasTolerances()) return kept;
  double const step = LargestStep(drawing);
  for (std::size_t i = 0; i < drawing.points.size(); ++i) {
    if (IsNearItsTolerance(drawing, i, step)) kept.push_back(i);
  }
  return kept;
}

Json ExactJson(Drawing const& drawing) {
  Json exact = {{"index", Json::array()}, {"signed", Json::array()}, {"w", Json::array()}};
  for (std::size_t const i : KeptExact(drawing)) {
    exact["index"].push_back(i);
    exact["signed"].push_back(SignedDistance(drawing.deviations[i]));
    exact["w"].push_back(drawing.points[i].w);
  }
  return exact;
}

/// Rounded to kDigits, but the very numbers near a tolerance: else they might read as all of it.
Json RoundedDistances(Drawing const& drawing) {
  constexpr double kNear = 1e-8;
  Json array = Json::array();
  for (std::size_t i = 0; i < drawing.deviations.size(); ++i) {
    double const distance = SignedDistance(drawing.deviations[i]);
    double const w = drawing.points[i].w;
    bool const isNear = std::fabs(std::fabs(distance) - w) <= kNear * w;
    array.push_back(isNear ? Json(distance) : Rounded(distance));
  }
  return array;
}

double LengthOf(std::vector<Piece> const& pieces) { return PieceStarts(pieces).back(); }

}  // namespace

Json PointsJson(Drawing const& drawing) {
  bool const isPacked = IsPacked(drawing);
  std::vector<double> const x = Column(drawing.points, [](WPoint const& point) { return point.x; });
  std::vector<double> const y = Column(drawing.points, [](WPoint const& point) { return point.y; });
  Json const w = TolerancesJson(drawing, isPacked);
  if (!isPacked) return {{"x", x}, {"y", y}, {"w", w}};
  double const step = LargestStep(drawing);
  return {{"x", PackedJson(x, step)}, {"y", PackedJson(y, step)}, {"w", w}};
}

Json DeviationsJson(Drawing const& drawing) {
  bool const isPacked = IsPacked(drawing);
  Json json;
  json["signed"] = isPacked ? PackedJson(SignedDistances(drawing), LargestStep(drawing))
                            : RoundedDistances(drawing);
  json["piece"] = PiecesOfPoints(drawing, isPacked);
  json["outside"] = OutsideJson(drawing);
  if (isPacked) json["exact"] = ExactJson(drawing);
  return json;
}

Json BandJson(Drawing const& drawing) {
  if (!drawing.HasTolerances() || drawing.IsToleranceUniform()) return nullptr;
  double const leastLength = IsPacked(drawing) ? LengthOf(drawing.pieces) / kMostBandSections : 0.0;
  Json band = {{"piece", Json::array()},
               {"from", Json::array()},
               {"to", Json::array()},
               {"tolerance", Json::array()}};
  for (Svg::BandSection const& section : Svg::BandSections(drawing, FeetOf(drawing), leastLength)) {
    band["piece"].push_back(section.piece);
    band["from"].push_back(Rounded(section.from));
    band["to"].push_back(Rounded(section.to));
    band["tolerance"].push_back(section.tolerance);
  }
  return band;
}

}  // namespace Vorn::IO
