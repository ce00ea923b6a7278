#pragma once

#include <cstdint>
#include <vector>

namespace Vorn::Benchmarks {

/// How much of everything is measured.
enum class Scale {
  Smoke,     ///< tiny sizes, to see that every benchmark runs
  Quick,     ///< under two minutes
  Standard,  ///< what the published table shows
  Full,      ///< with the plain composition on contours that take it minutes
};

/// Numbers of points or elements.
inline std::vector<std::int64_t> SizesFor(Scale scale) {
  switch (scale) {
    case Scale::Smoke:
      return {40};
    case Scale::Quick:
      return {100, 1000, 10000};
    default:
      return {100, 1000, 10000, 100000};
  }
}

}  // namespace Vorn::Benchmarks
