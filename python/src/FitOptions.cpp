#include "FitOptions.h"

#include <cstddef>

#include "Keywords.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using IO::FitChoice;

IO::Strategy StrategyFrom(py::handle given) {
  using IO::Strategy;
  return Chosen<Strategy>({{"mixed", Strategy::Mixed},
                           {"cells", Strategy::Cells},
                           {"arc", Strategy::Arc},
                           {"fewest", Strategy::Fewest}},
                          "strategy", given);
}

IO::ClosedChoice ClosedFrom(py::handle given) {
  if (py::isinstance<py::bool_>(given)) {
    return given.cast<bool>() ? IO::ClosedChoice::Yes : IO::ClosedChoice::No;
  }
  return Chosen<IO::ClosedChoice>({{"auto", IO::ClosedChoice::Auto},
                                   {"yes", IO::ClosedChoice::Yes},
                                   {"no", IO::ClosedChoice::No}},
                                  "closed", given);
}

Takers<FitChoice> const& FitTakers() {
  static Takers<FitChoice> const takers = {
      {"strategy", [](py::handle g, FitChoice* c) { c->strategy = StrategyFrom(g); }},
      {"closed", [](py::handle g, FitChoice* c) { c->closed = ClosedFrom(g); }},
      {"start", [](py::handle g, FitChoice* c) { c->start = g.cast<std::size_t>(); }},
  };
  return takers;
}

}  // namespace

FitChoice FitChoiceFrom(py::dict const& keywords) { return Taken(FitTakers(), keywords); }

}  // namespace Vorn::Python
