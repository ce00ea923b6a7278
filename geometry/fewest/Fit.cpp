// The service: checks what it is given, moves the points near the origin, finds the bound and the
// chain, and hands out what was measured.

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

#include "geometry/fewest/Answer.h"
#include "geometry/fewest/Assembly.h"
#include "geometry/fewest/Bound.h"
#include "geometry/fewest/Centring.h"
#include "geometry/fewest/Chain.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/OnePiece.h"
#include "geometry/fewest/Polyline.h"
#include "geometry/fewest/Progress.h"
#include "geometry/fewest/Seam.h"
#include "geometry/fewest/promises/Promises.h"
#include "vorn/FewestPieces.h"

namespace Vorn {

namespace {

using Fewest::Answer;
using Fewest::Chain;
using Fewest::Path;
using Options = FewestPieces::Options;
using Result = FewestPieces::Result;

/// The search works within this share of the tolerances, so that its rounding and its second order
/// terms stay within the true ones.
constexpr double kSearchShare = 1.0 - 1e-6;

/// From how many states a gate takes offsets, for each effort.
constexpr std::size_t kSources[] = {2, 4, 64};

/// By how much rounding may change a radius, relative to it.
constexpr double kRadiusRounding = 1e-9;

/// Percent of the progress that is done after the bound, and after the search of the open contour.
constexpr std::int32_t kCovered = 20;
constexpr std::int32_t kSearched = 80;

/// By what the tolerances near a broken promise are multiplied after each search that breaks one: a
/// little room is often enough and costs no piece.
constexpr double kTightening[] = {0.8, 0.8, 0.5, 0.5};

/// At least so many points on either side of a broken promise get a smaller tolerance.
constexpr std::int32_t kLeastReach = 4;

/// Joints of the open chain at which a closed one is tried to begin.
constexpr std::size_t kMostSeams = 4;

bool IsMeasured(WPoint const& p) {
  return std::isfinite(p.x) && std::isfinite(p.y) && std::isfinite(p.w) && p.w > 0.0;
}

bool AreValid(std::vector<WPoint> const& points) {
  return points.size() >= 2 &&
         points.size() <= static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max()) &&
         std::all_of(points.begin(), points.end(), IsMeasured);
}

bool IsValid(Options const& options) {
  auto const effort = static_cast<std::int32_t>(options.effort);
  return effort >= 0 && effort <= 2 && options.largestStep > 0.0 &&
         options.largestStep <= std::numbers::pi && options.smallestRadius >= 0.0 &&
         std::isfinite(options.smallestRadius) && options.largestRadius > 0.0 &&
         options.largestRadius >= options.smallestRadius && options.farthestBetweenPoints >= 0.0;
}

Fewest::Limits LimitsOf(Options const& options, double scale) {
  return {options.smallestRadius * scale, options.largestRadius * scale, options.segmentsOnly,
          std::sin(0.5 * options.largestStep), options.farthestBetweenPoints * scale};
}

/// Looks for contours and measures what they promise.
class Fitter {
 public:
  Fitter(std::vector<WPoint> const& points, Options const& options, Fewest::Shift const& shift,
         Path path, Fewest::Progress* progress)
      : points_(points),
        options_(options),
        shift_(shift),
        path_(std::move(path)),
        progress_(*progress) {}

  /// Whether one piece along a circle that covers all points keeps every promise.
  bool RunAsOne(Fewest::Circle const& covering, Answer* answer, Promises::Report* report) const {
    for (Chain const& chain : Fewest::MakeOnePiece(path_, covering)) {
      if (KeepsCentred(path_, 0, chain, answer, report)) return true;
      Fewest::RoundEnds(Fewest::Tightest(points_).w, answer);
      if (Measure(*answer, report)) return true;
    }
    return false;
  }

  /// The first contour found that keeps every promise; false when there is none.
  bool Run(Answer* answer, Promises::Report* report) {
    for (double const factor : kTightening) {
      if (Search(1.0, answer, report)) return true;
      if (answer->ranges.empty()) break;
      Tighten(*answer, *report, factor);
    }
    path_.points = shift_.Apply(points_);
    // What does not yield near the place may yield when all pieces change.
    for (double const share : {0.9, 0.7, 0.5, 0.3}) {
      if (Search(share, answer, report)) return true;
    }
    // Segments keep to the path between the points and have no radius.
    path_.limits.segmentsOnly = true;
    if (Search(1.0, answer, report)) return true;
    *answer = Fewest::FollowPoints(points_, options_.closed);
    return Measure(*answer, report);
  }

