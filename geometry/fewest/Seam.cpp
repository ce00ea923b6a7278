#include "geometry/fewest/Seam.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <utility>

#include "geometry/fewest/FollowGates.h"

namespace Vorn::Fewest {

namespace {

/// Places on the gate that are tried besides those that the chain suggests.
constexpr int kGridPlaces = 8;

/// Places between two offsets that are tried first.
constexpr double kSharesOfOpening[] = {0.5, 0.25, 0.75, 0.0, 1.0};

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
  for (double const share : kSharesOfOpening) places.push_back(begin + share * (end - begin));
  places.push_back(cut.offset);
  for (int i = 1; i < kGridPlaces; ++i) {
    places.push_back(cut.gate.least + (cut.gate.greatest - cut.gate.least) * i / kGridPlaces);
  }
  return places;
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

/// The seams at which a chain turns most.
std::vector<Seam> Sharpest(std::vector<Seam> seams, std::size_t most) {
  std::stable_sort(seams.begin(), seams.end(),
                   [](Seam const& s, Seam const& t) { return s.turn > t.turn; });
  if (seams.size() > most) seams.resize(most);
  return seams;
}

/// By how much a chain turns at a joint: 1 less the cosine of the angle.
double TurnAt(Place const& joint, PlacedCircle const& before, PlacedCircle const& behind) {
  Place const in = GradientAt(before, joint);
  Place const out = GradientAt(behind, joint);
  return 1.0 - (in.x * out.x + in.y * out.y);
}

}  // namespace

std::vector<Seam> SharpestJoints(Path const& path, Chain const& open, std::size_t most) {
  std::vector<Seam> seams;
  for (std::size_t k = 0; k < open.gates.size(); ++k) {
    Place const place = PlaceOn(open.gates[k], open.offsets[k]);
    double const turn = TurnAt(place, open.pieces[k].circle, open.pieces[k + 1].circle);
    seams.push_back({open.gates[k], open.offsets[k], turn});
  }
  if (seams.empty()) seams.push_back(SeamAtEnds(path, open.pieces.front().circle));
  return Sharpest(std::move(seams), most);
}

std::vector<Seam> SharpestJoints(Circuit const& circuit, std::size_t most) {
  std::vector<Seam> seams;
  for (std::size_t k = 0; k < circuit.size(); ++k) {
    CircuitPiece const& before = circuit[(k + circuit.size() - 1) % circuit.size()];
    CircuitPiece const& behind = circuit[k];
    double const middle = 0.5 * (behind.low + behind.high);
    double const turn = TurnAt(PlaceOn(behind.gate, middle), before.circle, behind.circle);
    seams.push_back({behind.gate, middle, turn, k});
  }
  return Sharpest(std::move(seams), most);
}

CutPath CutAt(Path const& path, Seam const& seam) {
  CutPath cut;
  cut.rotation = seam.gate.split % path.Count();
  cut.path.limits = path.limits;
  cut.path.leastTolerance = path.leastTolerance;
  cut.path.points.reserve(path.points.size());
  auto const middle = path.points.begin() + cut.rotation;
  cut.path.points.assign(middle, path.points.end());
  cut.path.points.insert(cut.path.points.end(), path.points.begin(), middle);
  Wrap(&cut.path);
  cut.gate = seam.gate;
  cut.gate.split = path.Count();
  cut.offset = seam.offset;
  return cut;
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

std::vector<std::int32_t> LeadsFrom(CutPath const& cut, Circuit const& circuit) {
  std::int32_t const count = cut.path.Count();
  if (circuit.empty()) return {};
  std::vector<std::int32_t> leads;
  for (CircuitPiece const& piece : circuit) {
    leads.push_back((piece.farthest - cut.rotation + count) % count);
  }
  std::sort(leads.begin(), leads.end());
  // The first one belongs to the piece that leads to the seam.
  std::rotate(leads.begin(), leads.begin() + 1, leads.end());
  leads.back() = count;
  return leads;
}

Chain CloseCircuit(CutPath* cut, Circuit const& circuit, std::size_t piece, double share) {
  std::int32_t const count = cut->path.Count();
  CircuitPiece const& first = circuit[piece];
  Chain known;
  for (std::size_t k = 0; k < circuit.size(); ++k) {
    CircuitPiece const& next = circuit[(piece + k) % circuit.size()];
    known.pieces.push_back({0, 0, next.circle, 1.0});
    if (k == 0) continue;
    known.gates.push_back(next.gate);
    known.gates.back().split = (next.gate.split - cut->rotation + count) % count;
  }
  for (double const along : kSharesOfOpening) {
    double const place = first.low + along * (first.high - first.low);
    OpenAt(cut, place, place);
    Chain closed = FollowGates(cut->path, share, known);
    if (!closed.pieces.empty()) return closed;
  }
  return {};
}

Chain CloseChain(CutPath* cut, double share, GoesOn const& goesOn) {
  // First without asking that it closes, then with its gates and one place for both ends.
  OpenAt(cut, cut->gate.least, cut->gate.greatest);
  Chain const chain = FindChainWhile(cut->path, share, goesOn);
  if (chain.pieces.empty()) return {};
  for (double const place : PlacesToTry(*cut, chain)) {
    OpenAt(cut, place, place);
    if (chain.pieces.size() <= 2) {
      Chain halves = FollowHalves(*cut, share, chain.pieces.front().circle);
      if (!halves.pieces.empty()) return halves;
    }
    Chain closed = FollowGates(cut->path, share, chain);
    if (!closed.pieces.empty()) return closed;
  }
  OpenAt(cut, cut->offset, cut->offset);
  return FindChainWhile(cut->path, share, goesOn);
}

}  // namespace Vorn::Fewest
