#include "support/ReferenceFitting.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <map>
#include <optional>
#include <stdexcept>

#include "vorn/MathUtils.h"

namespace Vorn::Testing {

namespace {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Triangle = GeometryUtils::Triangle;
using IndexedPoint = GeometryUtils::IndexedPoint;
using ProgressBase = GeometryUtils::ProgressBase;
using Cell = std::vector<Triangle>;

// The angular literals of the library; not the doubles nearest to pi, two pi and half pi.
constexpr double kPi = 3.14159265358979;
constexpr double kTwoPi = 6.28318530717958;
constexpr double kHalfPi = 1.570796326794895;

constexpr double kSmallestNormal = 2.2250738585072014e-308;

// Above these sizes a cell is rebuilt from fewer points.
constexpr std::size_t kMaxLineTriangles = 625000 / 8;
constexpr std::size_t kMaxArcTriangles = 625000 / 32;

constexpr int kMaxRefinements = 100;

bool IsRunInside(std::vector<WPoint> const& points, std::int64_t first, std::int64_t count) {
  return first >= 0 && count >= 0 && first + count <= static_cast<std::int64_t>(points.size());
}

WPoint const& At(std::vector<WPoint> const& points, std::int64_t index) {
  return points.at(static_cast<std::size_t>(index));
}

Point ToPoint(WPoint const& p) { return {p.x, p.y}; }

double Distance(Point const& p, Point const& q) { return std::sqrt(GeometryUtils::GetDist2(p, q)); }

double Angle(Point const& center, Point const& p) {
  return std::atan2(p.y - center.y, p.x - center.x);
}

/// All pieces of first ∩ second, by triangle of the first cell and then of the second.
Cell Intersect(Cell const& first, Cell const& second) {
  Cell pieces;
  for (Triangle const& t : first) {
    for (Triangle const& u : second) GeometryUtils::GetOverlapping(t, u, &pieces);
  }
  return pieces;
}

// --- Line fitting -------------------------------------------------------------------------------

struct LineSegment {
  Point start;
  Point end;
};

/// How one growth of a line run ended.
enum class GrowthEnd {
  TookAll,       ///< all points up to the limit are in the cell
  StoppedEarly,  ///< the next point does not fit; the cell is that of the points taken
  TurnedBack,    ///< the next point turns back: grow again, up to the points taken
  NoChain,       ///< the thinned chain has no cell: grow again, up to the points taken
  Failed,        ///< the call fails
};

struct Growth {
  GrowthEnd end;
  std::int32_t taken;
  Cell cell;
};

/// The arguments of one call of `GetFittingLine`, and the form of its cells.
class LineCall {
 public:
  LineCall(std::vector<WPoint> const& points, std::int32_t start, bool lastAttempt,
           std::vector<std::int32_t> const& indexList, ProgressBase const& progress)
      : points_(points),
        start_(start),
        lastAttempt_(lastAttempt),
        indexList_(indexList),
        progress_(progress) {}

  bool XOfY() const { return xOfY_; }

  Growth Grow(std::int32_t limit) {
    WPoint const first = At(points_, start_);
    WPoint previous = first;
    Cell cell;
    for (std::int32_t n = 1; n < limit;) {
      WPoint const next = At(points_, start_ + n);
      if (n > 1 &&
          !ReferenceFitting::IsValidLineOrder(ToPoint(first), ToPoint(previous), ToPoint(next))) {
        return {GrowthEnd::TurnedBack, n, {}};
      }
      Cell pair;
      if (PairCell(previous, next, &pair) != ErrorCode::Ok) {
        return {GrowthEnd::StoppedEarly, n, cell};
      }
      if (n == 1) {
        cell = pair;
      } else if (cell.size() > kMaxLineTriangles) {
        GrowthEnd const rebuilt = RebuildFromChain(n, next, &cell);
        if (rebuilt != GrowthEnd::TookAll) return {rebuilt, n, {}};
      } else {
        Cell const common = Intersect(cell, pair);
        if (common.empty()) return {GrowthEnd::StoppedEarly, n, cell};
        cell = common;
      }
      previous = next;
      ++n;
      ReferenceFitting::SetProgressState(progress_, start_ + n - 1);
    }
    return {GrowthEnd::TookAll, limit, cell};
  }

 private:
  ErrorCode PairCell(WPoint const& a, WPoint const& b, Cell* pair) {
    return GeometryUtils::GetLineTriangles(a, b, &formFixed_, &xOfY_, pair);
  }

  /// Replaces the cell by that of the chain first -> extreme points -> next, `taken` points being
  /// accepted so far.
  GrowthEnd RebuildFromChain(std::int32_t taken, WPoint const& next, Cell* cell) {
    WPoint const first = At(points_, start_);
    std::vector<std::int32_t> extremes;
    if (!ReferenceFitting::GetDeviationFromLineParameters(ToPoint(first), ToPoint(next), points_,
                                                          start_ + 1, taken - 1, &extremes)) {
      return GrowthEnd::Failed;
    }
    for (std::int32_t index : indexList_) {
      if (index >= start_ + 1 && index <= start_ + taken - 1) extremes.push_back(index);
    }
    std::sort(extremes.begin(), extremes.end());
    extremes.erase(std::unique(extremes.begin(), extremes.end()), extremes.end());

    std::vector<WPoint> chain{first};
    for (std::int32_t index : extremes) chain.push_back(At(points_, index));
    chain.push_back(next);

    Cell rebuilt;
    for (std::size_t i = 0; i + 1 < chain.size(); ++i) {
      Cell pair;
      if (PairCell(chain[i], chain[i + 1], &pair) != ErrorCode::Ok) {
        return lastAttempt_ ? GrowthEnd::NoChain : GrowthEnd::Failed;
      }
      rebuilt = i == 0 ? pair : Intersect(rebuilt, pair);
      if (rebuilt.empty()) return GrowthEnd::NoChain;
    }
    *cell = rebuilt;
    return GrowthEnd::TookAll;
  }

  std::vector<WPoint> const& points_;
  std::int32_t start_;
  bool lastAttempt_;
  std::vector<std::int32_t> const& indexList_;
  ProgressBase const& progress_;
  bool formFixed_ = false;
  bool xOfY_ = false;
};

// --- Arc fitting over cells ---------------------------------------------------------------------

/// A run of measured points with the ends that its arc must keep.
struct ArcRun {
  std::vector<WPoint> const& points;
  std::int32_t first;
  std::int32_t count;
  bool startFixed;
  Point start;
  bool endFixed;
  Point end;
  bool ccw;
};

IndexedPoint ToSample(std::vector<WPoint> const& points, std::int32_t index) {
  WPoint const& p = At(points, index);
  return {ToPoint(p), p.w, index};
}

std::vector<IndexedPoint> MakeSamples(std::vector<WPoint> const& points, std::int32_t first,
                                      std::int32_t count, std::vector<IndexedPoint> const& old) {
  std::vector<IndexedPoint> samples;
  if (old.empty()) {
    for (std::int32_t i = 0; i < count; ++i) samples.push_back(ToSample(points, first + i));
    return samples;
  }
  samples.push_back(ToSample(points, first));
  samples.insert(samples.end(), old.begin() + 1, old.end());
  samples.push_back(ToSample(points, first + count - 1));
  return samples;
}

ErrorCode TripleCell(ArcRun const& run, std::vector<IndexedPoint> const& samples, int i0, int i1,
                     int i2, Cell* cell) {
  double coords[6];
  bool usedFirst = false;
  bool usedLast = false;
  ReferenceFitting::TriPointsCoordsToArray(&samples, i0, i1, i2, run.startFixed, run.start,
                                           run.endFixed, run.end, &usedFirst, &usedLast, coords);
  auto const tolerance = [&samples](int i) { return samples[static_cast<std::size_t>(i)].w; };
  WPoint const first{coords[0], coords[1], tolerance(i0)};
  WPoint const middle{coords[2], coords[3], tolerance(i1)};
  WPoint const last{coords[4], coords[5], tolerance(i2)};
  return GeometryUtils::GetCircleTriangles(first, middle, last, usedFirst, usedLast, 0, cell);
}

/// One pass over the triples of the samples.
class ArcPass {
 public:
  ArcPass(ArcRun const& run, std::vector<IndexedPoint> const& samples, bool guarded, Cell* cell)
      : run_(run), samples_(samples), guarded_(guarded), cell_(cell), used_(samples.size(), false) {
    cell_->clear();
  }

  /// The step at which the cell grew too large, or 0 when the pass came to its end.
  int TooLargeAt() const { return tooLargeAt_; }

