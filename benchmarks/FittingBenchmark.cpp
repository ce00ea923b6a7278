// The fit of whole profiles: by the library, and by the plain composition of its exported steps.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <memory>
#include <optional>
#include <string>
#include <utility>

#include "benchmarks/AllocationMeter.h"
#include "benchmarks/Measure.h"
#include "benchmarks/MeasuredContours.h"
#include "benchmarks/Profiles.h"
#include "benchmarks/Registration.h"
#include "benchmarks/Subjects.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Benchmarks {
namespace {

using Strategy = GeometryUtils::FittingStrategy;
using Elem = GeometryUtils::Elem;

struct NamedStrategy {
  Strategy strategy;
  char const* name;
};

constexpr NamedStrategy kStrategies[] = {
    {Strategy::Mixed, "Mixed"},
    {Strategy::MixedCells, "MixedCells"},
    {Strategy::SingleArc, "SingleArc"},
};

struct Fit {
  ErrorCode code = ErrorCode::Failed;
  std::vector<Elem> contour;
  double deviation = 0.0;
  std::int32_t deviationIndex = 0;
};

Fit FitByLibrary(std::vector<WPoint> const& points, Strategy strategy) {
  Fit fit;
  fit.code = GeometryUtils::CreateFittingCurve(points, strategy, &fit.contour, &fit.deviation,
                                               &fit.deviationIndex, nullptr, 100);
  return fit;
}

Fit FitPlainly(std::vector<WPoint> const& points, Strategy strategy) {
  Fit fit;
  fit.code = Testing::ReferenceFitting::CreateFittingCurve(
      points, strategy, &fit.contour, &fit.deviation, &fit.deviationIndex, nullptr, 100);
  return fit;
}

bool AreSame(GeometryUtils::Point const& p, GeometryUtils::Point const& q) {
  return p.x == q.x && p.y == q.y;
}

bool AreSame(Elem const& a, Elem const& b) {
  if (a.type != b.type || !AreSame(a.end, b.end)) return false;
  if (a.type == GeometryUtils::ElemType::Segment) return true;
  return AreSame(a.center, b.center) && a.radius == b.radius && a.direction == b.direction &&
         a.startAngle == b.startAngle && a.endAngle == b.endAngle;
}

bool AreSame(Fit const& a, Fit const& b) {
  return a.code == b.code && a.deviation == b.deviation && a.deviationIndex == b.deviationIndex &&
         std::equal(a.contour.begin(), a.contour.end(), b.contour.begin(), b.contour.end(),
                    [](Elem const& p, Elem const& q) { return AreSame(p, q); });
}

/// What the fit answers and needs. The first run finds it; it is the only one when a run is long.
struct Outcome {
  Fit fit;
  std::int64_t peakBytes = 0;
};

Outcome Examine(std::vector<WPoint> const& points, Strategy strategy) {
  Outcome outcome;
  AllocationMeter const meter;
  outcome.fit = FitByLibrary(points, strategy);
  outcome.peakBytes = meter.PeakBytes();
  return outcome;
}

/// SingleArc reports a distance; this is the same in tolerances.
double LargestFromCircle(std::vector<WPoint> const& points, GeometryUtils::Arc const& arc) {
  double largest = 0.0;
  for (WPoint const& p : points) {
    double const distance = std::hypot(p.x - arc.center.x, p.y - arc.center.y);
    largest = std::max(largest, std::fabs(distance - arc.radius) / p.w);
  }
  return largest;
}

void Report(Profile const& profile, Fit const& fit, Strategy strategy, benchmark::State* state) {
  std::size_t const pieces = fit.contour.empty() ? 0 : fit.contour.size() - 1;
  CountTimePer(state, "seconds_per_point", static_cast<std::int64_t>(profile.points.size()));
  state->counters["pieces"] = static_cast<double>(pieces);
  if (profile.truePieces > 0) state->counters["true_pieces"] = profile.truePieces;
  if (fit.code == ErrorCode::Ok) {
    state->counters["largest_relative_deviation"] =
        strategy == Strategy::SingleArc ? LargestFromCircle(profile.points, fit.contour.back())
                                        : fit.deviation;
  }
  state->counters["code"] = static_cast<double>(fit.code);
}

void RegisterLibraryFit(std::string const& name, SubjectOfSize const& subject, Strategy strategy,
                        std::shared_ptr<TimeBudget> const& budget) {
  auto const outcome = std::make_shared<std::optional<Outcome>>();
  auto const body = [=](benchmark::State& state) {
    if (!IsWithin(*budget, subject.size, &state)) return;
    Profile const& profile = subject.subject->Get();
    TimeWithin(budget.get(), subject.size, &state, [&] {
      if (!*outcome) {
        *outcome = Examine(profile.points, strategy);
      } else {
        benchmark::DoNotOptimize(FitByLibrary(profile.points, strategy));
      }
    });
    Fit const& fit = (*outcome)->fit;
    if (strategy == Strategy::Mixed && (fit.code != ErrorCode::Ok || fit.deviation > 1.0)) {
      state.SkipWithError("the contour does not keep the tolerance");
    }
    Report(profile, fit, strategy, &state);
    state.counters["peak_bytes"] = static_cast<double>((*outcome)->peakBytes);
  };
  benchmark::RegisterBenchmark(name.c_str(), body)->Unit(benchmark::kMillisecond);
}

void RegisterPlainFit(std::string const& name, SubjectOfSize const& subject, Strategy strategy,
                      std::shared_ptr<TimeBudget> const& budget) {
  auto const body = [=](benchmark::State& state) {
    if (!IsWithin(*budget, subject.size, &state)) return;
    Profile const& profile = subject.subject->Get();
    Fit fit;
    TimeWithin(budget.get(), subject.size, &state,
               [&] { fit = FitPlainly(profile.points, strategy); });
    if (!AreSame(fit, FitByLibrary(profile.points, strategy))) {
      state.SkipWithError("the plain composition answers another contour");
      return;
    }
    Report(profile, fit, strategy, &state);
  };
  benchmark::RegisterBenchmark(name.c_str(), body)->Unit(benchmark::kMillisecond);
}

/// The plain composition leaves out MixedCells, whose walk may be done in more than one way.
bool HasPlainForm(Strategy strategy) { return strategy != Strategy::MixedCells; }

std::string NameOf(char const* function, NamedStrategy const& strategy, std::string const& profile,
                   std::int64_t size) {
  return std::string(function) + '_' + strategy.name + '/' + profile + '/' + std::to_string(size);
}

double SecondsForLibrary(Scale scale) { return scale == Scale::Quick ? 2.0 : 60.0; }

double SecondsForPlain(Scale scale) { return scale == Scale::Quick ? 1.0 : 60.0; }

constexpr std::int64_t kLargestPlainSize = 1000;

void RegisterMadeProfiles(Scale scale) {
  for (Maker const& maker : kMakers) {
    std::vector<SubjectOfSize> const subjects = SubjectsOf(maker, SizesFor(scale));
    for (NamedStrategy const& strategy : kStrategies) {
      auto const budget = std::make_shared<TimeBudget>(SecondsForLibrary(scale));
      auto const plainBudget = std::make_shared<TimeBudget>(SecondsForPlain(scale));
      for (SubjectOfSize const& subject : subjects) {
        RegisterLibraryFit(NameOf("BM_CreateFittingCurve", strategy, maker.name, subject.size),
                           subject, strategy.strategy, budget);
        if (!HasPlainForm(strategy.strategy) || subject.size > kLargestPlainSize) continue;
        RegisterPlainFit(NameOf("BM_PlainComposition", strategy, maker.name, subject.size), subject,
                         strategy.strategy, plainBudget);
      }
    }
  }
}

void RegisterMeasuredContours(Scale scale) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) {
    benchmark::RegisterBenchmark(
        "BM_CreateFittingCurve_Mixed/measured_contours",
        [](benchmark::State& state) { state.SkipWithError("left out: VORN_DATA_DIR is not set"); });
    return;
  }
  for (MeasuredContour const& contour : kMeasuredContours) {
    auto const subject = std::make_shared<Subject>([=] { return Load(*folder, contour); });
    auto const size = static_cast<std::int64_t>(subject->Get().points.size());
    for (NamedStrategy const& strategy : kStrategies) {
      auto const budget = std::make_shared<TimeBudget>(SecondsForLibrary(scale));
      RegisterLibraryFit(NameOf("BM_CreateFittingCurve", strategy, contour.name, size),
                         {size, subject}, strategy.strategy, budget);
      bool const isTooSlow =
          scale == Scale::Quick || (scale != Scale::Full && contour.isSlowWhenPlain);
      if (!HasPlainForm(strategy.strategy) || isTooSlow) continue;
      RegisterPlainFit(NameOf("BM_PlainComposition", strategy, contour.name, size), {size, subject},
                       strategy.strategy, budget);
    }
  }
}

}  // namespace

void RegisterFitting(Scale scale) {
  RegisterMadeProfiles(scale);
  if (scale != Scale::Smoke) RegisterMeasuredContours(scale);
}

}  // namespace Vorn::Benchmarks
