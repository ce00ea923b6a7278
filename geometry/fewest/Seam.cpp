#include "geometry/fewest/Seam.h"

#include <algorithm>
#include <cmath>

#include "geometry/fewest/FollowGates.h"

namespace Vorn::Fewest {

namespace {

/// Places on the gate that are tried besides those that the chain suggests.
constexpr int kGridPlaces = 8;

/// Lets the path begin and end between two offsets.
void OpenAt(CutPath* cut, double low, double high) {
  Gate start = SeenFromBehind(cut->gate);
  start.split = 0;
  cut->path.start =
      cut->gate.isCusp ? Opening{start, -high, -low, false} : Opening{start, low, high, false};
  cut->path.finish = {cut->gate, low, high, false};
}

/// Offsets at which a chain that need not close begins and ends, and what lies between.
std::vector<double> PlacesToTry(CutPath const& cut, Chain const& chain) {
  std::vector<double> places;
  double begin = cut.offset;
  double end = cut.offset;
  if (FindCrossing(chain.pieces.front().circle, cut.path.start.gate, &begin) && cut.gate.isCusp) {
    begin = -begin;
  }
  FindCrossing(chain.pieces.back().circle, cut.gate, &end);
  for (double share : {0.5, 0.25, 0.75, 0.0, 1.0}) places.push_back(begin + share * (end - begin));
  places.push_back(cut.offset);
  for (int i = 1; i < kGridPlaces; ++i) {
    places.push_back(cut.gate.least + (cut.gate.greatest - cut.gate.least) * i / kGridPlaces);
  }
  return places;
}

/// A gate of a closed path and the place on it at which the chain begins and ends.
struct Seam {
  Gate gate;
  double offset = 0.0;
  double turn = 0.0;  ///< 1 less the cosine of the angle by which the chain turns there
};

CutPath CutAt(Path const& path, Seam const& seam) {
  CutPath cut;
  cut.rotation = seam.gate.split % path.Count();
  cut.path.limits = path.limits;
  cut.path.leastTolerance = path.leastTolerance;
  cut.path.points.reserve(path.points.size());
  auto const middle = path.points.begin() + cut.rotation;
  cut.path.points.assign(middle, path.points.end());
  cut.path.points.insert(cut.path.points.end(), path.points.begin(), middle);
  cut.gate = seam.gate;
  cut.gate.split = path.Count();
  cut.offset = seam.offset;
  return cut;
}

/// Where the input ends: in the middle of the way from the last point to the first, or at the
/// first where they coincide.
Seam SeamAtEnds(Path const& path, PlacedCircle const& circle) {
  WPoint const& last = path.points.back();
  WPoint const& first = path.points.front();
  Place const middle{0.5 * (first.x + last.x), 0.5 * (first.y + last.y)};
  Place const normal = GradientAt(circle, middle);
  Seam seam;
  seam.gate = BisectorGate(middle, normal, normal);
  seam.gate.split = path.Count();
  double const gap = DistanceBetween(last, first);
  seam.gate.greatest = 0.5 * gap + 2.0 * std::max(last.w, first.w);
  seam.gate.least = -seam.gate.greatest;
  if (!FindCrossing(circle, seam.gate, &seam.offset)) seam.offset = 0.0;
  return seam;
}

}  // namespace

std::vector<CutPath> CutAtJoints(Path const& path, Chain const& open, std::size_t most) {
  std::vector<Seam> seams;
  for (std::size_t k = 0; k < open.gates.size(); ++k) {
    Place const place = PlaceOn(open.gates[k], open.offsets[k]);
    Place const in = GradientAt(open.pieces[k].circle, place);
    Place const out = GradientAt(open.pieces[k + 1].circle, place);
    seams.push_back({open.gates[k], open.offsets[k], 1.0 - (in.x * out.x + in.y * out.y)});
  }
  std::stable_sort(seams.begin(), seams.end(),
                   [](Seam const& s, Seam const& t) { return s.turn > t.turn; });
  if (seams.size() > most) seams.resize(most);
  if (seams.empty()) seams.push_back(SeamAtEnds(path, open.pieces.front().circle));
  std::vector<CutPath> cuts;
  cuts.reserve(seams.size());
  for (Seam const& seam : seams) cuts.push_back(CutAt(path, seam));
  return cuts;
}

namespace {

/// A full circle as two halves, where one circle covers all points; empty where it does not.
Chain FollowHalves(CutPath const& cut, double share, PlacedCircle const& circle) {
  std::int32_t const count = cut.path.Count();
  std::int32_t const half = count / 2;
  if (half < 1) return {};
  Chain halves;
  halves.pieces = {{0, half, circle, 1.0}, {half, count, circle, 1.0}};
  halves.gates = {MiddleGate(cut.path, half, circle)};
  halves.offsets = {0.0};
  return FollowGates(cut.path, share, halves);
}

}  // namespace

Chain CloseChain(CutPath* cut, double share, std::function<void(std::int32_t)> const& tell) {
  // First without asking that it closes, then with its gates and one place for both ends.
  OpenAt(cut, cut->gate.least, cut->gate.greatest);
  Chain const chain = FindChain(cut->path, share, tell);
  if (!chain.pieces.empty()) {
    for (double const place : PlacesToTry(*cut, chain)) {
      OpenAt(cut, place, place);
      if (chain.pieces.size() <= 2) {
        Chain halves = FollowHalves(*cut, share, chain.pieces.front().circle);
        if (!halves.pieces.empty()) return halves;
      }
      Chain closed = FollowGates(cut->path, share, chain);
      if (!closed.pieces.empty()) return closed;
    }
  }
  OpenAt(cut, cut->offset, cut->offset);
  return FindChain(cut->path, share, tell);
}

}  // namespace Vorn::Fewest
