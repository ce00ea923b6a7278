#pragma once

#include <string>
#include <vector>

#include "support/Bits.h"
#include "support/Transcript.h"
#include "vorn/GeometryUtils.h"

/// One call of a fitting operation, run with `GeometryUtils` or `ReferenceFitting` as the library,
/// as the transcript of all it returns, writes and reports.
namespace Vorn::Testing {

struct LineFitInput {
  std::vector<WPoint> points;
  std::int32_t start = 0;
  std::int32_t count = 0;
  bool startFixed = false;
  GeometryUtils::Point startPoint = kPointSentinel;
  bool endFixed = false;
  GeometryUtils::Point endPoint = kPointSentinel;
  bool lastAttempt = false;
  std::vector<std::int32_t> indexList;
};

struct LineFitOutput {
  ErrorCode code = ErrorCode::Failed;
  GeometryUtils::Point startPoint;
  GeometryUtils::Point endPoint;
  std::int32_t count = kIntSentinel;
  double deviation = kSentinel;
  std::int32_t deviationIndex = kIntSentinel;
  std::vector<std::int32_t> indexList;
  ErrorCode lineCode = ErrorCode{kIntSentinel};
  std::vector<std::int32_t> progress;
};

template <class Library>
LineFitOutput FitLine(LineFitInput const& in) {
  LineFitOutput out;
  out.startPoint = in.startPoint;
  out.endPoint = in.endPoint;
  out.indexList = in.indexList;
  ProgressRecorder recorder;
  GeometryUtils::ProgressBase const progress{&recorder, 100,
                                             static_cast<std::int32_t>(in.points.size())};
  out.code = Library::GetFittingLine(in.points, in.start, in.count, in.startFixed, &out.startPoint,
                                     in.endFixed, &out.endPoint, in.lastAttempt, &out.count,
                                     &out.deviation, &out.deviationIndex, &out.indexList,
                                     &out.lineCode, progress);
  out.progress = recorder.percents;
  return out;
}

inline std::string Transcribe(LineFitOutput const& out) {
  Transcript transcript;
  transcript.Add("code", out.code);
  transcript.Add("start", out.startPoint);
  transcript.Add("end", out.endPoint);
  transcript.Add("count", out.count);
  transcript.Add("deviation", out.deviation);
  transcript.Add("deviationIndex", out.deviationIndex);
  transcript.Add("indexList", out.indexList);
  transcript.Add("lineCode", out.lineCode);
  transcript.Add("progress", out.progress);
  return transcript.Text();
}

struct ArcFitInput {
  std::vector<WPoint> points;
  std::int32_t first = 0;
  std::int32_t maxCount = 0;
  std::int32_t minCount = 0;
  bool startFixed = false;
  GeometryUtils::Point start = kPointSentinel;
  bool endFixed = false;
  GeometryUtils::Point end = kPointSentinel;
  std::vector<GeometryUtils::IndexedPoint> indexedPoints;
  std::vector<GeometryUtils::Triangle> cells;
};

struct ArcFitOutput {
  ErrorCode code = ErrorCode::Failed;
  GeometryUtils::Point start;
  GeometryUtils::Point end;
  std::vector<GeometryUtils::IndexedPoint> indexedPoints;
  std::vector<GeometryUtils::Triangle> cells;
  std::int32_t count = kIntSentinel;
  GeometryUtils::Point centre = kPointSentinel;
  double radius = kSentinel;
  bool ccw = false;
  double deviation = kSentinel;
  std::int32_t deviationIndex = kIntSentinel;
  std::vector<std::int32_t> progress;
};

inline ArcFitOutput PresetArcFitOutput(ArcFitInput const& in) {
  ArcFitOutput out;
  out.start = in.start;
  out.end = in.end;
  out.indexedPoints = in.indexedPoints;
  out.cells = in.cells;
  return out;
}

/// The fitter of one run: `maxCount` is its count, `minCount` is not used.
template <class Library>
ArcFitOutput FitArcRun(ArcFitInput const& in) {
  ArcFitOutput out = PresetArcFitOutput(in);
  out.code = Library::GetFittingCircleO(in.points, in.first, in.maxCount, in.startFixed, &out.start,
                                        in.endFixed, &out.end, &out.indexedPoints, &out.cells,
                                        &out.count, &out.centre, &out.radius, &out.ccw,
                                        &out.deviation, &out.deviationIndex);
  return out;
}

template <class Library>
ArcFitOutput GrowArc(ArcFitInput const& in) {
  ArcFitOutput out = PresetArcFitOutput(in);
  ProgressRecorder recorder;
  GeometryUtils::ProgressBase const progress{&recorder, 100,
                                             static_cast<std::int32_t>(in.points.size())};
  out.code = Library::GetFittingCircle2(in.points, in.first, in.maxCount, in.minCount,
                                        in.startFixed, &out.start, in.endFixed, &out.end,
                                        &out.cells, &out.count, &out.centre, &out.radius, &out.ccw,
                                        &out.deviation, &out.deviationIndex, progress);
  out.progress = recorder.percents;
  return out;
}

template <class Library>
ArcFitOutput ShrinkArc(ArcFitInput const& in) {
  ArcFitOutput out = PresetArcFitOutput(in);
  out.code =
      Library::GetFittingCircle1(in.points, in.first, in.maxCount, in.minCount, in.startFixed,
                                 &out.start, in.endFixed, &out.end, &out.count, &out.centre,
                                 &out.radius, &out.ccw, &out.deviation, &out.deviationIndex);
  return out;
}

inline std::string Transcribe(ArcFitOutput const& out) {
  Transcript transcript;
  transcript.Add("code", out.code);
  transcript.Add("start", out.start);
  transcript.Add("end", out.end);
  transcript.Add("count", out.count);
  transcript.Add("centre", out.centre);
  transcript.Add("radius", out.radius);
  transcript.Add("ccw", out.ccw);
  transcript.Add("deviation", out.deviation);
  transcript.Add("deviationIndex", out.deviationIndex);
  transcript.Add("progress", out.progress);
  transcript.Add("indexedPoints", out.indexedPoints);
  transcript.Add("cells", out.cells);
  return transcript.Text();
}

struct CurveFitOutput {
  ErrorCode code = ErrorCode::Failed;
  std::vector<GeometryUtils::Elem> contour;
  double maxDeviation = kSentinel;
  std::int32_t maxDeviationIndex = kIntSentinel;
  std::vector<std::int32_t> progress;
};

template <class Library>
CurveFitOutput FitCurve(std::vector<WPoint> const& points,
                        GeometryUtils::FittingStrategy strategy) {
  CurveFitOutput out;
  ProgressRecorder recorder;
  out.code = Library::CreateFittingCurve(points, strategy, &out.contour, &out.maxDeviation,
                                         &out.maxDeviationIndex, &recorder, 100);
  out.progress = recorder.percents;
  return out;
}

inline std::string Transcribe(CurveFitOutput const& out) {
  Transcript transcript;
  transcript.Add("code", out.code);
  transcript.Add("maxDeviation", out.maxDeviation);
  transcript.Add("maxDeviationIndex", out.maxDeviationIndex);
  transcript.Add("contour", out.contour);
  transcript.Add("progress", out.progress);
  return transcript.Text();
}

}  // namespace Vorn::Testing
