// Strategy Mixed: from the current point both fitters say how far one element can reach. The longer
// reach wins; on equal reach the arc, unless its deviation is larger.

#include <algorithm>
#include <cstdint>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/Strategies.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::kFewestArcPoints;
using Fitting::ToPoint;

namespace {

/// Tries of the line fitter on one run, each fed with the points that deviated most in the one
/// before.
constexpr int kLineAttempts = 3;

}  // namespace

MixedWalk::MixedWalk(std::vector<WPoint> const& points, std::vector<GeometryUtils::Elem>* contour,
                     GeometryUtils::ProgressBase const& progress)
    : points_(points), contour_(*contour), progress_(progress), start_(ToPoint(points.front())) {}

LargestDeviation MixedWalk::Run() {
  auto const n = static_cast<std::int32_t>(points_.size());
  while (runStart_ + 1 < n) {
    std::int32_t const remaining = n - runStart_;
    end_ = ToPoint(points_.back());

    Line line;
    Arc arc;
    bool const hasLine = FitLine(remaining, &line);
    // Deliberate: a line of two points that ends where the points turn back is taken unasked; an
    // arc could only run on past the turn.
    bool const isTurn = hasLine && line.count == 2 && line.code == ErrorCode::SelfIntersection;
    bool hasArc = false;
    if (!isTurn) {
      std::int32_t const minimumRun =
          hasLine ? std::max(line.count, kFewestArcPoints) : kFewestArcPoints;
      hasArc = FitArc(remaining, minimumRun, &arc);
    }
    // Deliberate: where neither fits, the contour made so far stands and is no error.
    if (!hasLine && !hasArc) break;
    bool const isArcBetter =
        arc.count > line.count || (arc.count == line.count && arc.deviation <= line.deviation);
    bool const takeArc = hasArc && (!hasLine || isArcBetter);
    Piece const& piece = takeArc ? static_cast<Piece const&>(arc) : line;
    if (piece.count < 2) break;

    if (contour_.empty()) GeometryUtils::AddSegm(&contour_, piece.start);
    if (takeArc) {
      GeometryUtils::AddArc(&contour_, arc.start, arc.end, arc.centre, arc.radius, !arc.ccw);
    } else {
      GeometryUtils::AddSegm(&contour_, line.end);
    }
    Accept(piece);
  }
  return largest_;
}

/// False when the line fitter reports an error. What an attempt did to the end points is discarded
/// before the next; only the index list goes on.
bool MixedWalk::FitLine(std::int32_t remaining, Line* line) {
  indexList_.clear();
  for (int attempt = 1; attempt <= kLineAttempts; ++attempt) {
    line->start = start_;
    line->end = end_;
    bool const isLast = attempt == kLineAttempts;
    if (GeometryUtils::GetFittingLine(points_, runStart_, remaining, startFixed_, &line->start,
                                      false, &line->end, isLast, &line->count, &line->deviation,
                                      &line->deviationIndex, &indexList_, &line->code,
                                      progress_) != ErrorCode::Ok) {
      return false;
    }
    if (indexList_.empty()) break;
  }
  return true;
}

bool MixedWalk::FitArc(std::int32_t remaining, std::int32_t minimumRun, Arc* arc) {
  arc->start = start_;
  arc->end = end_;
  return GeometryUtils::GetFittingCircle2(points_, runStart_, remaining, minimumRun, startFixed_,
                                          &arc->start, false, &arc->end, nullptr, &arc->count,
                                          &arc->centre, &arc->radius, &arc->ccw, &arc->deviation,
                                          &arc->deviationIndex, progress_) == ErrorCode::Ok;
}

/// The last point of one run is the first point of the next.
void MixedWalk::Accept(Piece const& piece) {
  largest_.Take(piece.deviation, piece.deviationIndex);
  startFixed_ = true;
  start_ = piece.end;
  runStart_ += piece.count - 1;
}

}  // namespace Vorn
