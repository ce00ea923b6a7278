#include "FitOptions.h"

#include <cstddef>

#include "Keywords.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using IO::FitChoice;

IO::Strategy StrategyFrom(py::handle given) {
  return Chosen<IO::Strategy>({{"fewest", IO::Strategy::Fewest},
                               {"mixed", IO::Strategy::Mixed},
                               {"cells", IO::Strategy::Cells},
                               {"arc", IO::Strategy::Arc}},
                              "strategy", given);
}

FewestPieces::Effort EffortFrom(py::handle given) {
  return Chosen<FewestPieces::Effort>({{"quick", FewestPieces::Effort::Quick},
                                       {"wide", FewestPieces::Effort::Wide},
                                       {"full", FewestPieces::Effort::Full}},
                                      "effort", given);
}

/// Takes a number or a truth value into a member of the options of the fewest pieces.
template <typename Value>
auto Into(Value FewestPieces::Options::*member) {
  return [member](py::handle given, FitChoice* choice) {
    choice->fewest.*member = given.cast<Value>();
  };
}

Takers<FitChoice> const& FitTakers() {
  using Options = FewestPieces::Options;
  static Takers<FitChoice> const takers = {
      {"strategy", [](py::handle g, FitChoice* c) { c->strategy = StrategyFrom(g); }},
      {"closed", [](py::handle g, FitChoice* c) { c->closed = ClosedFrom(g); }},
      {"start", [](py::handle g, FitChoice* c) { c->start = g.cast<std::size_t>(); }},
      {"tolerance_per_point",
       [](py::handle g, FitChoice* c) { c->tolerance.cap = AboveZero(g, "tolerance_per_point"); }},
      {"effort", [](py::handle g, FitChoice* c) { c->fewest.effort = EffortFrom(g); }},
      {"centre", Into(&Options::centre)},
      {"segments_only", Into(&Options::segmentsOnly)},
      {"largest_step", Into(&Options::largestStep)},
      {"smallest_radius", Into(&Options::smallestRadius)},
      {"largest_radius", Into(&Options::largestRadius)},
      {"farthest_between_points", Into(&Options::farthestBetweenPoints)},
  };
  return takers;
}

}  // namespace

IO::ClosedChoice ClosedFrom(py::handle given) {
  bool const isOfNumPy = py::isinstance(given, py::module_::import("numpy").attr("bool_"));
  if (py::isinstance<py::bool_>(given) || isOfNumPy) {
    return py::bool_(py::reinterpret_borrow<py::object>(given)) ? IO::ClosedChoice::Yes
                                                                : IO::ClosedChoice::No;
  }
  return Chosen<IO::ClosedChoice>({{"auto", IO::ClosedChoice::Auto},
                                   {"yes", IO::ClosedChoice::Yes},
                                   {"no", IO::ClosedChoice::No}},
                                  "closed", given);
}

FitChoice FitChoiceFrom(py::dict const& keywords) { return Taken(FitTakers(), keywords); }

}  // namespace Vorn::Python