  ErrorCode Run(bool leadWithWholeRun) {
    int const size = static_cast<int>(samples_.size());
    if (leadWithWholeRun && size >= 3) {
      ErrorCode const code = Add(0, (size - 1) / 2, size - 1);
      if (code != ErrorCode::Ok) return code;
    }
    for (int step = 1; step <= (size - 1) / 2; ++step) {
      for (int mirror = 0; mirror <= 1; ++mirror) {
        int i0 = 0;
        int i1 = 0;
        int i2 = 0;
        ReferenceFitting::GetTriPointIndices(step, size, mirror, &i0, &i1, &i2);
        if (IsUsed(i0) && IsUsed(i1) && IsUsed(i2)) continue;
        bool const isFirst = isEmpty_;
        ErrorCode const code = Add(i0, i1, i2);
        if (code != ErrorCode::Ok) return code;
        if (guarded_ && !isFirst && cell_->size() > kMaxArcTriangles) {
          tooLargeAt_ = step;
          return ErrorCode::Ok;
        }
      }
    }
    return ErrorCode::Ok;
  }

 private:
  bool IsUsed(int i) const { return used_[static_cast<std::size_t>(i)]; }

  ErrorCode Add(int i0, int i1, int i2) {
    for (int i : {i0, i1, i2}) used_[static_cast<std::size_t>(i)] = true;
    Cell triple;
    ErrorCode const code = TripleCell(run_, samples_, i0, i1, i2, &triple);
    if (code != ErrorCode::Ok) return code;
    *cell_ = isEmpty_ ? triple : Intersect(*cell_, triple);
    isEmpty_ = false;
    return cell_->empty() ? ErrorCode::NoFit : ErrorCode::Ok;
  }

  ArcRun const& run_;
  std::vector<IndexedPoint> const& samples_;
  bool guarded_;
  Cell* cell_;
  std::vector<bool> used_;
  bool isEmpty_ = true;
  int tooLargeAt_ = 0;
};

/// Builds the cell of all centres; thins the samples, and starts again, whenever it grows too
/// large. A thinning that did not shorten the list would repeat for ever: the pass after it is
/// unguarded.
ErrorCode BuildArcCell(ArcRun const& run, std::vector<IndexedPoint>* samples, Cell* cell) {
  bool guarded = true;
  for (bool isFirstPass = true;; isFirstPass = false) {
    ArcPass pass(run, *samples, guarded, cell);
    ErrorCode const code = pass.Run(!isFirstPass);
    if (code != ErrorCode::Ok || pass.TooLargeAt() == 0) return code;

    std::size_t const before = samples->size();
    Point start = run.start;
    Point end = run.end;
    ErrorCode const reduced = ReferenceFitting::ReduceCircleArcPoints(
        samples, cell, pass.TooLargeAt(), run.startFixed, &start, run.endFixed, &end, run.points,
        run.first, run.count, run.ccw);
    if (reduced != ErrorCode::Ok) return reduced;
    guarded = samples->size() < before;
  }
}

/// The radius for the centre, which moves when both ends are fixed.
ErrorCode ChooseRadius(ArcRun const& run, Point* centre, double* radius) {
  double lowest = 0.0;
  double highest = 0.0;
  auto const range = [&] {
    return ReferenceFitting::GetRadiusRange(run.points, run.first, run.count, centre->x, centre->y,
                                            -1.0, &lowest, &highest);
  };
  if (!range()) return ErrorCode::NoFit;
  if (run.startFixed && run.endFixed) {
    Point adjusted;
    if (!ReferenceFitting::AdjustCenter(run.start, run.end, *centre, &adjusted)) {
      return ErrorCode::Failed;
    }
    *centre = adjusted;
    if (!range()) return ErrorCode::NoFit;
  }
  if (run.startFixed) {
    *radius = Distance(*centre, run.start);
  } else if (run.endFixed) {
    *radius = Distance(*centre, run.end);
  } else {
    *radius = (lowest + highest) * 0.5;
  }
  return *radius < lowest || *radius > highest ? ErrorCode::NoFit : ErrorCode::Ok;
}

bool SnapEnd(ArcRun const& run, Point const& centre, double radius, bool fixed, std::int32_t index,
             Point* end) {
  return fixed || GeometryUtils::GetNearestPointOnCircle(centre, radius,
                                                         ToPoint(At(run.points, index)), end);
}

void MeasureArc(ArcRun const& run, Point const& centre, double radius, double* deviation,
                std::int32_t* deviationIndex) {
  for (std::int32_t i = run.first; i < run.first + run.count; ++i) {
    WPoint const& p = At(run.points, i);
    double const relative = std::fabs(radius - Distance(ToPoint(p), centre)) / p.w;
    if (i == run.first || relative > *deviation) {
      *deviation = relative;
      *deviationIndex = i;
    }
  }
}

/// What the longest search keeps of its last good run.
struct SavedArc {
  Point start;
  Point end;
  std::int32_t count;
  Point centre;
  double radius;
  bool ccw;
  double deviation;
  std::int32_t deviationIndex;
  Cell cells;
  std::vector<IndexedPoint> samples;
};

// --- Driver -------------------------------------------------------------------------------------

void AppendStart(std::vector<Elem>* contour, Point const& start) {
  Elem elem;
  elem.type = ElemType::Segment;
  elem.end = start;
  contour->push_back(elem);
}

void AppendArc(std::vector<Elem>* contour, Point const& start, Point const& end,
               Point const& center, double radius, bool ccw) {
  Elem elem;
  elem.type = ElemType::Arc;
  elem.end = end;
  elem.center = center;
  elem.radius = radius;
  elem.direction = ccw ? 1.0 : -1.0;
  elem.startAngle = Angle(center, start);
  elem.endAngle = Angle(center, end);
  contour->push_back(elem);
}

/// One fitted element of either kind.
struct Piece {
  bool isArc;
  Point start;
  Point end;
  std::int32_t count;
  double deviation;
  std::int32_t deviationIndex;
  Point centre;
  double radius;
  bool ccw;
};

/// One call of the mixed strategy.
class MixedDriver {
 public:
  MixedDriver(std::vector<WPoint> const& points, ProgressBase const& progress)
      : points_(points), progress_(progress), size_(static_cast<std::int32_t>(points.size())) {}

  void Run(std::vector<Elem>* contour, double* maxDeviation, std::int32_t* maxDeviationIndex) {
    *maxDeviation = -1.0;
    *maxDeviationIndex = -1;
    startFixed_ = false;
    current_ = ToPoint(points_.front());
    for (first_ = 0; first_ + 1 < size_;) {
      std::optional<Piece> const piece = BestPiece();
      if (!piece || piece->count < 2) return;
      if (contour->empty()) AppendStart(contour, piece->start);
      if (piece->isArc) {
        AppendArc(contour, piece->start, piece->end, piece->centre, piece->radius, piece->ccw);
      } else {
        AppendStart(contour, piece->end);
      }
      if (*maxDeviation < 0.0 || piece->deviation > *maxDeviation) {
        *maxDeviation = piece->deviation;
        *maxDeviationIndex = piece->deviationIndex;
      }
      startFixed_ = true;
      current_ = piece->end;
      first_ += piece->count - 1;
    }
  }

 private:
  std::optional<Piece> BestPiece() {
    std::int32_t const remaining = size_ - first_;
    ErrorCode lineCode = ErrorCode::Ok;
    std::optional<Piece> const line = FitLine(remaining, &lineCode);
    if (line && line->count > remaining) return line;
    if (line && line->count == 2 && lineCode == ErrorCode::SelfIntersection) return line;

    std::optional<Piece> const arc = FitArc(remaining, line ? std::max(line->count, 3) : 3);
    if (!line || !arc) return line ? line : arc;
    bool const arcWins = arc->count > line->count ||
                         (arc->count == line->count && arc->deviation <= line->deviation);
    return arcWins ? arc : line;
  }

  std::optional<Piece> FitLine(std::int32_t remaining, ErrorCode* lineCode) {
    std::vector<std::int32_t> indexList;
    Piece line{};
    for (int attempt = 1; attempt <= 3; ++attempt) {
      line.start = current_;
      line.end = ToPoint(points_.back());
      ErrorCode const code = ReferenceFitting::GetFittingLine(
          points_, first_, remaining, startFixed_, &line.start, false, &line.end, attempt == 3,
          &line.count, &line.deviation, &line.deviationIndex, &indexList, lineCode, progress_);
      if (code != ErrorCode::Ok) return std::nullopt;
      if (indexList.empty()) break;
    }
    return line;
  }

