#pragma once

#include <cstdint>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {

/// A second, deliberately plain implementation of the whole fitting road, to be compared with the
/// library bit for bit: results, codes, progress calls and the state of every in/out argument.
///
/// It rests on the library's elementary geometry and cell primitives (`GetLineTriangles`,
/// `GetCircleTriangles`, `GetOverlapping`, `GetCenter`, ...) and composes them step by step, with
/// no care for speed: nothing is cached, nothing is skipped, every cell is copied. Names and
/// parameters are those of `GeometryUtils`, so one test template runs either.
class ReferenceFitting {
 public:
  using Point = GeometryUtils::Point;
  using Elem = GeometryUtils::Elem;
  using Triangle = GeometryUtils::Triangle;
  using IndexedPoint = GeometryUtils::IndexedPoint;
  using ProgressBase = GeometryUtils::ProgressBase;
  using FittingStrategy = GeometryUtils::FittingStrategy;
  using CircleRadiusFindingStrategy = GeometryUtils::CircleRadiusFindingStrategy;

  ReferenceFitting() = delete;

  /// Strategies `Mixed` and `SingleArc` only: the walk of `MixedCells` has freedoms that no second
  /// implementation can foresee, so with it (and more than two valid points) this throws
  /// std::logic_error.
  static ErrorCode CreateFittingCurve(std::vector<WPoint> const& points, FittingStrategy strategy,
                                      std::vector<Elem>* contour, double* maxDeviation,
                                      std::int32_t* maxDeviationIndex,
                                      ExecutionState* executionState, std::int32_t maxPercent);

  // Line fitting.
  static ErrorCode GetFittingLine(std::vector<WPoint> const& points, std::int32_t start,
                                  std::int32_t count, bool startFixed, Point* startPoint,
                                  bool endFixed, Point* endPoint, bool lastAttempt,
                                  std::int32_t* lineCount, double* lineDeviation,
                                  std::int32_t* lineDeviationIndex,
                                  std::vector<std::int32_t>* indexList, ErrorCode* lineCode,
                                  ProgressBase const& progress);
  static double GetMaxDeviationFromLine(std::vector<WPoint> const& points, std::int32_t start,
                                        std::int32_t count, Point const& a, Point const& b,
                                        std::int32_t* index);
  static bool GetDeviationFromLineParameters(Point const& a, Point const& b,
                                             std::vector<WPoint> const& points, std::int32_t start,
                                             std::int32_t count, double* minDeviation,
                                             double* maxDeviation, std::int32_t* minIndex,
                                             std::int32_t* maxIndex);
  static bool GetDeviationFromLineParameters(Point const& a, Point const& b,
                                             std::vector<WPoint> const& points, std::int32_t start,
                                             std::int32_t count,
                                             std::vector<std::int32_t>* indices);
  static bool GetOptimalLineSegment(std::vector<Triangle> const* cell, double x1, double y1,
                                    double x2, double y2, bool xOfY, bool startFixed,
                                    Point startPoint, bool endFixed, Point endPoint, double* sx,
                                    double* sy, double* ex, double* ey);
  static bool IsValidLineOrder(Point const& first, Point const& middle, Point const& last);
  static bool ReduceOverlappedTrianglesQuantityForStraightLine(std::vector<WPoint> const& points,
                                                               int start, int count,
                                                               double tolerance,
                                                               std::vector<Triangle>* cell);
  static void SetProgressState(ProgressBase const& progress, std::int32_t current);

