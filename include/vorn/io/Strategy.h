#pragma once

#include <string>

#include "vorn/io/Export.h"

namespace Vorn::IO {

/// How measured points become lines and arcs.
enum class Strategy {
  Mixed,   ///< GeometryUtils::FittingStrategy::Mixed
  Cells,   ///< GeometryUtils::FittingStrategy::MixedCells
  Arc,     ///< GeometryUtils::FittingStrategy::SingleArc
  Fewest,  ///< FewestPieces: as few pieces as the tolerances allow
};

/// What is used when nobody names a strategy.
inline constexpr Strategy kUsualStrategy = Strategy::Fewest;

/// As written on the command line: mixed, cells, arc, fewest.
VORN_IO_EXPORT std::string NameOf(Strategy strategy);

/// The single arc reports its largest deviation as a length, the other strategies as a multiple
/// of the point's tolerance.
VORN_IO_EXPORT bool IsDeviationRelative(Strategy strategy);

/// Whether neighbouring points must be further apart than 1.5 times the sum of their tolerances.
VORN_IO_EXPORT bool NeedsSpacing(Strategy strategy);

}  // namespace Vorn::IO