  std::optional<Piece> FitArc(std::int32_t remaining, std::int32_t minimumRun) {
    Piece arc{};
    arc.isArc = true;
    arc.start = current_;
    arc.end = ToPoint(points_.back());
    Cell cells;
    ErrorCode const code = ReferenceFitting::GetFittingCircle2(
        points_, first_, remaining, minimumRun, startFixed_, &arc.start, false, &arc.end, &cells,
        &arc.count, &arc.centre, &arc.radius, &arc.ccw, &arc.deviation, &arc.deviationIndex,
        progress_);
    if (code != ErrorCode::Ok) return std::nullopt;
    return arc;
  }

  std::vector<WPoint> const& points_;
  ProgressBase const& progress_;
  std::int32_t size_;
  std::int32_t first_ = 0;
  bool startFixed_ = false;
  Point current_;
};

ErrorCode FitArcThroughThree(std::vector<WPoint> const& points, std::vector<Elem>* contour,
                             double* maxDeviation, std::int32_t* maxDeviationIndex) {
  Point const a = ToPoint(points[0]);
  Point const b = ToPoint(points[1]);
  Point const c = ToPoint(points[2]);
  Point centre;
  double radius = 0.0;
  ErrorCode code =
      GeometryUtils::GetCircle(a.x, a.y, b.x, b.y, c.x, c.y, &centre.x, &centre.y, &radius);
  if (code != ErrorCode::Ok) return code;
  bool ccw = false;
  code = GeometryUtils::IsCcw(a, b, c, &ccw);
  if (code != ErrorCode::Ok) return code;
  AppendStart(contour, a);
  AppendArc(contour, a, c, centre, radius, ccw);
  *maxDeviation = 0.0;
  *maxDeviationIndex = -1;
  return ErrorCode::Ok;
}

/// One call of the single-arc strategy with more than three points.
class SingleArcDriver {
 public:
  SingleArcDriver(std::vector<WPoint> const& points, ProgressBase const& progress)
      : points_(points), progress_(progress), size_(static_cast<std::int32_t>(points.size())) {}

  ErrorCode Run(std::vector<Elem>* contour, double* maxDeviation, std::int32_t* maxDeviationIndex) {
    ErrorCode code = ChooseStartingCircle(contour);
    if (code != ErrorCode::Ok) return code;

    *maxDeviation = Measure(maxDeviationIndex);
    *maxDeviationIndex = -1;
    double keptDeviation = -1.0;
    code = Refine(maxDeviationIndex, &keptDeviation);
    if (code != ErrorCode::Ok) return code;

    Point start;
    if (!GeometryUtils::GetNearestPointOnCircle(centre_, radius_, ToPoint(points_.front()),
                                                &start)) {
      return ErrorCode::Failed;
    }
    if (!isShort_ &&
        !GeometryUtils::GetNearestPointOnCircle(centre_, radius_, ToPoint(points_.back()), &end_)) {
      return ErrorCode::Failed;
    }
    contour->clear();
    AppendStart(contour, start);
    AppendArc(contour, start, end_, centre_, radius_, ccw_);
    *maxDeviation = keptDeviation;
    *maxDeviationIndex = -1;
    return ErrorCode::Ok;
  }

 private:
  ErrorCode ChooseStartingCircle(std::vector<Elem>* contour) {
    std::vector<std::int32_t> excluded;
    Point estimatedCentre;
    double estimatedRadius = 0.0;
    if (!ReferenceFitting::GetEstimatedDeviationForCircle(points_, &tolerance_, &excluded,
                                                          &estimatedCentre, &estimatedRadius)) {
      return ErrorCode::Failed;
    }
    std::vector<WPoint> const reduced = WithoutExcluded(excluded);
    auto const reducedSize = static_cast<std::int32_t>(reduced.size());
    if (reducedSize < 2) return ErrorCode::Failed;

    Point start = ToPoint(points_.front());
    end_ = ToPoint(points_.back());
    Cell cells;
    std::int32_t arcCount = 0;
    double deviation = 0.0;
    std::int32_t deviationIndex = -1;
    ErrorCode const code = ReferenceFitting::GetFittingCircle2(
        reduced, 0, reducedSize, 3, false, &start, false, &end_, &cells, &arcCount, &centre_,
        &radius_, &ccw_, &deviation, &deviationIndex, progress_);
    if (code != ErrorCode::Ok && code != ErrorCode::OrientationMismatch) return code;

    if (code == ErrorCode::Ok && arcCount >= reducedSize) {
      AppendStart(contour, start);
      AppendArc(contour, start, end_, centre_, radius_, ccw_);
      return ErrorCode::Ok;
    }
    // The search never answers Ok with fewer than its three points.
    isShort_ = code == ErrorCode::Ok;
    centre_ = estimatedCentre;
    radius_ = estimatedRadius;
    std::int32_t const turning = isShort_ ? arcCount : size_;
    ErrorCode const sense =
        ReferenceFitting::IsCcw(points_, 0, turning, false, ToPoint(points_.front()), false,
                                ToPoint(At(points_, turning - 1)), centre_, &ccw_);
    return sense == ErrorCode::Ok ? ErrorCode::Ok : ErrorCode::NoFit;
  }

  std::vector<WPoint> WithoutExcluded(std::vector<std::int32_t> const& excluded) const {
    std::vector<WPoint> reduced;
    auto next = excluded.begin();
    for (std::int32_t i = 0; i < size_; ++i) {
      if (next != excluded.end() && *next == i) {
        ++next;
        continue;
      }
      WPoint const& p = At(points_, i);
      reduced.push_back({p.x, p.y, tolerance_});
    }
    return reduced;
  }

  double Measure(std::int32_t* index) const {
    return ReferenceFitting::GetMaxObtainedDeviation(points_, 0, size_, centre_, radius_, index);
  }

  ErrorCode Refine(std::int32_t* index, double* keptDeviation) {
    double previous = -1.0;
    for (int iteration = 0; iteration < kMaxRefinements; ++iteration) {
      Point const centreBefore = centre_;
      double const radiusBefore = radius_;
      std::vector<WPoint2> curve;
      if (!ReferenceFitting::CalcDeviationCurve(points_, 0, size_, centre_, radius_, &curve)) {
        return ErrorCode::Failed;
      }
      Point shift;
      if (!ReferenceFitting::CalcCorrectionShiftForCircle(curve, &shift)) return ErrorCode::Failed;
      centre_.x += shift.x;
      centre_.y += shift.y;
      if (!ReferenceFitting::CalcOptimalRadius(
              points_, 0, size_, centre_.x, centre_.y, tolerance_,
              GeometryUtils::CircleRadiusFindingStrategy::MeanDistance, &radius_)) {
        return ErrorCode::NoFit;
      }
      double const current = Measure(index);
      if (previous >= 0.0 && current >= previous) {
        centre_ = centreBefore;
        radius_ = radiusBefore;
        break;
      }
      previous = current;
    }
    *keptDeviation = previous;
    return ErrorCode::Ok;
  }

