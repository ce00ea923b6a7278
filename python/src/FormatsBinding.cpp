#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <iostream>
#include <optional>
#include <string>

#include "Bindings.h"
#include "Keywords.h"
#include "PieceRow.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using IO::GCodeOptions;
using IO::WriteOptions;

GCodeOptions::End EndFrom(py::handle given) {
  return Chosen<GCodeOptions::End>({{"M2", GCodeOptions::End::M2},
                                    {"M30", GCodeOptions::End::M30},
                                    {"none", GCodeOptions::End::None}},
                                   "end", given);
}

GCodeOptions::Plane PlaneFrom(py::handle given) {
  return Chosen<GCodeOptions::Plane>(
      {{"xy", GCodeOptions::Plane::G17}, {"xz", GCodeOptions::Plane::G18}}, "plane", given);
}

/// Takes a value into a member of the options of a tool path.
template <typename Value>
auto Into(Value GCodeOptions::*member) {
  return [member](py::handle given, WriteOptions* o) { o->gcode.*member = given.cast<Value>(); };
}

Takers<WriteOptions> const& WriteTakers() {
  static Takers<WriteOptions> const takers = {
      {"entities", [](py::handle g, WriteOptions* o) { o->dxfEntities = g.cast<bool>(); }},
      {"feed", Into(&GCodeOptions::feed)},
      {"decimals", Into(&GCodeOptions::decimals)},
      {"tolerance", Into(&GCodeOptions::tolerance)},
      {"end", [](py::handle g, WriteOptions* o) { o->gcode.end = EndFrom(g); }},
      {"plane", [](py::handle g, WriteOptions* o) { o->gcode.plane = PlaneFrom(g); }},
      {"radius_words", Into(&GCodeOptions::useRadiusWords)},
      {"safe_height", Into(&GCodeOptions::safeHeight)},
      {"cut_height", Into(&GCodeOptions::cutHeight)},
      {"plunge_feed", Into(&GCodeOptions::plungeFeed)},
      {"header", Into(&GCodeOptions::header)},
      {"footer", Into(&GCodeOptions::footer)},
  };
  return takers;
}

IO::Format FormatFrom(std::string const& name) {
  std::optional<IO::Format> const format = IO::FormatNamed(name);
  if (!format) throw py::value_error("'" + name + "' names no format");
  return *format;
}

std::string ToText(PieceRows const& rows, bool isClosed, std::string const& units,
                   std::string const& format, py::dict const& options) {
  return IO::ToText(ContourFrom(rows, isClosed, units), FormatFrom(format),
                    Taken(WriteTakers(), options));
}

py::tuple Parts(IO::ContourFile const& contour) {
  return py::make_tuple(RowsOf(contour.pieces), contour.isClosed, contour.units);
}

py::tuple FromText(std::string const& text, std::string const& format) {
  return Parts(IO::ParseContour(text, "text", FormatFrom(format)));
}

py::tuple FromFile(std::string const& path, std::optional<std::string> const& format) {
  std::optional<IO::Format> named;
  if (format) named = FormatFrom(*format);
  return Parts(IO::ReadContour(path, std::cin, named));
}

std::optional<std::string> FormatOf(std::string const& path) {
  std::optional<IO::Format> const format = IO::FormatOf(path);
  if (!format) return {};
  return IO::NameOf(*format);
}

void WriteFile(std::string const& path, py::bytes const& contents) {
  IO::AtomicFile(path, std::string(contents)).Commit();
}

}  // namespace

void BindFormats(py::module_& module) {
  module.def("to_text", &ToText, "The contour as the text of a file.");
  module.def("from_text", &FromText, "Rows, whether closed, and units of a text.");
  module.def("from_file", &FromFile, "The same of a file.");
  module.def("format_of", &FormatOf, "The format that the ending of a name tells.");
  module.def("write_file", &WriteFile, "Writes a file whole or not at all.");
}

}  // namespace Vorn::Python