 private:
  /// Finds and measures one contour; `answer` is without ranges when there was none to measure.
  bool Search(double share, Answer* answer, Promises::Report* report) {
    *answer = {};
    path_.limits.mostSources = kSources[0];
    Chain chain = FindOpen(share);
    // A wider look starts from other gates, so it may also end with more pieces.
    for (std::int32_t effort = 1; effort <= static_cast<std::int32_t>(options_.effort); ++effort) {
      path_.limits.mostSources = kSources[effort];
      Chain wider = FindOpen(share);
      bool const isBetter = chain.pieces.empty() || wider.pieces.size() < chain.pieces.size();
      if (isBetter && !wider.pieces.empty()) chain = std::move(wider);
    }
    if (chain.pieces.empty()) return false;
    if (options_.closed) return Close(chain, share * kSearchShare, answer, report);
    return KeepsCentred(path_, 0, chain, answer, report);
  }

  Chain FindOpen(double share) {
    return Fewest::FindChain(path_, share * kSearchShare, [&](std::int32_t done) { Tell(done); });
  }

  void Tell(std::int32_t done) { progress_.Tell(kCovered, kSearched, done); }

  /// Multiplies the tolerances of the search about the places where promises fail by a factor below
  /// 1, which leaves room for them and may cost a piece there.
  void Tighten(Answer const& answer, Promises::Report const& report, double factor) {
    for (Promises::Violation const& violation : report.violations) {
      TightenNear(answer.ranges[violation.piece], violation.at, factor);
      if (violation.otherPiece != Promises::kNone) {
        TightenNear(answer.ranges[violation.otherPiece], violation.at, factor);
      }
    }
    path_.leastTolerance *= factor;
  }

  void TightenNear(FewestPieces::Range const& range, GeometryUtils::Point const& at,
                   double factor) {
    std::int32_t const count = path_.Count();
    std::int32_t const length = (range.last - range.first + count) % count + 1;
    std::int32_t nearest = 0;
    double least = std::numeric_limits<double>::infinity();
    for (std::int32_t k = 0; k < length; ++k) {
      WPoint const& p = points_[static_cast<std::size_t>((range.first + k) % count)];
      double const distance = Fewest::DistanceBetween(p, {at.x, at.y, 0.0});
      if (distance < least) {
        least = distance;
        nearest = k;
      }
    }
    std::int32_t const reach = std::max(kLeastReach, length / 8);
    for (std::int32_t k = nearest - reach; k <= nearest + reach; ++k) {
      std::int32_t const i = range.first + k;
      if (!options_.closed && (i < 0 || i >= count)) continue;
      path_.points[static_cast<std::size_t>((i % count + count) % count)].w *= factor;
    }
  }

  /// The shortest of the chains that begin and end at one of the joints of an open one.
  bool Close(Chain const& open, double share, Answer* answer, Promises::Report* report) {
    bool isFound = false;
    auto cuts = Fewest::CutAtJoints(path_, open, kMostSeams);
    for (Fewest::CutPath& cut : cuts) {
      Chain const chain = Fewest::CloseChain(&cut, share, [&](std::int32_t done) { Tell(done); });
      if (chain.pieces.empty()) continue;
      if (isFound && chain.pieces.size() >= answer->ranges.size()) continue;
      Answer closed;
      Promises::Report closedReport;
      bool const isKept = KeepsCentred(cut.path, cut.rotation, chain, &closed, &closedReport);
      if (isFound && !isKept) continue;
      *answer = std::move(closed);
      *report = std::move(closedReport);
      if (!isKept) continue;
      isFound = true;
      // No closed chain has fewer than the open one less the piece that the end of the input cuts.
      if (answer->ranges.size() + 1 <= open.pieces.size()) return true;
    }
    if (isFound && answer->ranges.size() <= open.pieces.size() + 1) return true;
    return CloseBySegment(open, answer, report) || isFound;
  }

