#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fewest/BothWays.h"
#include "geometry/fewest/Bound.h"
#include "geometry/fewest/Circuit.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Seam.h"
#include "support/RandomGeometry.h"
#include "support/fewest/Scans.h"

namespace Vorn::Fewest {
namespace {

using Testing::NominalPiece;
using Testing::RandomGeometry;
using Testing::Scan;

constexpr double kShare = 1.0 - 1e-6;
constexpr double kHalfTurn = 10.0 * 3.141592653589793;
constexpr std::int32_t kCount = 480;

bool Always(std::size_t, std::int32_t) { return true; }

/// Two lines and two half circles in noise, from a point on.
Path Stadium(std::int32_t start) {
  RandomGeometry random(8101);
  Scan scan = Testing::SampleWithNormalNoise(
      &random, {{30.0, 0.0}, {kHalfTurn, 0.1}, {30.0, 0.0}, {kHalfTurn, 0.1}}, kCount + 1, 0.02,
      0.45);
  scan.pop_back();
  std::rotate(scan.begin(), scan.begin() + start, scan.end());
  Shift const shift = ShiftFor(scan);
  Path path;
  path.points = shift.Apply(scan);
  path.leastTolerance = Tightest(scan).w * shift.scale;
  return path;
}

std::vector<std::int32_t> RunStarts(Path const& path) {
  return CoverGreedily(path.points, path.limits, [](std::int32_t) {}).starts;
}

/// How many points lie from each gate to the next.
std::vector<std::int32_t> Lengths(Circuit const& circuit) {
  std::vector<std::int32_t> lengths;
  for (std::size_t k = 0; k < circuit.size(); ++k) {
    std::int32_t const next = circuit[(k + 1) % circuit.size()].gate.split;
    lengths.push_back((next - circuit[k].gate.split + kCount) % kCount);
  }
  return lengths;
}

TEST(FindCircuit, HasThePiecesOfTheContourWhereverItBegins) {
  for (std::int32_t const start : {0, 1, 17, 60, 100, 240, 333, 479}) {
    SCOPED_TRACE(testing::Message() << "started at " << start);
    Path const path = Stadium(start);
    Circuit const circuit = FindCircuit(path, kShare, Always);
    ASSERT_EQ(circuit.size(), 4U);
    std::int32_t sum = 0;
    for (std::int32_t const length : Lengths(circuit)) {
      // Lines and half circles have nearly as many points.
      EXPECT_NEAR(length, kCount / 4, 20);
      sum += length;
    }
    EXPECT_EQ(sum, kCount);
    for (CircuitPiece const& piece : circuit) {
      EXPECT_GE(piece.gate.split, 0);
      EXPECT_LT(piece.gate.split, kCount);
      EXPECT_LE(piece.gate.least, piece.low);
      EXPECT_LE(piece.low, piece.high);
      EXPECT_LE(piece.high, piece.gate.greatest);
    }
  }
}

TEST(FindCircuit, IsEmptyWhereOnePieceLeadsAllAround) {
  RandomGeometry random(8102);
  Scan scan = Testing::SampleWithNormalNoise(&random, {{2.0 * kHalfTurn, 0.1}}, 301, 0.02, 0.3);
  scan.pop_back();
  Path path;
  path.points = scan;
  path.leastTolerance = Tightest(scan).w;
  EXPECT_TRUE(FindCircuit(path, kShare, Always).empty());
}

TEST(FindCircuit, EndsAsSoonAsItIsNotToGoOn) {
  std::size_t asked = 0;
  Circuit const circuit = FindCircuit(Stadium(60), kShare, [&](std::size_t pieces, std::int32_t) {
    asked = pieces;
    return pieces < 2;
  });
  EXPECT_TRUE(circuit.empty());
  EXPECT_EQ(asked, 2U);
}

TEST(FindCircuitBackwards, HasAsManyPieces) {
  Path const path = Stadium(60);
  Circuit const circuit = FindCircuitBackwards(path, kShare, RunStarts(path), 100);
  ASSERT_EQ(circuit.size(), 4U);
  for (std::int32_t const length : Lengths(circuit)) EXPECT_NEAR(length, kCount / 4, 20);
}

TEST(FindCircuitBackwards, IsEmptyWhereFewerPiecesAreOutOfReach) {
  Path const path = Stadium(60);
  std::vector<std::int32_t> const runs = RunStarts(path);
  ASSERT_GE(runs.size(), 4U);
  EXPECT_TRUE(FindCircuitBackwards(path, kShare, runs, 2).empty());
}

TEST(ReversedCircuit, TwiceIsTheCircuitItself) {
  Circuit const circuit = FindCircuit(Stadium(17), kShare, Always);
  ASSERT_EQ(circuit.size(), 4U);
  Circuit const twice = Reversed(Reversed(circuit, kCount), kCount);
  ASSERT_EQ(twice.size(), circuit.size());
  for (std::size_t k = 0; k < circuit.size(); ++k) {
    auto const same = std::find_if(twice.begin(), twice.end(), [&](CircuitPiece const& piece) {
      return piece.gate.split == circuit[k].gate.split;
    });
    ASSERT_NE(same, twice.end());
    EXPECT_EQ(same->gate.across.x, circuit[k].gate.across.x);
    EXPECT_EQ(same->gate.least, circuit[k].gate.least);
    EXPECT_EQ(same->low, circuit[k].low);
    EXPECT_EQ(same->high, circuit[k].high);
    EXPECT_EQ(same->circle.about.a, circuit[k].circle.about.a);
  }
}

TEST(CloseCircuit, BeginsAndEndsAtOnePlaceOfTheSeam) {
  Path const path = Stadium(100);
  for (Circuit const& circuit : {FindCircuit(path, kShare, Always),
                                 FindCircuitBackwards(path, kShare, RunStarts(path), 100)}) {
    ASSERT_EQ(circuit.size(), 4U);
    std::vector<Seam> const seams = SharpestJoints(circuit, 1);
    ASSERT_EQ(seams.size(), 1U);
    CutPath cut = CutAt(path, seams.front());
    Chain const chain = CloseCircuit(&cut, circuit, seams.front().piece, kShare);
    ASSERT_EQ(chain.pieces.size(), 4U);
    EXPECT_EQ(chain.pieces.back().end, kCount);
    Place const seam = PlaceOn(cut.path.finish.gate, cut.path.finish.low);
    double const room = 1e-6 * path.leastTolerance;
    EXPECT_NEAR(ValueAt(chain.pieces.front().circle, seam), 0.0, room);
    EXPECT_NEAR(ValueAt(chain.pieces.back().circle, seam), 0.0, room);
  }
}

TEST(LeadsFrom, CountFromTheSeamAndEndWithTheWholeLap) {
  CutPath cut;
  cut.path.points.resize(100);
  cut.rotation = 30;
  Circuit circuit(4);
  // The piece that leads beyond the seam, to 35, is the last of the lap.
  circuit[0].farthest = 35;
  circuit[1].farthest = 60;
  circuit[2].farthest = 90;
  circuit[3].farthest = 10;
  EXPECT_EQ(LeadsFrom(cut, circuit), (std::vector<std::int32_t>{30, 60, 80, 100}));
  EXPECT_TRUE(LeadsFrom(cut, {}).empty());
}

}  // namespace
}  // namespace Vorn::Fewest
