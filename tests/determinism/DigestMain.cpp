// Prints the digests of all sections, and of the fits of the shared contours where VORN_DATA_DIR
// names their folder: one line each, in the order of the records.

#include <cinttypes>
#include <cstdio>

#include "determinism/Sections.h"
#include "support/SharedData.h"

int main() {
  using namespace Vorn::Testing;
  using Strategy = Vorn::GeometryUtils::FittingStrategy;
  std::printf("libm 0x%016" PRIx64 "\n", DigestLibm());
  for (Section const& section : AllSections()) {
    std::printf("%s 0x%016" PRIx64 "\n", section.name, section.compute());
  }
  if (!SharedDataFolder()) return 0;
  for (ContourSection const& contour : ContourSections()) {
    std::printf("%s", contour.file);
    for (Strategy const strategy : {Strategy::Mixed, Strategy::MixedCells, Strategy::SingleArc}) {
      std::printf(" 0x%016" PRIx64, DigestContourFit(contour, strategy));
    }
    std::printf("\n");
  }
  return 0;
}
