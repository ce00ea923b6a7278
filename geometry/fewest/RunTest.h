#pragma once

#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Polytope.h"
#include "geometry/fewest/Simplex.h"

/// Whether one circle or line passes within tolerance of a run of points: a search that finds one
/// quickly, and a proof that there is none.
namespace Vorn::Fewest {

/// How the rows of a programme are met.
struct RunFit {
  /// A normalised circle; the best found.
  Circle circle;
  /// Its largest |row| over all slabs, at least; at most 1 when the rows are met.
  double ratio = 0.0;
  /// Whether there is a circle at all.
  bool isFound = false;
};

/// Looks for the normalised circle of the smallest largest ratio, from a guess on. The form is
/// linearised at the best circle so far, so the search follows one local optimum.
///
/// @param[in]     programme the rows; slabs and half spaces only
/// @param[in]     start     a normalised circle; isFound when it meets the rows with its ratio
/// @param[in]     isTest    true: a ratio of 1 is enough, and what is clearly above is not refined
/// @param[in,out] simplex,basis where to start; afterwards the state of the last programme
RunFit FitRun(Programme const& programme, RunFit const& start, bool isTest, Simplex* simplex,
              Basis* basis);

/// Proves that no circle meets the rows of the points of a programme, or finds one that does.
///
/// The circles that do form a polytope that is symmetric about 0, and a multiple of one of them is
/// normalised exactly when the form reaches 1 on the polytope. Starting with the rows of a basis,
/// the place where the form is largest is tested on all points and the row that it breaks most
/// is added, until a tested circle holds or the form stays below 1 (cutting planes, Kelley 1960).
///
/// @param[in] programme the rows; slabs only
/// @param[in] basis     the rows to begin with
/// @param[in] simplex   inverts them
/// @param[in] workspace room for the polytope, which takes long to create
/// @return a fit that isFound unless there is none. When the polytope grows beyond its room, which
///         no input is known to do, the run counts as covered: isFound with a ratio above 1.
RunFit ProveRun(Programme const& programme, Basis const& basis, Simplex* simplex,
                Polytope* workspace);

}  // namespace Vorn::Fewest
