#include "geometry/fewest/Seam.h"

#include <algorithm>
#include <cmath>

namespace Vorn::Fewest {

namespace {

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
  Gate finish = seam.gate;
  finish.split = path.Count();
  Gate start = SeenFromBehind(seam.gate);
  start.split = 0;
  double const sign = seam.gate.isCusp ? -1.0 : 1.0;
  cut.path.start = {start, sign * seam.offset, sign * seam.offset, false};
  cut.path.finish = {finish, seam.offset, seam.offset, false};
  return cut;
}

/// Where the input ends: in the middle of the way from the last point to the first, or at the
/// first where they coincide.
Seam SeamAtEnds(Path const& path, Circle const& circle) {
  WPoint const& last = path.points.back();
  WPoint const& first = path.points.front();
  Place const middle{0.5 * (first.x + last.x), 0.5 * (first.y + last.y)};
  Place const normal = GradientAt(circle, middle);
  Seam seam;
  seam.gate = BisectorGate(middle, normal, normal);
  seam.gate.split = path.Count();
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
  for (Seam const& seam : seams) cuts.push_back(CutAt(path, seam));
  return cuts;
}

}  // namespace Vorn::Fewest
