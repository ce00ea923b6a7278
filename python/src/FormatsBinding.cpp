#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <cmath>
#include <iostream>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "Bindings.h"
#include "Keywords.h"
#include "PieceRow.h"
#include "Points.h"
#include "vorn/io/FileMeasure.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"

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

IO::DxfVersion DxfVersionFrom(py::handle given) {
  return Chosen<IO::DxfVersion>({{"r12", IO::DxfVersion::R12}, {"r2000", IO::DxfVersion::R2000}},
                                "dxf_version", given);
}

Takers<WriteOptions> const& WriteTakers() {
  static Takers<WriteOptions> const takers = {
      {"entities", [](py::handle g, WriteOptions* o) { o->dxfEntities = g.cast<bool>(); }},
      {"dxf_version", [](py::handle g, WriteOptions* o) { o->dxfVersion = DxfVersionFrom(g); }},
      {"plain", [](py::handle g, WriteOptions* o) { o->svgPlain = g.cast<bool>(); }},
      {"chords", [](py::handle g, WriteOptions* o) { o->chords = AboveZero(g, "chords"); }},
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

/// What the caller tells beside the contour. With points the text is one for them: see ToTextFor.
struct TextChoice {
  IO::Format format = IO::Format::Json;
  WriteOptions options;
  std::vector<WPoint> points;
};

TextChoice TextChoiceFrom(std::string const& format, py::dict const& options,
                          py::object const& points, py::object const& tolerance) {
  TextChoice choice = {FormatFrom(format), Taken(WriteTakers(), options), {}};
  if (points.is_none()) return choice;
  PointsInput input = PointsFrom(points, tolerance);
  RequireUsable(input);
  if (!input.hasTolerances) throw py::value_error("the points have no tolerances: say tol=");
  choice.points = std::move(input.points);
  return choice;
}

std::string ToText(PieceRows const& rows, bool isClosed, std::string const& units,
                   TextChoice const& choice) {
  IO::ContourFile const contour = ContourFrom(rows, isClosed, units);
  py::gil_scoped_release const unlocked;
  if (choice.points.empty()) return IO::ToText(contour, choice.format, choice.options);
  return IO::ToTextFor(choice.points, contour, choice.format, choice.options);
}

/// What the caller ought to know of what was read, in words.
std::vector<std::string> NotesOn(IO::ContourFile const& contour) {
  std::vector<std::string> notes;
  if (contour.leftOut > 0) {
    notes.push_back("left out " + IO::Counted(contour.leftOut, "piece") + " without length");
  }
  if (contour.hadHeights) notes.emplace_back("dropped the coordinates beside x and y");
  return notes;
}

py::tuple Parts(IO::ContourFile const& contour) {
  return py::make_tuple(RowsOf(contour.pieces), contour.isClosed, contour.units, NotesOn(contour));
}

IO::ReadOptions ReadOptionsFrom(std::optional<std::string> const& format,
                                py::object const& flatten) {
  IO::ReadOptions options;
  if (format) options.format = FormatFrom(*format);
  if (!flatten.is_none()) options.flattening = AboveZero(flatten, "flatten");
  return options;
}

IO::ContourFile Parse(std::string const& text, IO::ReadOptions const& options) {
  py::gil_scoped_release const unlocked;
  return IO::ParseContour(text, "text", options);
}

IO::ContourFile Read(std::string const& path, IO::ReadOptions const& options) {
  py::gil_scoped_release const unlocked;
  return IO::ReadContour(path, std::cin, options);
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
  module.def(
      "to_text",
      [](PieceRows const& rows, bool isClosed, std::string const& units, std::string const& format,
         py::dict const& options, py::object const& points, py::object const& tolerance) {
        return ToText(rows, isClosed, units, TextChoiceFrom(format, options, points, tolerance));
      },
      "The contour as the text of a file.");
  module.def(
      "from_text",
      [](std::string const& text, std::string const& format, py::object const& flatten) {
        return Parts(Parse(text, ReadOptionsFrom(format, flatten)));
      },
      "Rows, whether closed, units and notes of a text.");
  module.def(
      "from_file",
      [](std::string const& path, std::optional<std::string> const& format,
         py::object const& flatten) { return Parts(Read(path, ReadOptionsFrom(format, flatten))); },
      "The same of a file.");
  module.def("format_of", &FormatOf, "The format that the ending of a name tells.");
  module.def("write_file", &WriteFile, "Writes a file whole or not at all.");
}

}  // namespace Vorn::Python
