#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

#include "geometry/fewest/promises/Promises.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"
#include "support/fewest/Motions.h"
#include "support/fewest/NominalContour.h"
#include "support/fewest/PromiseChecker.h"
#include "support/fewest/Scans.h"

// The measurement of the service against the plain one of the tests, on contours that keep their
// promises and on contours that just do not.

namespace Vorn::Testing {
namespace {

using Promises::PieceRange;
using Promises::Promise;

struct Trial {
  Scan points;
  std::vector<GeometryUtils::Elem> contour;
  std::vector<PieceRange> ranges;
};

/// Points at equal lengths belong to the piece that they were taken from.
Trial MakeTrial(RandomGeometry* random, std::vector<NominalPiece> const& pieces, std::int32_t count,
                double w, double noise) {
  Trial trial;
  NominalContour const nominal = MakeNominalContour(pieces);
  trial.contour = nominal.contour;
  trial.points = SampleWithNormalNoise(random, pieces, count, w, noise);
  double const length = Walk(pieces).Length();
  std::int32_t first = 0;
  for (std::size_t k = 0; k < pieces.size(); ++k) {
    std::int32_t last = first;
    while (last + 1 < count && length * (last + 1) / (count - 1) <= nominal.joints[k + 1]) ++last;
    if (k + 1 == pieces.size()) last = count - 1;
    trial.ranges.push_back({first, last});
    first = last + 1;
  }
  return trial;
}

Promises::Report MeasureTrial(Trial const& t, double largestStep) {
  return Promises::Measure({t.points, t.contour, t.ranges, false, largestStep});
}

PromiseCheck CheckTrial(Trial const& t, double largestStep) {
  return CheckPromises<PieceRange>({t.points, t.contour, t.ranges, false, largestStep});
}

TEST(MeasurePromises, AgreesWithThePlainChecker) {
  RandomGeometry random(4301);
  int kept = 0;
  int broken = 0;
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 4301, round " << round);
    auto const style = static_cast<ProfileStyle>(random.Integer(0, 2));
    auto const pieces = MakeProfilePieces(&random, style, 1);
    double const noise = random.Flip() ? 1.0 : 1.0 + std::exp2(random.Uniform(-30.0, -3.0));
    std::int32_t const count = random.Integer(100, 400);
    double const w = std::exp2(random.Uniform(-20.0, -2.0));
    Trial trial = MakeTrial(&random, pieces, count, w, noise);
    if (random.Integer(0, 3) == 0) {
      auto const i = static_cast<std::size_t>(random.Integer(0, count - 2));
      std::swap(trial.points[i], trial.points[i + 1]);
    }
    double const largestStep = random.Uniform(0.1, 1.0);
    auto const report = MeasureTrial(trial, largestStep);
    auto const check = CheckTrial(trial, largestStep);
    EXPECT_EQ(report.violations.empty(), check.complaints.empty()) << check.Text();
    EXPECT_NEAR(report.largestRatio, check.largestRatio, 1e-9 + 4e-15 / w);
    EXPECT_EQ(report.largestIndex, static_cast<std::size_t>(check.largestIndex));
    (check.complaints.empty() ? kept : broken) += 1;
  }
  EXPECT_GT(kept, 300);
  EXPECT_GT(broken, 300);
}

TEST(MeasurePromises, AgreesWithThePlainCheckerOnWhatCrosses) {
  RandomGeometry random(4302);
  int kept = 0;
  int broken = 0;
  int stricter = 0;
  for (int round = 0; round < 6000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 4302, round " << round);
    // Pieces that wind about a small place, and points that follow them or a shape beside them.
    std::vector<NominalPiece> pieces;
    for (int k = random.Integer(2, 5); k > 0; --k) {
      double const curvature = random.Flip() ? 0.0 : random.Uniform(-0.4, 0.4);
      pieces.push_back({random.Uniform(2.0, 12.0), curvature, random.Uniform(-2.5, 2.5)});
    }
    Trial trial = MakeTrial(&random, pieces, random.Integer(20, 120), 0.05, 0.9);
    if (random.Flip()) {
      // A scan of something else within wide tolerances: straight on, where nothing crosses.
      for (std::size_t i = 0; i < trial.points.size(); ++i) {
        trial.points[i] = {0.3 * static_cast<double>(i), 0.0, 100.0};
      }
    }
    auto const crosses = [](Promises::Violation const& v) {
      return v.promise == Promise::NotCrossing;
    };
    auto const report = MeasureTrial(trial, 10.0);
    bool const isReported =
        std::any_of(report.violations.begin(), report.violations.end(), crosses);
    auto const check = CheckTrial(trial, 10.0);
    bool const isComplained =
        std::any_of(check.complaints.begin(), check.complaints.end(),
                    [](std::string const& text) { return text.find("cross") != text.npos; });
    // The plain checker takes every meeting of the path for a crossing. A corner of the path that
    // pokes through another strand by less than its tolerance is none.
    EXPECT_TRUE(isReported || !isComplained) << check.Text();
    stricter += isReported && !isComplained ? 1 : 0;
    (isComplained ? broken : kept) += 1;
  }
  EXPECT_LT(stricter, 12);
  EXPECT_GT(kept, 300);
  EXPECT_GT(broken, 300);
}

TEST(MeasurePromises, DoesNotDependOnPowersOfTwo) {
  RandomGeometry random(4303);
  for (int round = 0; round < 200; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 4303, round " << round);
    auto const pieces = MakeProfilePieces(&random, ProfileStyle::Mixed, 1);
    Trial const trial = MakeTrial(&random, pieces, 200, 0.02, 1.01);
    double const factor = std::exp2(random.Integer(-40, 40));
    Trial scaled = trial;
    scaled.points = Magnified(trial.points, factor);
    for (auto& elem : scaled.contour) {
      elem.end = Scale(elem.end, factor);
      elem.center = Scale(elem.center, factor);
      elem.radius *= factor;
    }
    auto const report = MeasureTrial(trial, 1.0);
    auto const scaledReport = MeasureTrial(scaled, 1.0);
    ASSERT_EQ(report.violations.size(), scaledReport.violations.size());
    EXPECT_EQ(report.largestRatio, scaledReport.largestRatio);
    EXPECT_EQ(report.largestIndex, scaledReport.largestIndex);
  }
}

}  // namespace
}  // namespace Vorn::Testing
