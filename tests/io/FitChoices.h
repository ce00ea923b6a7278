#pragma once

#include "vorn/io/FitContour.h"

/// Ways to ask for a fit run by run, for tests.
namespace Vorn::IO::FitChoices {

/// By lines and arcs compared run by run, at the tolerances that the points have.
inline FitChoice Mixed() {
  FitChoice choice;
  choice.strategy = Strategy::Mixed;
  return choice;
}

/// One tolerance for all points.
inline FitChoice Same(double tolerance) {
  FitChoice choice = Mixed();
  choice.tolerance.same = tolerance;
  return choice;
}

/// Tolerances by spacing up to a cap.
inline FitChoice PerPoint(double cap) {
  FitChoice choice = Mixed();
  choice.tolerance.cap = cap;
  return choice;
}

}  // namespace Vorn::IO::FitChoices
