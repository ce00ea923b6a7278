#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "benchmarks/Profiles.h"

/// The profiles that fits are timed on.
namespace Vorn::Benchmarks {

/// One profile of one size; made when first asked for, since most of them are large.
class Subject {
 public:
  explicit Subject(std::function<Profile()> make) : make_(std::move(make)) {}

  Profile const& Get() {
    if (!profile_) profile_ = make_();
    return *profile_;
  }

 private:
  std::function<Profile()> make_;
  std::optional<Profile> profile_;
};

struct SubjectOfSize {
  std::int64_t size;
  std::shared_ptr<Subject> subject;
};

struct Maker {
  char const* name;
  Profile (*make)(std::int64_t count, bool isNoisy);
  bool isNoisy;
};

inline constexpr Maker kMakers[] = {
    {"line", MakeLine, false},    {"line_noisy", MakeLine, true}, {"arc", MakeArc, false},
    {"arc_noisy", MakeArc, true}, {"mixed", MakeMixed, false},    {"mixed_noisy", MakeMixed, true},
};

/// The profiles of one maker, by number of points.
inline std::vector<SubjectOfSize> SubjectsOf(Maker const& maker,
                                             std::vector<std::int64_t> const& sizes) {
  std::vector<SubjectOfSize> subjects;
  for (std::int64_t const size : sizes) {
    subjects.push_back(
        {size, std::make_shared<Subject>([=] { return maker.make(size, maker.isNoisy); })});
  }
  return subjects;
}

}  // namespace Vorn::Benchmarks
