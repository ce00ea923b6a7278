// The contour of the fewest pieces: the profiles that the strategies are timed on, noisy scans of
// up to a million points, sparse and far denser than their tolerance, and the measured contours.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "benchmarks/AllocationMeter.h"
#include "benchmarks/Measure.h"
#include "benchmarks/MeasuredContours.h"
#include "benchmarks/Profiles.h"
#include "benchmarks/Registration.h"
#include "benchmarks/Subjects.h"
#include "support/fewest/Scans.h"
#include "vorn/FewestPieces.h"

namespace Vorn::Benchmarks {
namespace {

using Effort = FewestPieces::Effort;

struct Answer {
  ErrorCode code = ErrorCode::Failed;
  FewestPieces::Result result;
  std::int64_t peakBytes = 0;
};

/// What varies from one benchmark of a profile to another.
struct Manner {
  Effort effort = Effort::Quick;
  bool isClosed = false;
};

Answer Fit(std::vector<WPoint> const& points, Manner const& manner) {
  FewestPieces::Options options;
  options.effort = manner.effort;
  options.closed = manner.isClosed;
  Answer answer;
  AllocationMeter const meter;
  answer.code = FewestPieces::Fit(points, options, &answer.result, nullptr, 100);
  answer.peakBytes = meter.PeakBytes();
  return answer;
}

void Report(Profile const& profile, Answer const& answer, benchmark::State* state) {
  auto const count = static_cast<double>(profile.points.size());
  CountTimePer(state, "seconds_per_point", static_cast<std::int64_t>(profile.points.size()));
  double arcs = 0.0;
  for (auto const& elem : answer.result.contour) {
    if (elem.type == GeometryUtils::ElemType::Arc) arcs += 1.0;
  }
  state->counters["pieces"] = static_cast<double>(answer.result.ranges.size());
  state->counters["arcs"] = arcs;
  state->counters["bound"] = answer.result.fewestPossible;
  state->counters["largest_relative_deviation"] = answer.result.largestDeviation;
  state->counters["peak_bytes_per_point"] = static_cast<double>(answer.peakBytes) / count;
  state->counters["code"] = static_cast<double>(answer.code);
}

std::string NameOf(Manner const& manner) {
  std::string const name = manner.effort == Effort::Quick ? "Quick" : "Wide";
  return manner.isClosed ? name + "_closed" : name;
}

void RegisterFit(std::string const& profileName, SubjectOfSize const& subject, Manner manner,
                 std::shared_ptr<TimeBudget> const& budget) {
  auto const answer = std::make_shared<std::optional<Answer>>();
  auto const body = [=](benchmark::State& state) {
    if (!IsWithin(*budget, subject.size, &state)) return;
    Profile const& profile = subject.subject->Get();
    TimeWithin(budget.get(), subject.size, &state, [&] {
      Answer next = Fit(profile.points, manner);
      if (!*answer) *answer = std::move(next);
    });
    if ((*answer)->code == ErrorCode::Ok && (*answer)->result.largestDeviation > 1.0) {
      state.SkipWithError("the contour does not keep the tolerance");
    }
    Report(profile, **answer, &state);
    bool const isKnown = profile.truePieces > 0 && !manner.isClosed;
    if (isKnown) state.counters["true_pieces"] = profile.truePieces;
  };
  std::string const name = std::string("BM_FewestPieces_") + NameOf(manner) + '/' + profileName +
                           '/' + std::to_string(subject.size);
  benchmark::RegisterBenchmark(name.c_str(), body)->Unit(benchmark::kMillisecond);
}

/// Scans of which the true number of pieces is known.
struct ScanMaker {
  char const* name;
  std::int64_t smallest;
  std::int64_t largest;
  Effort effort;
  Profile (*make)(std::int64_t count);
};

constexpr std::uint64_t kSeed = 1;

std::int32_t RepeatsFor(std::int64_t count) {
  constexpr std::int64_t kPointsPerProfile = 1000;
  return static_cast<std::int32_t>(std::max<std::int64_t>(1, count / kPointsPerProfile));
}

Profile MakeScan(Testing::Scan scan, int truePieces) { return {std::move(scan), truePieces}; }

Profile MakeNoisy(std::int64_t count, double noise) {
  std::int32_t const repeats = RepeatsFor(count);
  return MakeScan(Testing::MakeNoisyProfile(kSeed, Testing::ProfileStyle::Mixed, repeats,
                                            static_cast<std::int32_t>(count), noise),
                  16 * repeats);
}

Profile MakeProfileAtHalf(std::int64_t count) { return MakeNoisy(count, 0.45); }
Profile MakeProfileAtAll(std::int64_t count) { return MakeNoisy(count, 0.99); }

Profile MakeLongArc(std::int64_t count) {
  return MakeScan(Testing::MakeNoisyArc(kSeed, static_cast<std::int32_t>(count), 0.45), 1);
}

/// 100 long whatever the number of points is: 1 um apart for 100,000.
Profile MakeBracket(std::int64_t count) {
  return MakeScan(Testing::MakeDenseBracket(kSeed, 100.0 / static_cast<double>(count), 1.0), 4);
}

Profile MakeDenseSixteen(std::int64_t count) {
  return MakeScan(Testing::MakeDenseProfile(kSeed, Testing::ProfileStyle::Mixed, 200.0,
                                            200.0 / static_cast<double>(count)),
                  16);
}

constexpr ScanMaker kScanMakers[] = {
    {"profile_noise_0.45", 1000, 1000000, Effort::Quick, MakeProfileAtHalf},
    {"profile_noise_0.99", 1000, 100000, Effort::Wide, MakeProfileAtAll},
    {"arc_270_degrees", 1000, 1000000, Effort::Quick, MakeLongArc},
    {"dense_four_pieces", 100000, 1000000, Effort::Quick, MakeBracket},
    {"dense_sixteen_pieces", 100000, 1000000, Effort::Quick, MakeDenseSixteen},
};

double SecondsFor(Scale scale) { return scale == Scale::Quick ? 2.0 : 60.0; }

void RegisterScans(Scale scale) {
  for (ScanMaker const& maker : kScanMakers) {
    auto const budget = std::make_shared<TimeBudget>(SecondsFor(scale));
    std::int64_t const smallest = scale == Scale::Smoke ? 1000 : maker.smallest;
    std::int64_t const largest = scale == Scale::Smoke ? smallest : maker.largest;
    for (std::int64_t size = smallest; size <= largest; size *= 10) {
      auto const subject = std::make_shared<Subject>([=] { return maker.make(size); });
      RegisterFit(maker.name, {size, subject}, {maker.effort}, budget);
    }
  }
}

void RegisterProfilesOfStrategies(Scale scale) {
  for (Maker const& maker : kMakers) {
    auto const budget = std::make_shared<TimeBudget>(SecondsFor(scale));
    for (SubjectOfSize const& subject : SubjectsOf(maker, SizesFor(scale))) {
      RegisterFit(maker.name, subject, {}, budget);
    }
  }
}

/// Without the folder the benchmarks of the strategies say that they are left out.
void RegisterMeasured(Scale scale) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) return;
  for (MeasuredContour const& contour : kMeasuredContours) {
    auto const subject = std::make_shared<Subject>([=] { return Load(*folder, contour); });
    auto const size = static_cast<std::int64_t>(subject->Get().points.size());
    auto const budget = std::make_shared<TimeBudget>(SecondsFor(scale));
    RegisterFit(contour.name, {size, subject}, {}, budget);
    if (contour.isClosed) RegisterFit(contour.name, {size, subject}, {Effort::Quick, true}, budget);
  }
}

}  // namespace

void RegisterFewest(Scale scale) {
  RegisterScans(scale);
  RegisterProfilesOfStrategies(scale);
  if (scale != Scale::Smoke) RegisterMeasured(scale);
}

}  // namespace Vorn::Benchmarks
