// Members for the line cells of two measured points.

#include "geometry/cells/LineCells.h"

#include <optional>
#include <vector>

#include "geometry/interface/LineCellArguments.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::GetPermissibleRect(WPoint a, WPoint b, double* rect) {
  std::optional<Cells::TangentPoints> const found = Cells::FindTangentPoints(a, b);
  if (!found) return false;
  Cells::WriteRect(*found, rect);
  return true;
}

bool GeometryUtils::IsValidBunch(double const* den, double const* num, int n) {
  return Cells::HaveOneSign(den, num, n);
}

ErrorCode GeometryUtils::GetLineTriangles(WPoint a, WPoint b, bool* formFixed, bool* xOfY,
                                          std::vector<Triangle>* cell) {
  Cells::LineForm form = Cells::ReadForm(formFixed, xOfY);
  Cells::LineCell found;
  ErrorCode const code = Cells::FindLineCell(a, b, &form, &found);
  Cells::WriteForm(form, formFixed, xOfY);
  if (code == ErrorCode::Ok) cell->assign(found.begin(), found.end());
  return code;
}

}  // namespace Vorn
