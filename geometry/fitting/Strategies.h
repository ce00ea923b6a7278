#pragma once

#include <cstdint>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn {

/// The largest deviation met over the elements of a contour. The first element always sets it; of
/// equal ones the first stands.
struct LargestDeviation {
  double value = -1.0;
  std::int32_t index = -1;

  void Take(double deviation, std::int32_t deviationIndex) {
    if (value < 0.0 || deviation > value) {
      value = deviation;
      index = deviationIndex;
    }
  }
};

/// Segments and arcs compared run by run; the longer reach wins.
class MixedWalk {
 public:
  MixedWalk(std::vector<WPoint> const& points, std::vector<GeometryUtils::Elem>* contour,
            GeometryUtils::ProgressBase const& progress);

  /// Appends elements up to the last point, or as far as either fitter gets.
  LargestDeviation Run();

 private:
  using Point = GeometryUtils::Point;

  struct Piece {
    Point start;
    Point end;
    std::int32_t count = 0;
    double deviation = 0.0;
    std::int32_t deviationIndex = -1;
  };

  struct Line : Piece {
    ErrorCode code = ErrorCode::Ok;
  };

  struct Arc : Piece {
    Point centre;
    double radius = 0.0;
    bool ccw = false;
  };

  bool FitLine(std::int32_t remaining, Line* line);
  bool FitArc(std::int32_t remaining, std::int32_t minimumRun, Arc* arc);
  void Accept(Piece const& piece);

  std::vector<WPoint> const& points_;
  std::vector<GeometryUtils::Elem>& contour_;
  GeometryUtils::ProgressBase const& progress_;

  std::int32_t runStart_ = 0;
  bool startFixed_ = false;
  Point start_;
  Point end_;
  std::vector<std::int32_t> indexList_;
  LargestDeviation largest_;
};

/// Segments first; the points skipped between them are covered by arcs fixed at both ends.
class CellsWalk {
 public:
  CellsWalk(std::vector<WPoint> const& points, std::vector<GeometryUtils::Elem>* contour,
            GeometryUtils::ProgressBase const& progress);

  ErrorCode Run(LargestDeviation* largest);

 private:
  using Point = GeometryUtils::Point;

  struct Line {
    Point start;
    Point end;
    std::int32_t count = 0;
    double deviation = 0.0;
    std::int32_t deviationIndex = -1;
  };

  ErrorCode FindLine(bool isLastPair, Line* line);
  ErrorCode FitLine(std::int32_t first, std::int32_t count, bool startFixed, bool endFixed,
                    Line* line);
  ErrorCode TakeLine(Line* line);
  ErrorCode CoverGap(std::int32_t last, Point const& end);
  ErrorCode CoverByArc(std::int32_t last, Point const& end);
  ErrorCode BridgeGap(Point const& end);
  void CoverTail();
  ErrorCode FitArc(std::int32_t count, bool startFixed, bool endFixed, Point const& end);
  void AppendSegments(std::int32_t last, Point const& end);
  void AppendSegment(std::int32_t last, Point const& end);
  void PlaceStart(Point const& start);
  /// Where the next element begins: the last element's end, at first the first input point.
  Point CurrentEnd() const;
  std::int32_t LastIndex() const;

  std::vector<WPoint> const& points_;
  std::vector<GeometryUtils::Elem>& contour_;
  GeometryUtils::ProgressBase const& progress_;

  /// The last point that an element covers.
  std::int32_t anchor_ = 0;
  /// How many points after the anchor the search for segments has passed over.
  std::int32_t skipped_ = 0;
  bool startElementPending_ = true;
  LargestDeviation largest_;
};

/// One arc through all points: estimated, fitted over cells, then refined by least squares.
class SingleArcFit {
 public:
  SingleArcFit(std::vector<WPoint> const& points, std::vector<GeometryUtils::Elem>* contour,
               GeometryUtils::ProgressBase const& progress);

  ErrorCode Run(double* maxDeviation, std::int32_t* maxDeviationIndex);

 private:
  using Point = GeometryUtils::Point;

  struct Circle {
    Point centre;
    double radius = 0.0;
  };

  ErrorCode FitThreePoints();
  ErrorCode FindStartingCircle();
  std::vector<WPoint> ReducedPoints(std::vector<std::int32_t> const& excluded) const;
  ErrorCode Refine(double* deviation, std::int32_t* index);
  ErrorCode ImproveCircle();
  ErrorCode WriteContour();
  std::int32_t Count() const;

  std::vector<WPoint> const& points_;
  std::vector<GeometryUtils::Elem>& contour_;
  GeometryUtils::ProgressBase const& progress_;

  double tolerance_ = 0.0;
  Circle circle_;
  bool ccw_ = false;
  /// Whether the arc ends where a fit that did not cover all points ended.
  bool endsShort_ = false;
  Point shortEnd_;
};

}  // namespace Vorn
