#pragma once

#include <optional>
#include <string>

#include "vorn/io/Export.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

/// The ways to state tolerances; at most one is set.
struct ToleranceChoice {
  std::optional<double> same;         ///< that of every point
  std::optional<std::string> column;  ///< the name of the column that holds them
  std::optional<double> cap;          ///< the largest of those that follow from the spacing
};

/// Which column of the file the reader has to look for.
VORN_IO_EXPORT ToleranceColumn ColumnFor(ToleranceChoice const& choice);

/// The tolerance that follows from the distance to the nearer neighbour: 0.3 of it, at most `cap`.
VORN_IO_EXPORT double ToleranceForSpacing(double cap, double spacing);

/// Whether AssignTolerances finds a tolerance, in the options or in the file.
VORN_IO_EXPORT bool IsToleranceStated(ToleranceChoice const& choice, PointFile const& file);

/// What becomes of neighbours in one place when tolerances follow the spacing.
enum class Coinciding {
  Refused,    ///< no tolerance above zero can follow
  GivenZero,  ///< for commands that only look
};

/// Gives every point of the file its tolerance and says in words where it came from.
///
/// The choice goes before what the file holds; without one a column `w` goes before a comment
/// `# tolerance T`.
///
/// @param isClosed the first and the last point are neighbours as well
/// @throws Failure (FailureKind::BadArgument) when nobody gives a tolerance; SpacingFailure when a
///         tolerance by spacing would be zero because neighbours coincide and this is refused.
VORN_IO_EXPORT std::string AssignTolerances(ToleranceChoice const& choice, PointFile* file,
                                            bool isClosed = false,
                                            Coinciding coinciding = Coinciding::Refused);

}  // namespace Vorn::IO
