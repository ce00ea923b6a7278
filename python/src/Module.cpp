#include <pybind11/pybind11.h>

#include "Bindings.h"
#include "Errors.h"
#include "PieceRow.h"
#include "geometry/Values.h"

namespace {

void BindGeometry(pybind11::module_ module) {
  using namespace Vorn::Python;
  module.doc() = "The operations of the core, one by one.";
  BindElements(module);
  BindElementary(module);
  BindChains(module);
  BindPolylines(module);
  BindCells(module);
  BindCurves(module);
  BindNumeric(module);
  BindMatrix(module);
  BindBatches(module);
}

}  // namespace

PYBIND11_MODULE(_core, module) {
  using namespace Vorn::Python;
  module.doc() = "The compiled part of vorn. Use the package, not this module.";
  module.attr("__version__") = VORN_VERSION;
  RegisterErrors();
  RegisterPieceRow();
  BindFit(module);
  BindPoints(module);
  BindContours(module);
  BindFormats(module);
  BindDrawings(module);
  BindThinning(module);
  BindOutlines(module);
  BindReports(module);
  BindGeometry(module.def_submodule("geometry"));
}
