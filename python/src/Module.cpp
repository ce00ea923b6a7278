#include <pybind11/pybind11.h>

#include "Bindings.h"
#include "Errors.h"
#include "PieceRow.h"

PYBIND11_MODULE(_core, module) {
  using namespace Vorn::Python;
  module.doc() = "The compiled part of vorn. Use the package, not this module.";
  RegisterErrors();
  RegisterPieceRow();
  BindFit(module);
  BindPoints(module);
  BindContours(module);
  BindFormats(module);
  BindDrawings(module);
}
