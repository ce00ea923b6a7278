#include <gtest/gtest.h>

#include <cmath>
#include <initializer_list>
#include <numbers>

#include "geometry/fewest/PieceRules.h"
#include "geometry/fewest/Spacing.h"

// The rules of a piece, on points of the unit circle about the origin, counter-clockwise.

namespace Vorn::Fewest {
namespace {

using Check = PieceRules::Check;

/// Points at these angles in degrees, all of one tolerance.
Path OnUnitCircle(std::initializer_list<double> degrees, double tolerance) {
  Path path;
  for (double const d : degrees) {
    double const angle = d * std::numbers::pi / 180.0;
    path.points.push_back({std::cos(angle), std::sin(angle), tolerance});
  }
  path.leastTolerance = tolerance;
  return path;
}

/// What the rules say of the unit circle through all points of a path, in local coordinates of a
/// scale, and the condition that they added.
struct Answer {
  Check check = Check::Hopeless;
  Programme programme;
};

Answer AskOrder(Path const& path, double scale) {
  LocalFrame const frame{0.0, 0.0, scale};
  // f grows towards the centre, to the left of the way.
  Circle const circle{-0.5 / scale, 0.0, 0.0, 0.5 * scale};
  Opening const from;
  Answer answer;
  Spacing spacing(path);
  Backsteps backsteps(path);
  PieceRules const rules(path, frame, 1.0, &spacing, &backsteps, &answer.programme);
  answer.check = rules.AddBrokenOrder(circle, {&from, nullptr, 0, path.Count()});
  return answer;
}

constexpr double kScales[] = {1.0 / 64.0, 1.0, 64.0};
constexpr double kTight = 1e-9;

TEST(PieceRules, AStepUpToTheGreatestHolds) {
  for (double const scale : kScales) {
    EXPECT_EQ(AskOrder(OnUnitCircle({0, 59.9, 119.8}, kTight), scale).check, Check::Holds);
    EXPECT_EQ(AskOrder(OnUnitCircle({0, 59.9, 120.1}, kTight), scale).check, Check::Added);
  }
}

TEST(PieceRules, ALargeStepBoundsTheCurvatureToWhatTheGreatestStepAllows) {
  for (double const scale : kScales) {
    Answer const answer = AskOrder(OnUnitCircle({0, 90}, kTight), scale);
    ASSERT_EQ(answer.programme.conditionCount, 1);
    Condition const& condition = answer.programme.conditions[0];
    EXPECT_EQ(condition.kind, Condition::Kind::Slab);
    // A chord of root 2 is 60 degrees of a circle of radius root 2, so |a| <= 1 / (2 root 2).
    EXPECT_NEAR(condition.limit * scale, 0.25 * std::numbers::sqrt2, 1e-6);
    EXPECT_EQ(condition.row.a, 1.0);
    EXPECT_EQ(condition.row.bx, 0.0);
    EXPECT_EQ(condition.row.by, 0.0);
    EXPECT_EQ(condition.row.d, 0.0);
  }
}

TEST(PieceRules, PointsNearerThanTheirToleranceMakeNoStep) {
  // The chord of 80 degrees is 1.2856.
  for (double const scale : kScales) {
    EXPECT_EQ(AskOrder(OnUnitCircle({0, 80}, 1.28), scale).check, Check::Added);
    EXPECT_EQ(AskOrder(OnUnitCircle({0, 80}, 1.29), scale).check, Check::Holds);
  }
}

TEST(PieceRules, AStepBackIsNoiseUpTo165OfBothTolerances) {
  // Five degrees back are 0.0872.
  for (double const scale : kScales) {
    EXPECT_EQ(AskOrder(OnUnitCircle({0, 20, 15, 30}, 0.0265), scale).check, Check::Holds);
    EXPECT_EQ(AskOrder(OnUnitCircle({0, 20, 15, 30}, 0.0263), scale).check, Check::Added);
  }
}

TEST(PieceRules, DensePointsThatRunAgainstTheCircleAreNotInOrder) {
  // Every step is a tenth of a tolerance, and the first point is not at a joint.
  for (std::int32_t const count : {50, 3000}) {
    Path path;
    for (std::int32_t i = 0; i < count; ++i) {
      double const angle = -0.001 * i;
      path.points.push_back({std::cos(angle), std::sin(angle), 0.01});
    }
    path.leastTolerance = 0.01;
    for (double const scale : kScales) {
      EXPECT_EQ(AskOrder(path, scale).check, Check::Added) << count << " points";
    }
  }
}

TEST(PieceRules, TheWorstStepBackIsTheOneThatIsAdded) {
  for (double const scale : kScales) {
    Path const path = OnUnitCircle({0, 20, 15, 30, 20, 40, 35}, 0.01);
    Answer const answer = AskOrder(path, scale);
    ASSERT_EQ(answer.programme.conditionCount, 1);
    Condition const& condition = answer.programme.conditions[0];
    EXPECT_EQ(condition.kind, Condition::Kind::HalfSpace);
    EXPECT_NEAR(condition.limit, 1.65 * 0.02 * scale, 1e-9 * scale);
    // The row is how far the fifth point lies behind the fourth.
    Circle const circle{-0.5 / scale, 0.0, 0.0, 0.5 * scale};
    double const back = std::sin(10.0 * std::numbers::pi / 180.0) * scale;
    EXPECT_NEAR(Apply(condition.row, circle), back, 0.02 * scale);
    EXPECT_GT(Apply(condition.row, circle), condition.limit);
  }
}

TEST(PieceRules, MoreThanAFullTurnIsHopeless) {
  for (double const scale : kScales) {
    Path const less = OnUnitCircle({0, 50, 100, 150, 200, 250, 300, 350}, kTight);
    Path const more = OnUnitCircle({0, 50, 100, 150, 200, 250, 300, 350, 370}, kTight);
    EXPECT_EQ(AskOrder(less, scale).check, Check::Holds);
    EXPECT_EQ(AskOrder(more, scale).check, Check::Hopeless);
    EXPECT_EQ(AskOrder(more, scale).programme.conditionCount, 0);
  }
}

TEST(PieceRules, TheEndsOfAnOpenPathMayOverlapByHalfATolerance) {
  // Two degrees are 0.0349.
  for (double const scale : kScales) {
    Path path = OnUnitCircle({0, 50, 100, 150, 200, 250, 300, 350, 362}, 0.0697);
    EXPECT_EQ(AskOrder(path, scale).check, Check::Hopeless);
    for (WPoint& p : path.points) p.w = 0.0699;
    EXPECT_EQ(AskOrder(path, scale).check, Check::Holds);
  }
}

TEST(PieceRules, APointAtTheCentreIsHopeless) {
  // No curvature lets a step from there be small.
  Path path = OnUnitCircle({0, 90}, kTight);
  path.points[0] = {0.0, 0.0, kTight};
  for (double const scale : kScales) {
    Answer const answer = AskOrder(path, scale);
    EXPECT_EQ(answer.check, Check::Hopeless);
    EXPECT_EQ(answer.programme.conditionCount, 0);
  }
}

TEST(PieceRules, AFullProgrammeIsHopeless) {
  Path const path = OnUnitCircle({0, 90}, kTight);
  LocalFrame const frame{0.0, 0.0, 1.0};
  Opening const from;
  Programme programme;
  Spacing spacing(path);
  Backsteps backsteps(path);
  PieceRules const rules(path, frame, 1.0, &spacing, &backsteps, &programme);
  Ends const ends{&from, nullptr, 0, 2};
  for (int i = 0; i < Programme::kMostConditions; ++i) {
    ASSERT_EQ(rules.AddBrokenOrder({-0.5, 0.0, 0.0, 0.5}, ends), Check::Added);
  }
  EXPECT_EQ(rules.AddBrokenOrder({-0.5, 0.0, 0.0, 0.5}, ends), Check::Hopeless);
}

}  // namespace
}  // namespace Vorn::Fewest
