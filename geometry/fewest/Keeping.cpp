#include "geometry/fewest/Keeping.h"

#include <algorithm>
#include <cstddef>
#include <limits>

#include "geometry/fewest/Centring.h"
#include "geometry/fewest/LineCorners.h"
#include "geometry/fewest/Mending.h"
#include "geometry/fewest/Retracing.h"

namespace Vorn::Fewest {

namespace {

/// By how much rounding may change a radius, relative to it.
constexpr double kRadiusRounding = 1e-9;

/// How often the places are repaired at which a chain breaks promises.
constexpr int kMostRepairs = 24;

/// So many points on either side of a broken promise the path is followed at first, twice as many
/// every other time.
constexpr std::int32_t kFirstReach = 4;

}  // namespace

bool Keeping::KeepsRepaired(Repair repair, RotatedPath const& path, Chain const& chain,
                            Answer* answer, Promises::Report* report) const {
  switch (repair) {
    case Repair::Mend:
      return KeepsMended(path, chain, answer, report);
    case Repair::Retrace:
      return KeepsRetraced(path, chain, answer, report);
    case Repair::None:
      break;
  }
  return KeepsCentred(path, chain, answer, report);
}

bool Keeping::KeepsMended(RotatedPath const& path, Chain const& chain, Answer* answer,
                          Promises::Report* report) const {
  Mending mending(path.path, kSearchShare, chain);
  for (int round = 0; round < kMostRepairs; ++round) {
    if (Keeps(path, mending.Current(), answer, report)) {
      return KeepsCentred(path, mending.Current(), answer, report);
    }
    if (!mending.Mend(report->violations)) return false;
  }
  return false;
}

bool Keeping::KeepsRetraced(RotatedPath const& path, Chain const& chain, Answer* answer,
                            Promises::Report* report) const {
  Retracing retracing(path.path, kSearchShare, chain);
  for (int round = 0; round < kMostRepairs; ++round) {
    if (Keeps(path, retracing.Current(), answer, report)) {
      return KeepsCentred(path, retracing.Current(), answer, report);
    }
    std::int32_t const reach = kFirstReach << (round / 2);
    std::vector<std::int32_t> const places = PlacesOf(*report, retracing.Current(), path.rotation);
    if (!retracing.Follow(places, reach)) return false;
  }
  return false;
}

std::vector<std::int32_t> Keeping::PlacesOf(Promises::Report const& report, Chain const& chain,
                                            std::int32_t rotation) const {
  std::vector<std::int32_t> places;
  auto const add = [&](std::size_t k, GeometryUtils::Point const& at) {
    ChainPiece const& piece = chain.pieces[k];
    FewestPieces::Range const range{piece.first + rotation, piece.end - 1 + rotation};
    places.push_back(piece.first + NearestOf(range, at));
  };
  for (Promises::Violation const& violation : report.violations) {
    add(violation.piece, violation.at);
    if (violation.otherPiece != Promises::kNone) add(violation.otherPiece, violation.at);
  }
  return places;
}

bool Keeping::KeepsCentred(RotatedPath const& path, Chain const& chain, Answer* answer,
                           Promises::Report* report) const {
  if (options_.centre) {
    Chain const centred = Centre(path.path, chain);
    std::vector<BuiltPiece> pieces = BuildPieces(path.path, centred);
    SharpenCorners(path.path, centred, &pieces);
    if (KeepsBuilt(path, centred, pieces, answer, report)) return true;
    if (Keeps(path, centred, answer, report)) return true;
  }
  return Keeps(path, chain, answer, report);
}

bool Keeping::Keeps(RotatedPath const& path, Chain const& chain, Answer* answer,
                    Promises::Report* report) const {
  return KeepsBuilt(path, chain, BuildPieces(path.path, chain), answer, report);
}

bool Keeping::KeepsBuilt(RotatedPath const& path, Chain const& chain,
                         std::vector<BuiltPiece> const& pieces, Answer* answer,
                         Promises::Report* report) const {
  *answer = Restore(shift_, chain, pieces);
  std::int32_t const count = path.path.Count();
  for (FewestPieces::Range& range : answer->ranges) {
    range = {(range.first + path.rotation) % count, (range.last + path.rotation) % count};
  }
  return IsKept(*answer, report);
}

bool Keeping::IsKept(Answer const& answer, Promises::Report* report) const {
  *report = Promises::Measure({points_, answer.contour, answer.ranges, options_.closed,
                               options_.largestStep, options_.farthestBetweenPoints});
  return report->violations.empty() && AreRadiiAllowed(answer.contour);
}

bool Keeping::AreRadiiAllowed(std::vector<GeometryUtils::Elem> const& contour) const {
  return std::all_of(contour.begin(), contour.end(), [&](GeometryUtils::Elem const& elem) {
    return elem.type == GeometryUtils::ElemType::Segment ||
           (elem.radius >= options_.smallestRadius * (1.0 - kRadiusRounding) &&
            elem.radius <= options_.largestRadius * (1.0 + kRadiusRounding));
  });
}

std::int32_t Keeping::NearestOf(FewestPieces::Range const& range,
                                GeometryUtils::Point const& at) const {
  auto const count = static_cast<std::int32_t>(points_.size());
  std::int32_t nearest = 0;
  double least = std::numeric_limits<double>::infinity();
  for (std::int32_t i = range.first; i <= range.last; ++i) {
    WPoint const& p = points_[static_cast<std::size_t>(i % count)];
    double const distance = DistanceBetween(p, {at.x, at.y, 0.0});
    if (distance >= least) continue;
    least = distance;
    nearest = i - range.first;
  }
  return nearest;
}

}  // namespace Vorn::Fewest
