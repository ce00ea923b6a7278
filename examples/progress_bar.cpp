// Shows the progress of a fit as a bar on the terminal (standard error).

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "vorn/GeometryUtils.h"

using Vorn::GeometryUtils;

namespace {

// The library calls SetProgress on this thread, inside the fit. It reports for every point tried,
// by the line and by the arc fitter in turn, so the figures go back now and then; a bar shows the
// greatest one so far.
class ProgressBar : public Vorn::ExecutionState {
 public:
  void SetProgress(std::int32_t percent) override {
    ++reports_;
    if (percent <= greatest_) return;
    greatest_ = percent;
    std::size_t const filled = static_cast<std::size_t>(std::clamp(greatest_, 0, 100)) / 5;
    std::string const bar = std::string(filled, '#') + std::string(20 - filled, '.');
    std::fprintf(stderr, "\r[%s] %3d %%", bar.c_str(), static_cast<int>(greatest_));
    if (greatest_ >= 100) std::fputc('\n', stderr);
  }

  [[nodiscard]] std::int32_t Greatest() const { return greatest_; }
  [[nodiscard]] int Reports() const { return reports_; }

 private:
  std::int32_t greatest_ = 0;
  int reports_ = 0;
};

}  // namespace

int main() {
  std::vector<Vorn::WPoint> wave;
  for (int i = 0; i <= 300; ++i) wave.push_back({0.2 * i, 3.0 * std::sin(0.1 * i), 0.02});

  ProgressBar bar;
  std::vector<GeometryUtils::Elem> contour;
  double deviation = 0.0;
  std::int32_t index = -1;
  Vorn::ErrorCode const code = GeometryUtils::CreateFittingCurve(
      wave, GeometryUtils::FittingStrategy::Mixed, &contour, &deviation, &index, &bar, 100);
  if (code != Vorn::ErrorCode::Ok) return 1;

  std::printf("progress: %d %%, %s\n", static_cast<int>(bar.Greatest()),
              bar.Reports() >= static_cast<int>(wave.size()) ? "at least one report per point"
                                                             : "fewer reports than points");
  std::printf("%zu points became %zu pieces\n", wave.size(), contour.size() - 1);
  return 0;
}
