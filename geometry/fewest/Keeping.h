#pragma once

#include <cstdint>
#include <vector>

#include "geometry/fewest/Answer.h"
#include "geometry/fewest/Assembly.h"
#include "geometry/fewest/Chain.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/promises/Promises.h"
#include "vorn/FewestPieces.h"
#include "vorn/Types.h"

/// Whether chains keep what is promised, as they are or once they are repaired.
namespace Vorn::Fewest {

/// The search works within this share of the tolerances, so that its rounding and its second order
/// terms stay within the true ones.
inline constexpr double kSearchShare = 1.0 - 1e-6;

/// What is done with a chain that breaks promises: nothing, other pieces within smaller tolerances,
/// or the path itself from point to point, see Mending and Retracing.
enum class Repair { None, Mend, Retrace };

/// A path whose point 0 is that point of the measured ones, which begin anew behind their last.
struct RotatedPath {
  Path const& path;
  std::int32_t rotation = 0;
};

/// Makes contours of chains and measures them. Where a contour breaks a promise the answer holds it
/// nevertheless, and the report what it breaks.
class Keeping {
 public:
  /// The references have to outlive this.
  Keeping(std::vector<WPoint> const& points, FewestPieces::Options const& options,
          Shift const& shift)
      : points_(points), options_(options), shift_(shift) {}

  /// Whether a contour keeps every promise.
  bool IsKept(Answer const& answer, Promises::Report* report) const;
  /// Whether a chain does as it is.
  bool Keeps(RotatedPath const& path, Chain const& chain, Answer* answer,
             Promises::Report* report) const;
  /// Whether it does once it is centred, where that is asked for, or else as it is.
  bool KeepsCentred(RotatedPath const& path, Chain const& chain, Answer* answer,
                    Promises::Report* report) const;
  /// The same once it is repaired.
  bool KeepsRepaired(Repair repair, RotatedPath const& path, Chain const& chain, Answer* answer,
                     Promises::Report* report) const;
  /// Of the points of a range, which may run on past the last one, the position of the one nearest
  /// to a place.
  std::int32_t NearestOf(FewestPieces::Range const& range, GeometryUtils::Point const& at) const;

 private:
  /// Mends a chain until it keeps every promise; false when nothing is left to try.
  bool KeepsMended(RotatedPath const& path, Chain const& chain, Answer* answer,
                   Promises::Report* report) const;
  /// Has a chain follow the path itself near broken promises, and ever more of it, until it keeps
  /// them all; false when nothing is left to follow.
  bool KeepsRetraced(RotatedPath const& path, Chain const& chain, Answer* answer,
                     Promises::Report* report) const;
  /// Whether the pieces of a chain keep every promise.
  bool KeepsBuilt(RotatedPath const& path, Chain const& chain,
                  std::vector<BuiltPiece> const& pieces, Answer* answer,
                  Promises::Report* report) const;
  /// The points of a chain at which promises are broken.
  std::vector<std::int32_t> PlacesOf(Promises::Report const& report, Chain const& chain,
                                     std::int32_t rotation) const;
  bool AreRadiiAllowed(std::vector<GeometryUtils::Elem> const& contour) const;

  std::vector<WPoint> const& points_;
  FewestPieces::Options const& options_;
  Shift const& shift_;
};

}  // namespace Vorn::Fewest
