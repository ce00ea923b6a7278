#pragma once

#include "vorn/io/FitContour.h"

/// The usual ways to ask for a fit, for tests.
namespace Vorn::IO::FitChoices {

/// One tolerance for all points.
inline FitChoice Same(double tolerance) {
  FitChoice choice;
  choice.tolerance.same = tolerance;
  return choice;
}

/// Tolerances by spacing up to a cap.
inline FitChoice PerPoint(double cap) {
  FitChoice choice;
  choice.tolerance.cap = cap;
  return choice;
}

}  // namespace Vorn::IO::FitChoices