  /// The open chain with a segment from its end back to its start; leaves the answer where that
  /// breaks a promise.
  bool CloseBySegment(Chain const& open, Answer* answer, Promises::Report* report) const {
    Chain const centred = options_.centre ? Fewest::Centre(path_, open) : open;
    for (Chain const* chain : {&centred, &open}) {
      Answer closed = Fewest::Restore(shift_, *chain, Fewest::BuildPieces(path_, *chain));
      Promises::Report closedReport;
      if (!Fewest::AppendClosingSegment(&closed) || !Measure(closed, &closedReport)) continue;
      *answer = std::move(closed);
      *report = std::move(closedReport);
      return true;
    }
    return false;
  }

  bool AreRadiiAllowed(std::vector<GeometryUtils::Elem> const& contour) const {
    return std::all_of(contour.begin(), contour.end(), [&](GeometryUtils::Elem const& elem) {
      return elem.type == GeometryUtils::ElemType::Segment ||
             (elem.radius >= options_.smallestRadius * (1.0 - kRadiusRounding) &&
              elem.radius <= options_.largestRadius * (1.0 + kRadiusRounding));
    });
  }

  bool KeepsCentred(Path const& path, std::int32_t rotation, Chain const& chain, Answer* answer,
                    Promises::Report* report) const {
    if (options_.centre && Keeps(path, rotation, Fewest::Centre(path, chain), answer, report)) {
      return true;
    }
    return Keeps(path, rotation, chain, answer, report);
  }

  bool Keeps(Path const& path, std::int32_t rotation, Chain const& chain, Answer* answer,
             Promises::Report* report) const {
    *answer = Fewest::Restore(shift_, chain, Fewest::BuildPieces(path, chain));
    std::int32_t const count = path.Count();
    for (FewestPieces::Range& range : answer->ranges) {
      range = {(range.first + rotation) % count, (range.last + rotation) % count};
    }
    return Measure(*answer, report);
  }

  bool Measure(Answer const& answer, Promises::Report* report) const {
    *report = Promises::Measure({points_, answer.contour, answer.ranges, options_.closed,
                                 options_.largestStep, options_.farthestBetweenPoints});
    return report->violations.empty() && AreRadiiAllowed(answer.contour);
  }

  std::vector<WPoint> const& points_;
  Options const& options_;
  Fewest::Shift const& shift_;
  Path path_;
  Fewest::Progress& progress_;
};

}  // namespace

ErrorCode FewestPieces::Fit(std::vector<WPoint> const& points, Options const& options,
                            Result* result, ExecutionState* executionState,
                            std::int32_t maxPercent) {
  if (result == nullptr || !AreValid(points) || !IsValid(options)) return ErrorCode::Failed;
  if (Fewest::DoCoincide(points)) return ErrorCode::NoFit;
  Fewest::Progress progress(executionState, maxPercent, static_cast<std::int32_t>(points.size()));
  Fewest::Shift const shift = Fewest::ShiftFor(points);
  Path path;
  path.points = shift.Apply(points);
  path.limits = LimitsOf(options, shift.scale);
  path.leastTolerance = Fewest::Tightest(points).w * shift.scale;

  Fewest::Cover const cover = Fewest::CoverGreedily(
      path.points, path.limits, [&](std::int32_t done) { progress.Tell(0, kCovered, done); });
  Answer answer;
  Promises::Report report;
  Fitter fitter(points, options, shift, std::move(path), &progress);
  bool const isOne = !options.closed && cover.starts.size() == 1 && points.size() > 3 &&
                     fitter.RunAsOne(cover.last, &answer, &report);
  if (!isOne && !fitter.Run(&answer, &report)) return ErrorCode::NoFit;
  progress.Finish();
  result->contour = std::move(answer.contour);
  result->ranges = std::move(answer.ranges);
  result->largestDeviation = report.largestRatio;
  result->largestDeviationIndex = static_cast<std::int32_t>(report.largestIndex);
  // A closed cover of m runs, cut where the input ends, is an open one of m + 1 at most.
  auto const open = static_cast<std::int32_t>(cover.starts.size());
  result->fewestPossible = options.closed ? std::max(1, open - 1) : open;
  result->isFewest = static_cast<std::int32_t>(result->ranges.size()) == result->fewestPossible;
  return ErrorCode::Ok;
}

}  // namespace Vorn