  std::vector<WPoint> const& points_;
  ProgressBase const& progress_;
  std::int32_t size_;
  double tolerance_ = 0.0;
  Point centre_;
  double radius_ = 0.0;
  bool ccw_ = false;
  bool isShort_ = false;
  Point end_;
};

bool AreNeighboursValid(std::vector<WPoint> const& points) {
  for (std::size_t i = 0; i + 1 < points.size(); ++i) {
    if (!GeometryUtils::IsPointValidToFit(points[i], points[i + 1])) return false;
  }
  return true;
}

}  // namespace

ErrorCode ReferenceFitting::CreateFittingCurve(std::vector<WPoint> const& points,
                                               FittingStrategy strategy, std::vector<Elem>* contour,
                                               double* maxDeviation,
                                               std::int32_t* maxDeviationIndex,
                                               ExecutionState* executionState,
                                               std::int32_t maxPercent) {
  if (contour == nullptr || points.size() < 2) return ErrorCode::Failed;
  ProgressBase const progress{executionState, maxPercent, static_cast<std::int32_t>(points.size())};
  if (strategy == FittingStrategy::SingleArc) {
    if (points.size() < 3) return ErrorCode::Failed;
    if (points.size() == 3) {
      return FitArcThroughThree(points, contour, maxDeviation, maxDeviationIndex);
    }
    return SingleArcDriver(points, progress).Run(contour, maxDeviation, maxDeviationIndex);
  }
  if (!AreNeighboursValid(points)) return ErrorCode::PointsTooClose;
  if (points.size() == 2) {
    AppendStart(contour, ToPoint(points.front()));
    AppendStart(contour, ToPoint(points.back()));
    *maxDeviation = 0.0;
    *maxDeviationIndex = -1;
    return ErrorCode::Ok;
  }
  if (strategy == FittingStrategy::MixedCells) {
    throw std::logic_error("the reference has no second walk of segments first, arcs in between");
  }
  if (strategy != FittingStrategy::Mixed) return ErrorCode::Failed;
  MixedDriver(points, progress).Run(contour, maxDeviation, maxDeviationIndex);
  return ErrorCode::Ok;
}

// --- Line fitting -------------------------------------------------------------------------------

ErrorCode ReferenceFitting::GetFittingLine(std::vector<WPoint> const& points, std::int32_t start,
                                           std::int32_t count, bool startFixed, Point* startPoint,
                                           bool endFixed, Point* endPoint, bool lastAttempt,
                                           std::int32_t* lineCount, double* lineDeviation,
                                           std::int32_t* lineDeviationIndex,
                                           std::vector<std::int32_t>* indexList,
                                           ErrorCode* lineCode, ProgressBase const& progress) {
  if (count < 2 || !IsRunInside(points, start, count)) return ErrorCode::Failed;
  *lineCode = ErrorCode::Ok;

  auto const writeOutputs = [&](LineSegment const& segment, std::int32_t n, double deviation,
                                std::int32_t index) {
    *lineCount = n;
    *startPoint = segment.start;
    *endPoint = segment.end;
    *lineDeviation = deviation;
    *lineDeviationIndex = index;
    SetProgressState(progress, start + n);
  };

  LineCall call(points, start, lastAttempt, *indexList, progress);
  std::int32_t limit = count;
  while (limit > 2) {
    Growth const growth = call.Grow(limit);
    std::int32_t const n = growth.taken;
    if (growth.end == GrowthEnd::Failed) return ErrorCode::Failed;
    if (growth.end == GrowthEnd::TurnedBack || growth.end == GrowthEnd::NoChain) {
      limit = n;
      *lineCode = growth.end == GrowthEnd::TurnedBack ? ErrorCode::SelfIntersection : ErrorCode::Ok;
      continue;
    }

    WPoint const& first = At(points, start);
    WPoint const& last = At(points, start + n - 1);
    LineSegment segment;
    bool const isMade = GetOptimalLineSegment(
        &growth.cell, first.x, first.y, last.x, last.y, call.XOfY(), startFixed, *startPoint,
        endFixed, *endPoint, &segment.start.x, &segment.start.y, &segment.end.x, &segment.end.y);
    std::int32_t index = -1;
    double const deviation =
        isMade ? GetMaxDeviationFromLine(points, start, n, segment.start, segment.end, &index)
               : 0.0;
    bool const fits = isMade && deviation <= 1.0;
    if (fits || (isMade && growth.end == GrowthEnd::TookAll)) {
      writeOutputs(segment, n, deviation, index);
    }
    if (fits) {
      indexList->clear();
      return ErrorCode::Ok;
    }
    if (isMade && growth.end == GrowthEnd::TookAll && !lastAttempt) {
      return GetDeviationFromLineParameters(segment.start, segment.end, points, start + 1, n - 2,
                                            indexList)
                 ? ErrorCode::Ok
                 : ErrorCode::Failed;
    }
    limit = n - 1;
    *lineCode = ErrorCode::Ok;
  }

  // Two points: they are joined, whatever their tolerances.
  LineSegment const segment{startFixed ? *startPoint : ToPoint(At(points, start)),
                            endFixed ? *endPoint : ToPoint(At(points, start + 1))};
  std::int32_t index = -1;
  double const deviation =
      GetMaxDeviationFromLine(points, start, 2, segment.start, segment.end, &index);
  writeOutputs(segment, 2, deviation, index);
  indexList->clear();
  return ErrorCode::Ok;
}

double ReferenceFitting::GetMaxDeviationFromLine(std::vector<WPoint> const& points,
                                                 std::int32_t start, std::int32_t count,
                                                 Point const& a, Point const& b,
                                                 std::int32_t* index) {
  *index = -1;
  if (count < 1 || !IsRunInside(points, start, count)) return 0.0;
  double best = 0.0;
  std::int32_t bestIndex = -1;
  for (std::int32_t i = start; i < start + count; ++i) {
    WPoint const& p = At(points, i);
    double const coords[6] = {a.x, a.y, b.x, b.y, p.x, p.y};
    double distance = 0.0;
    if (!GeometryUtils::GetDeviation(coords, &distance)) return 0.0;
    double const relative = std::fabs(distance) / p.w;
    if (i == start || relative > best) {
      best = relative;
      bestIndex = i;
    }
  }
  *index = bestIndex;
  return best;
}

bool ReferenceFitting::GetDeviationFromLineParameters(Point const& a, Point const& b,
                                                      std::vector<WPoint> const& points,
                                                      std::int32_t start, std::int32_t count,
                                                      double* minDeviation, double* maxDeviation,
                                                      std::int32_t* minIndex,
                                                      std::int32_t* maxIndex) {
  if (count < 1 || !IsRunInside(points, start, count)) return false;
  double la = 0.0;
  double lb = 0.0;
  double lc = 0.0;
  if (!GeometryUtils::GetLineParameters(a.x, a.y, b.x, b.y, &la, &lb, &lc)) return false;
  bool isFirst = true;
  for (std::int32_t i = start; i < start + count; ++i) {
    WPoint const& p = At(points, i);
    double deviation = 0.0;
    if (!GeometryUtils::GetSignedDeviation(la, lb, lc, p.x, p.y, &deviation)) continue;
    if (isFirst || deviation < *minDeviation) {
      *minDeviation = deviation;
      *minIndex = i;
    }
    if (isFirst || deviation > *maxDeviation) {
      *maxDeviation = deviation;
      *maxIndex = i;
    }
    isFirst = false;
  }
  return true;
}

bool ReferenceFitting::GetDeviationFromLineParameters(Point const& a, Point const& b,
                                                      std::vector<WPoint> const& points,
                                                      std::int32_t start, std::int32_t count,
                                                      std::vector<std::int32_t>* indices) {
  double minDeviation = 0.0;
  double maxDeviation = 0.0;
  std::int32_t minIndex = -1;
  std::int32_t maxIndex = -1;
  if (!GetDeviationFromLineParameters(a, b, points, start, count, &minDeviation, &maxDeviation,
                                      &minIndex, &maxIndex)) {
    return false;
  }
  indices->push_back(std::min(minIndex, maxIndex));
  if (minIndex != maxIndex) indices->push_back(std::max(minIndex, maxIndex));
  return true;
}

bool ReferenceFitting::GetOptimalLineSegment(std::vector<Triangle> const* cell, double x1,
                                             double y1, double x2, double y2, bool xOfY,
                                             bool startFixed, Point startPoint, bool endFixed,
                                             Point endPoint, double* sx, double* sy, double* ex,
                                             double* ey) {
  Point center;
  if (!GeometryUtils::GetCenterForLine(startFixed, startPoint, endFixed, endPoint, xOfY, cell,
                                       &center)) {
    return false;
  }
  double const a = xOfY ? 1.0 : center.y;
  double const b = xOfY ? center.y : 1.0;
  double const c = center.x;
  if (!startFixed && !GeometryUtils::GetNearestPointOnLine(a, b, c, {x1, y1}, &startPoint)) {
    return false;
  }
  if (!endFixed && !GeometryUtils::GetNearestPointOnLine(a, b, c, {x2, y2}, &endPoint)) {
    return false;
  }
  *sx = startPoint.x;
  *sy = startPoint.y;
  *ex = endPoint.x;
  *ey = endPoint.y;
  return true;
}

bool ReferenceFitting::IsValidLineOrder(Point const& first, Point const& middle,
                                        Point const& last) {
  double const d1 = GeometryUtils::GetDist2(middle, first);
  double const d2 = GeometryUtils::GetDist2(last, first);
  double const d3 = GeometryUtils::GetDist2(last, middle);
  if (d1 >= d2) return false;
  return d3 + d1 - d2 < 0.0;
}

bool ReferenceFitting::ReduceOverlappedTrianglesQuantityForStraightLine(
    std::vector<WPoint> const& points, int start, int count, double /*tolerance*/,
    std::vector<Triangle>* cell) {
  if (count < 4 || !IsRunInside(points, start, count)) return false;
  WPoint const& first = At(points, start);
  WPoint const& last = At(points, start + count - 1);
  double lowest = 0.0;
  double highest = 0.0;
  int lowestIndex = -1;
  int highestIndex = -1;
  for (int i = start + 1; i < start + count; ++i) {
    WPoint const& p = At(points, i);
    double const coords[6] = {first.x, first.y, last.x, last.y, p.x, p.y};
    double distance = 0.0;
    if (!GeometryUtils::GetDeviation(coords, &distance)) return false;
    if (i == start + 1 || distance < lowest) {
      lowest = distance;
      lowestIndex = i;
    }
    if (i == start + 1 || distance > highest) {
      highest = distance;
      highestIndex = i;
    }
  }
  std::vector<WPoint> run{first, At(points, lowestIndex)};
  if (highestIndex != lowestIndex) run.push_back(At(points, highestIndex));
  run.push_back(last);
  cell->clear();

  Point startPoint = ToPoint(first);
  Point endPoint = ToPoint(last);
  std::int32_t lineCount = 0;
  double lineDeviation = 0.0;
  std::int32_t lineDeviationIndex = -1;
  std::vector<std::int32_t> indexList;
  ErrorCode lineCode = ErrorCode::Ok;
  ProgressBase const silent{nullptr, 100, 100};
  return GetFittingLine(run, 0, static_cast<std::int32_t>(run.size()), false, &startPoint, false,
                        &endPoint, true, &lineCount, &lineDeviation, &lineDeviationIndex,
                        &indexList, &lineCode, silent) == ErrorCode::Ok;
}

void ReferenceFitting::SetProgressState(ProgressBase const& progress, std::int32_t current) {
  if (progress.state == nullptr || progress.total < 1) return;
  std::int64_t percent = progress.maxPercent;
  std::int64_t const left = std::int64_t{progress.total} - current;
  if (left > 0) percent -= left * 100 / progress.total;
  if (percent == 0) percent = 1;
  progress.state->SetProgress(static_cast<std::int32_t>(percent));
}

// --- Arc fitting over cells ---------------------------------------------------------------------

ErrorCode ReferenceFitting::GetFittingCircleO(std::vector<WPoint> const& points, std::int32_t first,
                                              std::int32_t count, bool startFixed, Point* start,
                                              bool endFixed, Point* end,
                                              std::vector<IndexedPoint>* indexedPoints,
                                              std::vector<Triangle>* cells, std::int32_t* arcCount,
                                              Point* centre, double* radius, bool* ccw,
                                              double* deviation, std::int32_t* deviationIndex) {
  *deviationIndex = -1;
  if (count < 3 || !IsRunInside(points, first, count)) return ErrorCode::Failed;
  Triangle const turn{{ToPoint(At(points, first)), ToPoint(At(points, first + count / 2)),
                       ToPoint(At(points, first + count - 1))}};
  double const area = GeometryUtils::GetArea(turn);
  if (area == 0.0) return ErrorCode::Failed;
  ArcRun const run{points, first, count, startFixed, *start, endFixed, *end, area < 0.0};

  *indexedPoints = MakeSamples(points, first, count, *indexedPoints);
  ErrorCode code = BuildArcCell(run, indexedPoints, cells);
  if (code != ErrorCode::Ok) return code;

  Point fittedCentre;
  if (!GeometryUtils::GetCenter(cells, &fittedCentre)) return ErrorCode::Failed;
  double fittedRadius = 0.0;
  code = ChooseRadius(run, &fittedCentre, &fittedRadius);
  if (code != ErrorCode::Ok) return code;

  Point fittedStart = *start;
  Point fittedEnd = *end;
  if (!SnapEnd(run, fittedCentre, fittedRadius, startFixed, first, &fittedStart) ||
      !SnapEnd(run, fittedCentre, fittedRadius, endFixed, first + count - 1, &fittedEnd)) {
    return ErrorCode::Failed;
  }
  *start = fittedStart;
  *end = fittedEnd;
  MeasureArc(run, fittedCentre, fittedRadius, deviation, deviationIndex);
  *arcCount = count;
  *centre = fittedCentre;
  *radius = fittedRadius;
  *ccw = run.ccw;
  return ErrorCode::Ok;
}

ErrorCode ReferenceFitting::GetFittingCircle2(
    std::vector<WPoint> const& points, std::int32_t first, std::int32_t maxCount,
    std::int32_t minCount, bool startFixed, Point* start, bool endFixed, Point* end,
    std::vector<Triangle>* cells, std::int32_t* arcCount, Point* centre, double* radius, bool* ccw,
    double* deviation, std::int32_t* deviationIndex, ProgressBase const& progress) {
  if (minCount > maxCount) return ErrorCode::Failed;
  cells->clear();
  Point workingEnd = *end;
  std::vector<IndexedPoint> samples;
  std::optional<SavedArc> saved;
  ErrorCode code = ErrorCode::Ok;
  std::int32_t triedCount = 0;
  std::int32_t lastTested = 1;
  std::int32_t counter = first + minCount;

  for (std::int32_t n = minCount; n <= maxCount;) {
    code = GetFittingCircleO(points, first, n, startFixed, start, endFixed, &workingEnd, &samples,
                             cells, &triedCount, centre, radius, ccw, deviation, deviationIndex);
    if (code == ErrorCode::OrientationMismatch) {
      if (!IsValidLineOrder(ToPoint(At(points, first)), ToPoint(At(points, first + n - 2)),
                            ToPoint(At(points, first + n - 1)))) {
        code = ErrorCode::SelfIntersection;
        break;
      }
      cells->clear();
      ++n;
      ++counter;
      continue;
    }
    if (code != ErrorCode::Ok) break;

    bool inOrder = !saved || saved->ccw == *ccw;
    for (std::int32_t j = lastTested + 1; inOrder && j < n; ++j) {
      inOrder = IsValidArcOrder(*centre, *ccw, ToPoint(At(points, first)),
                                ToPoint(At(points, first + j - 1)), ToPoint(At(points, first + j)),
                                n != minCount);
    }
    if (!inOrder) {
      code = ErrorCode::SelfIntersection;
      break;
    }
    lastTested = n - 1;
    ++n;
    ++counter;
    if (n <= maxCount) {
      saved = SavedArc{*start, workingEnd, n - 1,           *centre, *radius,
                       *ccw,   *deviation, *deviationIndex, *cells,  samples};
      bool const reachesLast = std::int64_t{first} + n == static_cast<std::int64_t>(points.size());
      if (endFixed && reachesLast) {
        workingEnd = *end;
      } else if (IsRunInside(points, first, n)) {
        workingEnd = ToPoint(At(points, first + n - 1));
      }
    }
    SetProgressState(progress, counter);
  }

  if (code == ErrorCode::Ok) {
    *end = workingEnd;
    *arcCount = triedCount;
    SetProgressState(progress, first + triedCount);
    return ErrorCode::Ok;
  }
  if (!saved) return code;

  if (code == ErrorCode::SelfIntersection) {
    // The cell ends up empty where the samples can be thinned; whether they can is of no interest.
    ReduceCircleArcPoints(
        &saved->samples, &saved->cells, (static_cast<int>(saved->samples.size()) - 1) / 2,
        startFixed, &saved->start, endFixed, &saved->end, points, first, saved->count, saved->ccw);
  }
  *start = saved->start;
  *end = saved->end;
  *cells = saved->cells;
  *arcCount = saved->count;
  *centre = saved->centre;
  *radius = saved->radius;
  *ccw = saved->ccw;
  *deviation = saved->deviation;
  *deviationIndex = saved->deviationIndex;
  SetProgressState(progress, first + saved->count);
  return ErrorCode::Ok;
}

ErrorCode ReferenceFitting::GetFittingCircle1(std::vector<WPoint> const& points, std::int32_t first,
                                              std::int32_t maxCount, std::int32_t minCount,
                                              bool startFixed, Point* start, bool endFixed,
                                              Point* end, std::int32_t* arcCount, Point* centre,
                                              double* radius, bool* ccw, double* deviation,
                                              std::int32_t* deviationIndex) {
  bool workingEndFixed = endFixed;
  Point workingEnd = *end;
  for (std::int32_t n = maxCount; n >= minCount; --n) {
    std::vector<IndexedPoint> samples;
    Cell cells;
    std::int32_t triedCount = 0;
    ErrorCode const code = GetFittingCircleO(points, first, n, startFixed, start, workingEndFixed,
                                             &workingEnd, &samples, &cells, &triedCount, centre,
                                             radius, ccw, deviation, deviationIndex);
    if (code == ErrorCode::Ok) {
      *end = workingEnd;
      *arcCount = n;
      return ErrorCode::Ok;
    }
    workingEndFixed = false;
  }
  return ErrorCode::NoFit;
}

bool ReferenceFitting::IsValidArcOrder(Point const& centre, bool ccw, Point const& p1,
                                       Point const& p2, Point const& p3, bool skipFirstGap) {
  if (!IsValidArcOrder(centre, ccw, p1, p2, p3)) return false;
  double const a1 = Angle(centre, p1);
  double const a2 = Angle(centre, p2);
  double const a3 = Angle(centre, p3);
  auto const isShortGap = [ccw](double from, double to) {
    double gap = to - from;
    if (ccw) {
      if (gap < 0.0) gap += kTwoPi;
      return gap < kHalfPi;
    }
    if (gap > 0.0) gap -= kTwoPi;
    return gap > -kHalfPi;
  };
  return (skipFirstGap || isShortGap(a1, a2)) && isShortGap(a2, a3);
}

// --- Arc point reduction ------------------------------------------------------------------------

ErrorCode ReferenceFitting::ReduceCircleArcPoints(std::vector<IndexedPoint>* samples,
                                                  std::vector<Triangle>* cell, int steps,
                                                  bool firstFixed, Point* first, bool lastFixed,
                                                  Point* last, std::vector<WPoint> const& wpoints,
                                                  std::int32_t begin, std::int32_t count,
                                                  bool ccw) {
  if (count < 1 || !IsRunInside(wpoints, begin, count)) return ErrorCode::Failed;
  Point center;
  if (cell->empty() || !GeometryUtils::GetCenter(cell, &center)) return ErrorCode::Failed;

  // Which samples the triples used, and with which coordinates.
  int const size = static_cast<int>(samples->size());
  std::map<int, Point> usedSamples;
  std::vector<bool> isUsed(samples->size(), false);
  double lastTolerance = 0.0;
  for (int step = 1; step <= steps; ++step) {
    for (int mirror = 0; mirror <= 1; ++mirror) {
      int i[3] = {};
      GetTriPointIndices(step, size, mirror, &i[0], &i[1], &i[2]);
      for (int position : i) {
        if (position < 0 || position >= size) return ErrorCode::Failed;
      }
      if (isUsed[static_cast<std::size_t>(i[0])] && isUsed[static_cast<std::size_t>(i[1])] &&
          isUsed[static_cast<std::size_t>(i[2])]) {
        continue;
      }
      double coords[6];
      bool usedFirst = false;
      bool usedLast = false;
      TriPointsCoordsToArray(samples, i[0], i[1], i[2], firstFixed, *first, lastFixed, *last,
                             &usedFirst, &usedLast, coords);
      for (int k = 0; k < 3; ++k) {
        isUsed[static_cast<std::size_t>(i[k])] = true;
        if (i[k] == 0 && size == 1) continue;
        usedSamples[i[k]] = {coords[2 * k], coords[2 * k + 1]};
        lastTolerance = (*samples)[static_cast<std::size_t>(i[k])].w;
      }
    }
  }
  if (usedSamples.size() < 5) return ErrorCode::Failed;

  // The samples nearest to and farthest from the centre, both ends left out.
  auto const lastUsed = std::prev(usedSamples.end());
  auto nearest = std::next(usedSamples.begin());
  auto farthest = nearest;
  for (auto it = std::next(nearest); it != lastUsed; ++it) {
    double const distance = GeometryUtils::GetDist2(it->second, center);
    if (distance < GeometryUtils::GetDist2(nearest->second, center)) nearest = it;
    if (distance > GeometryUtils::GetDist2(farthest->second, center)) farthest = it;
  }
  if (nearest == farthest) {
    auto const third = static_cast<std::ptrdiff_t>((usedSamples.size() - 1) / 3);
    nearest = std::next(usedSamples.begin(), third);
    farthest = std::next(nearest, third);
  }

  // The direction of the middle of the arc, and the measured point nearest to it.
  Point const runStart = ToPoint(At(wpoints, begin));
  Point const runEnd = ToPoint(At(wpoints, begin + count - 1));
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;
  if (!GeometryUtils::GetLineParameters(runStart.x, runStart.y, runEnd.x, runEnd.y, &a, &b, &c)) {
    return ErrorCode::Failed;
  }
  double na = 0.0;
  double nb = 0.0;
  double nc = 0.0;
  GeometryUtils::GetNormal(a, b, c, center, &na, &nb, &nc);
  double const radius = (Distance(runEnd, center) + Distance(runStart, center)) * 0.5;
  Point candidates[2];
  if (GeometryUtils::GetLineAndCircleIntersection(na, nb, nc, center.x, center.y, radius,
                                                  &candidates[0].x, &candidates[0].y,
                                                  &candidates[1].x, &candidates[1].y) != 2) {
    return ErrorCode::Failed;
  }
  bool const isFirstOnArc = IsValidArcOrder(center, ccw, runStart, candidates[0], runEnd);
  double const middleAngle = Angle(center, candidates[isFirstOnArc ? 0 : 1]);
  std::optional<std::int32_t> middle;
  double middleGap = 0.0;
  for (std::int32_t j = begin + 1; j <= begin + count - 2; ++j) {
    double gap = std::fabs(Angle(center, ToPoint(At(wpoints, j))) - middleAngle);
    if (gap > kPi) gap = kTwoPi - gap;
    if (!middle || gap < middleGap) {
      middle = j;
      middleGap = gap;
    }
  }

  std::vector<IndexedPoint> reduced;
  bool isInserted = !middle.has_value();
  auto const insertMiddle = [&] {
    reduced.push_back(ToSample(wpoints, *middle));
    isInserted = true;
  };
  for (int p = 0; p < size; ++p) {
    IndexedPoint const& sample = (*samples)[static_cast<std::size_t>(p)];
    if (!isInserted && *middle < sample.index) insertMiddle();
    if (p == 0 || p == size - 1 || usedSamples.count(p) == 0) {
      reduced.push_back(sample);
    } else if (p == nearest->first) {
      reduced.push_back({nearest->second, lastTolerance, 0});
    } else if (p == farthest->first) {
      reduced.push_back({farthest->second, lastTolerance, 0});
    } else if (!isInserted && sample.index == *middle) {
      insertMiddle();
    }
  }
  *samples = reduced;
  cell->clear();
  return ErrorCode::Ok;
}

void ReferenceFitting::GetTriPointIndices(int step, int size, int mirror, int* i0, int* i1,
                                          int* i2) {
  bool const isInner = step < size / 3;
  int const a = isInner ? step : 0;
  int const b = isInner ? (step - 1 + size) / 2 : step;
  int const c = size - 1;
  *i0 = mirror == 1 ? size - 1 - c : a;
  *i1 = mirror == 1 ? size - 1 - b : b;
  *i2 = mirror == 1 ? size - 1 - a : c;
}

void ReferenceFitting::TriPointsCoordsToArray(std::vector<IndexedPoint> const* samples, int i0,
                                              int i1, int i2, bool firstFixed, Point const& first,
                                              bool lastFixed, Point const& last, bool* usedFirst,
                                              bool* usedLast, double* const coords) {
  auto const at = [samples](int i) { return samples->at(static_cast<std::size_t>(i)).pt; };
  *usedFirst = firstFixed && i0 == 0;
  *usedLast = lastFixed && i2 == static_cast<int>(samples->size()) - 1;
  Point const triple[3] = {*usedFirst ? first : at(i0), at(i1), *usedLast ? last : at(i2)};
  for (int k = 0; k < 3; ++k) {
    coords[2 * k] = triple[k].x;
    coords[2 * k + 1] = triple[k].y;
  }
}

bool ReferenceFitting::IsValidArcOrder(Point const& center, bool ccw, Point const& p1,
                                       Point const& p2, Point const& p3) {
  double const a1 = Angle(center, p1);
  double const a2 = Angle(center, p2);
  double const a3 = Angle(center, p3);
  if (ccw) return a3 > a1 ? a1 <= a2 && a2 <= a3 : a2 >= a1 || a2 <= a3;
  return a3 <= a1 ? a3 <= a2 && a2 <= a1 : a2 <= a1 || a2 >= a3;
}

// --- Circle estimation and radius choice --------------------------------------------------------

bool ReferenceFitting::GetEstimatedCircle(std::vector<WPoint> const& points, Point* first,
                                          Point* middle, Point* last, Point* center, double* radius,
                                          double* minSpacing) {
  std::size_t const n = points.size();
  if (n < 3) return false;
  auto const distance2 = [&points](std::size_t i, std::size_t j) {
    return GeometryUtils::GetDist2(ToPoint(points[i]), ToPoint(points[j]));
  };
  std::size_t farI = 0;
  std::size_t farJ = 1;
  double largest = distance2(0, 1);
  double smallest = largest;
  for (std::size_t i = 0; i < n; ++i) {
    for (std::size_t j = i + 1; j < n; ++j) {
      double const d2 = distance2(i, j);
      if (d2 > largest) {
        largest = d2;
        farI = i;
        farJ = j;
      }
      if (d2 < smallest) smallest = d2;
    }
  }
  std::optional<std::size_t> between;
  double smallestGap = 0.0;
  for (std::size_t k = 0; k < n; ++k) {
    if (k == farI || k == farJ) continue;
    double const gap = std::fabs(std::sqrt(distance2(k, farI)) - std::sqrt(distance2(k, farJ)));
    if (!between || gap < smallestGap) {
      between = k;
      smallestGap = gap;
    }
  }
  Point const a = ToPoint(points[farI]);
  Point const b = ToPoint(points[*between]);
  Point const c = ToPoint(points[farJ]);
  Point circleCenter;
  double circleRadius = 0.0;
  if (!GeometryUtils::GetCircle(a, b, c, &circleCenter, &circleRadius)) return false;
  *first = a;
  *middle = b;
  *last = c;
  *center = circleCenter;
  *radius = circleRadius;
  *minSpacing = std::sqrt(smallest);
  return true;
}

bool ReferenceFitting::GetEstimatedMaxDeviationForCircle(Point const& first, Point const& middle,
                                                         Point const& last, double radius,
                                                         double* deviation) {
  double const halfChord2 =
      std::min(GeometryUtils::GetDist2(middle, last), GeometryUtils::GetDist2(first, middle));
  *deviation = std::min(radius * 0.25, halfChord2 / (radius * 4.0));
  return true;
}

bool ReferenceFitting::GetEstimatedDeviationForCircle(std::vector<WPoint> const& points,
                                                      double* tolerance,
                                                      std::vector<std::int32_t>* excluded,
                                                      Point* center, double* radius) {
  auto const n = static_cast<std::int32_t>(points.size());
  if (n < 3) return false;
  Point first;
  Point middle;
  Point last;
  Point estimatedCenter;
  double estimatedRadius = 0.0;
  double minSpacing = 0.0;
  double allowance = 0.0;
  if (!GetEstimatedCircle(points, &first, &middle, &last, &estimatedCenter, &estimatedRadius,
                          &minSpacing) ||
      !GetEstimatedMaxDeviationForCircle(first, middle, last, estimatedRadius, &allowance)) {
    return false;
  }
  double const limit = minSpacing / 3.0;
  double const guard = limit * 0.99;
  if (guard == limit || guard <= kSmallestNormal) return false;

  excluded->clear();
  auto const accept = [&] {
    *tolerance = allowance;
    *center = estimatedCenter;
    *radius = estimatedRadius;
    return true;
  };
  if (!(allowance > guard)) return accept();

  auto const isTooClose = [&](std::int32_t i, std::int32_t j) {
    return allowance > Distance(ToPoint(At(points, i)), ToPoint(At(points, j))) / 3.0;
  };
  std::int32_t kept = 0;
  bool isLastTooClose = false;
  for (std::int32_t i = 1; i < n; ++i) {
    if (!isTooClose(kept, i)) {
      kept = i;
    } else if (i == n - 1) {
      isLastTooClose = true;
    } else {
      excluded->push_back(i);
    }
  }
  if (isLastTooClose && excluded->empty()) {
    if (n < 4) return false;
    excluded->push_back(n - 2);
  } else if (isLastTooClose) {
    int notes = 0;
    for (auto it = std::prev(excluded->end()); it != excluded->begin(); --it) {
      if (*it == *std::prev(it) + 1) continue;
      std::int32_t const noted = *it - 1;
      if (++notes < 2) continue;
      if (isTooClose(noted, n - 1)) {
        excluded->push_back(n - 1);
      } else {
        excluded->insert(it, noted);
      }
      break;
    }
  }
  if (n - static_cast<std::int32_t>(excluded->size()) < 3) {
    excluded->clear();
    return false;
  }
  return accept();
}

bool ReferenceFitting::GetRadiusRange(std::vector<WPoint> const& points, std::int32_t first,
                                      std::int32_t count, double cx, double cy, double tolerance,
                                      double* minRadius, double* maxRadius) {
  if (count <= 0) return true;
  if (!IsRunInside(points, first, count)) return false;
  double lowest = 0.0;
  double highest = 0.0;
  for (std::int32_t i = first; i < first + count; ++i) {
    WPoint const& p = At(points, i);
    double const d = Distance(ToPoint(p), {cx, cy});
    double const t = tolerance < 0.0 ? p.w : tolerance;
    lowest = i == first ? d - t : std::max(lowest, d - t);
    highest = i == first ? d + t : std::min(highest, d + t);
    if (lowest > highest) return false;
  }
  *minRadius = lowest;
  *maxRadius = highest;
  return true;
}

bool ReferenceFitting::CalcOptimalRadius(std::vector<WPoint> const& points, std::int32_t first,
                                         std::int32_t count, double cx, double cy, double tolerance,
                                         CircleRadiusFindingStrategy strategy, double* radius) {
  if (count < 1) return false;
  double lowest = 0.0;
  double highest = 0.0;
  if (!GetRadiusRange(points, first, count, cx, cy, tolerance, &lowest, &highest)) return false;
  if (strategy == CircleRadiusFindingStrategy::MidRange) {
    *radius = (lowest + highest) * 0.5;
    return true;
  }
  if (strategy != CircleRadiusFindingStrategy::MeanDistance) return false;
  bool const isWeighted = tolerance < 0.0;
  double sum = 0.0;
  double weights = 0.0;
  for (std::int32_t i = first; i < first + count; ++i) {
    WPoint const& p = At(points, i);
    double const d = Distance(ToPoint(p), {cx, cy});
    sum += isWeighted ? d * p.w : d;
    weights += p.w;
  }
  if (isWeighted && weights <= kSmallestNormal) return false;
  *radius = sum / (isWeighted ? weights : static_cast<double>(count));
  return true;
}

bool ReferenceFitting::CalcDeviationCurve(std::vector<WPoint> const& points, std::int32_t first,
                                          std::int32_t count, Point const& center, double radius,
                                          std::vector<WPoint2>* curve) {
  if (count < 1 || !IsRunInside(points, first, count)) return false;
  double sum = 0.0;
  for (std::int32_t i = first; i < first + count; ++i) {
    WPoint const& p = At(points, i);
    curve->push_back({p.x - center.x, p.y - center.y, Distance(ToPoint(p), center) - radius, p.w});
    sum += p.w;
  }
  if (sum <= kSmallestNormal) return false;
  double const mean = sum / static_cast<double>(count);
  for (WPoint2& sample : *curve) sample.weight /= mean;
  return true;
}

bool ReferenceFitting::CalcCorrectionShiftForCircle(std::vector<WPoint2> const& curve,
                                                    Point* shift) {
  if (curve.size() < 3) return false;
  // Normal equations of dev = dr + sy * uy + sx * ux; unknowns in the order dr, sy, sx.
  double guy = 0.0;
  double gux = 0.0;
  double guyuy = 0.0;
  double guxuy = 0.0;
  double guxux = 0.0;
  double gdev = 0.0;
  double guydev = 0.0;
  double guxdev = 0.0;
  for (WPoint2 const& s : curve) {
    double const r2 = s.dx * s.dx + s.dy * s.dy;
    if (r2 <= kSmallestNormal) return false;
    double const r = std::sqrt(r2);
    double const ux = s.dx / r;
    double const uy = s.dy / r;
    double const g = s.weight;
    guy += g * uy;
    gux += g * ux;
    guyuy += g * (s.dy * s.dy) / r2;
    guxuy += g * s.dx * s.dy / r2;
    guxux += g * (s.dx * s.dx) / r2;
    gdev += g * s.dev;
    guydev += g * uy * s.dev;
    guxdev += g * ux * s.dev;
  }
  double matrix[9] = {
      static_cast<double>(curve.size()), guy, gux, guy, guyuy, guxuy, gux, guxuy, guxux};
  double rhs[3] = {gdev, guydev, guxdev};
  double solution[3] = {};
  if (!MathUtils::LinearEquationSystemSolve(3, matrix, rhs, solution)) return false;
  double const sy = solution[1];
  double const sx = solution[2];
  double const length = std::sqrt(sx * sx + sy * sy);
  double const angle = -std::atan2(sx, sy) + kHalfPi;
  *shift = {std::cos(angle) * length, std::sin(angle) * length};
  return true;
}

double ReferenceFitting::GetMaxObtainedDeviation(std::vector<WPoint> const& points,
                                                 std::int32_t first, std::int32_t count,
                                                 Point const& center, double radius,
                                                 std::int32_t* index) {
  *index = -1;
  double largest = -1.0;
  if (!IsRunInside(points, first, count)) return largest;
  for (std::int32_t i = 0; i < count; ++i) {
    double const deviation = std::fabs(radius - Distance(ToPoint(At(points, first + i)), center));
    if (i == 0 || deviation > largest) {
      largest = deviation;
      *index = i;
    }
  }
  return largest;
}

bool ReferenceFitting::GetMaxObtainedDeviation(std::vector<WPoint> const& points,
                                               std::int32_t first, std::int32_t count,
                                               Point const& center, double radius,
                                               double* minSigned, double* maxSigned) {
  *minSigned = -1.0;
  *maxSigned = -1.0;
  if (!IsRunInside(points, first, count)) return true;
  for (std::int32_t i = 0; i < count; ++i) {
    double const deviation = radius - Distance(ToPoint(At(points, first + i)), center);
    if (i == 0 || deviation < *minSigned) *minSigned = deviation;
    if (i == 0 || deviation > *maxSigned) *maxSigned = deviation;
  }
  return true;
}

// --- Circle fit by mean circumcentre ------------------------------------------------------------

namespace {

/// Circumcentre by the padded system of four unknowns whose last two are forced to zero.
bool Circumcentre(Point const& a, Point const& b, Point const& c, Point* centre) {
  double matrix[16] = {};
  double rhs[4] = {};
  double solution[4] = {};
  Point const pairs[2][2] = {{a, b}, {b, c}};
  for (int row = 0; row < 2; ++row) {
    Point const& p = pairs[row][0];
    Point const& q = pairs[row][1];
    matrix[4 * row] = matrix[4 * row + 2] = 2.0 * (p.x - q.x);
    matrix[4 * row + 1] = matrix[4 * row + 3] = 2.0 * (p.y - q.y);
    rhs[row] = (q.y + p.y) * (p.y - q.y) + (q.x + p.x) * (p.x - q.x);
  }
  matrix[10] = 1.0;
  matrix[15] = 1.0;
  if (!MathUtils::LinearEquationSystemSolve(4, matrix, rhs, solution)) return false;
  *centre = {solution[0], solution[1]};
  return true;
}

bool IsWithinTolerances(std::vector<WPoint> const& wpoints, std::int32_t begin, std::int32_t count,
                        Point const& center, double radius) {
  for (std::int32_t j = begin; j < begin + count; ++j) {
    WPoint const& p = At(wpoints, j);
    if (std::fabs(radius - Distance(ToPoint(p), center)) > p.w) return false;
  }
  return true;
}

}  // namespace

ErrorCode ReferenceFitting::GetFittingCircle(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                             std::int32_t count, bool firstFixed, Point* first,
                                             bool lastFixed, Point* last, std::int32_t* fitCount,
                                             Point* center, double* radius, bool* ccw,
                                             double* /*extra*/) {
  if (count < 3 || !IsRunInside(wpoints, begin, count)) return ErrorCode::Failed;
  Point const fixedFirst = *first;
  Point const fixedLast = *last;
  Point centreSum{0.0, 0.0};
  for (std::int32_t k = 0; k + 3 <= count; ++k) {
    std::int32_t const m = k + 3;
    ErrorCode const stop = k > 0 ? ErrorCode::Ok : ErrorCode::Failed;
    bool const lastFixedNow = lastFixed && k == count - 3;
    Point const measuredFirst = ToPoint(At(wpoints, begin));
    Point const measuredLast = ToPoint(At(wpoints, begin + m - 1));

    Point const a = firstFixed && k == 0 ? fixedFirst : ToPoint(At(wpoints, begin + k));
    Point const b = ToPoint(At(wpoints, begin + k + 1));
    Point const c = lastFixedNow ? fixedLast : ToPoint(At(wpoints, begin + k + 2));
    Point circumcentre;
    if (!Circumcentre(a, b, c, &circumcentre)) return ErrorCode::Failed;
    centreSum = {centreSum.x + circumcentre.x, centreSum.y + circumcentre.y};
    double const centres = static_cast<double>(k + 1);
    Point mean{centreSum.x / centres, centreSum.y / centres};

    std::int32_t failIndex = -1;
    double rmin = 0.0;
    double rmax = 0.0;
    Point const rangeEnd = lastFixedNow ? fixedLast : measuredLast;
    if (!GetRadiusRange(wpoints, begin, m, mean.x, mean.y, -1.0, firstFixed, &fixedFirst,
                        lastFixedNow, &rangeEnd, &failIndex, &rmin, &rmax)) {
      return stop;
    }
    double r = (rmin + rmax) * 0.5;

    Point start = fixedFirst;
    Point end = fixedLast;
    if (!firstFixed && !GeometryUtils::GetNearestPointOnCircle(mean, r, measuredFirst, &start)) {
      return ErrorCode::Failed;
    }
    if (!lastFixedNow && !GeometryUtils::GetNearestPointOnCircle(mean, r, measuredLast, &end)) {
      return ErrorCode::Failed;
    }
    if (firstFixed || lastFixedNow) {
      Point adjusted;
      if (!AdjustCenter(start, end, mean, &adjusted)) return ErrorCode::Failed;
      mean = adjusted;
      r = Distance(start, mean);
    }
    if (!IsWithinTolerances(wpoints, begin, m, mean, r)) return stop;
    if (IsCcw(wpoints, begin, m, firstFixed, start, lastFixedNow, end, mean, ccw) !=
        ErrorCode::Ok) {
      return ErrorCode::Failed;
    }
    *first = start;
    *last = end;
    *center = mean;
    *radius = r;
    *fitCount = m;
  }
  return ErrorCode::Ok;
}

bool ReferenceFitting::GetRadiusRange(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                      std::int32_t count, double cx, double cy, double tolerance,
                                      bool firstFixed, Point const* first, bool lastFixed,
                                      Point const* last, std::int32_t* failIndex, double* rmin,
                                      double* rmax) {
  if (!IsRunInside(wpoints, begin, count)) return false;
  Point const center{cx, cy};
  double fixedDistance = 0.0;
  for (std::int32_t k = 0; k < count; ++k) {
    *failIndex = k;
    WPoint const& measured = At(wpoints, begin + k);
    Point p = ToPoint(measured);
    if (k == 0 && firstFixed) {
      p = *first;
      fixedDistance = Distance(p, center);
    }
    if (k == count - 1 && lastFixed) {
      p = *last;
      fixedDistance = Distance(p, center);
    }
    double const d = Distance(p, center);
    double const t = tolerance < 0.0 ? measured.w : tolerance;
    double lo = d - t;
    double hi = d + t;
    if (!(lo > 0.0)) return false;
    if (k > 0) {
      lo = std::max(lo, *rmin);
      hi = std::min(hi, *rmax);
      if (lo > hi) return false;
    }
    *rmin = lo;
    *rmax = hi;
  }
  if (firstFixed || lastFixed) {
    if (!(*rmin <= fixedDistance && fixedDistance <= *rmax)) return false;
    *rmin = fixedDistance;
    *rmax = fixedDistance;
  }
  *failIndex = count;
  return true;
}

bool ReferenceFitting::AdjustCenter(Point const& p1, Point const& p2, Point const& center,
                                    Point* adjusted) {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;
  if (!GeometryUtils::GetLineParameters(p1.x, p1.y, p2.x, p2.y, &a, &b, &c)) return false;
  Point const middle{(p1.x + p2.x) * 0.5, (p1.y + p2.y) * 0.5};
  double na = 0.0;
  double nb = 0.0;
  double nc = 0.0;
  GeometryUtils::GetNormal(a, b, c, middle, &na, &nb, &nc);
  return GeometryUtils::GetNearestPointOnLine(na, nb, nc, center, adjusted);
}

ErrorCode ReferenceFitting::IsCcw(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                  std::int32_t count, bool firstFixed, Point const& first,
                                  bool lastFixed, Point const& last, Point const& /*center*/,
                                  bool* ccw) {
  if (count < 3 || !IsRunInside(wpoints, begin, count)) return ErrorCode::Failed;
  Point const a = firstFixed ? first : ToPoint(At(wpoints, begin));
  Point const b = ToPoint(At(wpoints, begin + count / 2));
  Point const c = lastFixed ? last : ToPoint(At(wpoints, begin + count - 1));
  return GeometryUtils::IsCcw(a, b, c, ccw);
}

}  // namespace Vorn::Testing