  // Arc fitting over cells.
  static ErrorCode GetFittingCircleO(std::vector<WPoint> const& points, std::int32_t first,
                                     std::int32_t count, bool startFixed, Point* start,
                                     bool endFixed, Point* end,
                                     std::vector<IndexedPoint>* indexedPoints,
                                     std::vector<Triangle>* cells, std::int32_t* arcCount,
                                     Point* centre, double* radius, bool* ccw, double* deviation,
                                     std::int32_t* deviationIndex);
  static ErrorCode GetFittingCircle2(std::vector<WPoint> const& points, std::int32_t first,
                                     std::int32_t maxCount, std::int32_t minCount, bool startFixed,
                                     Point* start, bool endFixed, Point* end,
                                     std::vector<Triangle>* cells, std::int32_t* arcCount,
                                     Point* centre, double* radius, bool* ccw, double* deviation,
                                     std::int32_t* deviationIndex, ProgressBase const& progress);
  static ErrorCode GetFittingCircle1(std::vector<WPoint> const& points, std::int32_t first,
                                     std::int32_t maxCount, std::int32_t minCount, bool startFixed,
                                     Point* start, bool endFixed, Point* end,
                                     std::int32_t* arcCount, Point* centre, double* radius,
                                     bool* ccw, double* deviation, std::int32_t* deviationIndex);
  static bool IsValidArcOrder(Point const& centre, bool ccw, Point const& p1, Point const& p2,
                              Point const& p3, bool skipFirstGap);

  // Arc point reduction.
  static ErrorCode ReduceCircleArcPoints(std::vector<IndexedPoint>* samples,
                                         std::vector<Triangle>* cell, int steps, bool firstFixed,
                                         Point* first, bool lastFixed, Point* last,
                                         std::vector<WPoint> const& wpoints, std::int32_t begin,
                                         std::int32_t count, bool ccw);
  static void GetTriPointIndices(int step, int size, int mirror, int* i0, int* i1, int* i2);
  static void TriPointsCoordsToArray(std::vector<IndexedPoint> const* samples, int i0, int i1,
                                     int i2, bool firstFixed, Point const& first, bool lastFixed,
                                     Point const& last, bool* usedFirst, bool* usedLast,
                                     double* const coords);
  static bool IsValidArcOrder(Point const& center, bool ccw, Point const& p1, Point const& p2,
                              Point const& p3);

  // Circle estimation and radius choice.
  static bool GetEstimatedCircle(std::vector<WPoint> const& points, Point* first, Point* middle,
                                 Point* last, Point* center, double* radius, double* minSpacing);
  static bool GetEstimatedMaxDeviationForCircle(Point const& first, Point const& middle,
                                                Point const& last, double radius,
                                                double* deviation);
  static bool GetEstimatedDeviationForCircle(std::vector<WPoint> const& points, double* tolerance,
                                             std::vector<std::int32_t>* excluded, Point* center,
                                             double* radius);
  static bool GetRadiusRange(std::vector<WPoint> const& points, std::int32_t first,
                             std::int32_t count, double cx, double cy, double tolerance,
                             double* minRadius, double* maxRadius);
  static bool CalcOptimalRadius(std::vector<WPoint> const& points, std::int32_t first,
                                std::int32_t count, double cx, double cy, double tolerance,
                                CircleRadiusFindingStrategy strategy, double* radius);
  static bool CalcDeviationCurve(std::vector<WPoint> const& points, std::int32_t first,
                                 std::int32_t count, Point const& center, double radius,
                                 std::vector<WPoint2>* curve);
  static bool CalcCorrectionShiftForCircle(std::vector<WPoint2> const& curve, Point* shift);
  static double GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                        std::int32_t count, Point const& center, double radius,
                                        std::int32_t* index);
  static bool GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                      std::int32_t count, Point const& center, double radius,
                                      double* minSigned, double* maxSigned);

  // Circle fit by mean circumcentre.
  static ErrorCode GetFittingCircle(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                    std::int32_t count, bool firstFixed, Point* first,
                                    bool lastFixed, Point* last, std::int32_t* fitCount,
                                    Point* center, double* radius, bool* ccw, double* extra);
  static bool GetRadiusRange(std::vector<WPoint> const& wpoints, std::int32_t begin,
                             std::int32_t count, double cx, double cy, double tolerance,
                             bool firstFixed, Point const* first, bool lastFixed, Point const* last,
                             std::int32_t* failIndex, double* rmin, double* rmax);
  static bool AdjustCenter(Point const& p1, Point const& p2, Point const& center, Point* adjusted);
  static ErrorCode IsCcw(std::vector<WPoint> const& wpoints, std::int32_t begin, std::int32_t count,
                         bool firstFixed, Point const& first, bool lastFixed, Point const& last,
                         Point const& center, bool* ccw);
};

}  // namespace Vorn::Testing
