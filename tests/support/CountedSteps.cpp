#include "support/CountedSteps.h"

#include <span>

#include "geometry/cells/fast/CellSequence.h"
#include "geometry/cells/fast/Cutter.h"
#include "geometry/fewest/Columns.h"

namespace Vorn::Testing {

namespace {

Steps steps;

}  // namespace

void ResetSteps() { steps = {}; }

Steps CountedSteps() { return steps; }

}  // namespace Vorn::Testing

// The linker option --wrap=NAME sends the library's calls of NAME to __wrap_NAME and calls the step
// itself __real_NAME; names are those that compilers give. A member takes its object first.
namespace {

using Vorn::Cells::BoxedTriangle;
using Vorn::Cells::CellSequence;
using Vorn::Cells::Cutter;
using Vorn::Fewest::Circle;
using Vorn::Fewest::Columns;
using Vorn::Testing::steps;
using Triangles = std::span<Vorn::GeometryUtils::Triangle const>;

#define NARROW_BY                                      \
  "_ZN4Vorn5Cells12CellSequence8NarrowByESt4spanIKNS_" \
  "13GeometryUtils8TriangleELm18446744073709551615EE"
#define CUT "_ZNK4Vorn5Cells6Cutter3CutERKNS0_13BoxedTriangleEPNS_9Triangles7OverlapE"
#define FIND_WORST "_ZNK4Vorn6Fewest7Columns9FindWorstEiiRKNS0_6CircleE"

}  // namespace

void RealNarrowBy(CellSequence* cell, Triangles other) asm("__real_" NARROW_BY);
void CountedNarrowBy(CellSequence* cell, Triangles other) asm("__wrap_" NARROW_BY);
void CountedNarrowBy(CellSequence* cell, Triangles other) {
  ++steps.narrowings;
  RealNarrowBy(cell, other);
}

Cutter::Rest RealCut(Cutter const* cutter, BoxedTriangle const& other,
                     Vorn::Triangles::Overlap* overlap) asm("__real_" CUT);
Cutter::Rest CountedCut(Cutter const* cutter, BoxedTriangle const& other,
                        Vorn::Triangles::Overlap* overlap) asm("__wrap_" CUT);
Cutter::Rest CountedCut(Cutter const* cutter, BoxedTriangle const& other,
                        Vorn::Triangles::Overlap* overlap) {
  ++steps.overlaps;
  return RealCut(cutter, other, overlap);
}

Columns::Worst RealFindWorst(Columns const* columns, std::int32_t first, std::int32_t last,
                             Circle const& circle) asm("__real_" FIND_WORST);
Columns::Worst CountedFindWorst(Columns const* columns, std::int32_t first, std::int32_t last,
                                Circle const& circle) asm("__wrap_" FIND_WORST);
Columns::Worst CountedFindWorst(Columns const* columns, std::int32_t first, std::int32_t last,
                                Circle const& circle) {
  steps.measurements += last - first;
  return RealFindWorst(columns, first, last, circle);
}
