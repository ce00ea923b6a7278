#include "cli/commands/FitFiles.h"

#include "cli/texts/Relative.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/JoinedFit.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

ContourFile ContourOf(FitReport const& report) {
  return {report.file.path, report.pieces, report.closure.isClosed, report.file.units};
}

std::string TextOf(FitReport const& report, Format format, WriteOptions const& options) {
  if (HoldsContour(format, options) && format != Format::Json) {
    return ToTextFor(report.file.points, ContourOf(report), format, options);
  }
  switch (format) {
    case Format::Json:
      return ToJson(report);
    case Format::Svg:
      return ToSvg(DrawingOf(report));
    case Format::Html:
      return ToHtml(DrawingOf(report));
    default:
      return ToPng(DrawingOf(report), {});
  }
}

std::string NameOf(FittedFile const& file) {
  return file.path == "-" ? "the standard output" : Printable(file.path);
}

/// Why a contour within tolerance is not so in its file.
std::string FileComplaint(FitReport const& report, FittedFile const& file) {
  std::string const name = NameOf(file) + ": ";
  if (!file.measure->unreadable.empty()) {
    return name + "cannot be read back and measured: " + file.measure->unreadable;
  }
  std::string const remedy =
      file.format == Format::GCode ? "; more digits (--gcode-decimals) would keep it" : "";
  return name + "rounded, the contour leaves the tolerance of " +
         report.file.NameOf(file.measure->point) + " (relative deviation " +
         FormatShort(file.measure->relative) + ")" + remedy;
}

}  // namespace

FittedFile RenderFit(FitReport const& report, std::string const& path, Format format,
                     WriteOptions const& options) {
  FittedFile file = {path, format, TextOf(report, format, options), {}};
  if (HoldsContour(format, options))
    file.measure = MeasureText(file.text, format, report.file.points);
  return file;
}

FittedFile RenderFit(std::vector<FitReport> const& outlines, std::string const& path, Format format,
                     WriteOptions const& options) {
  FittedFile file = RenderFit(Joined(outlines), path, format, options);
  if (format == Format::Json) file.text = ToJson(outlines);
  if (file.measure) file.measure = MeasureText(file.text, format, outlines);
  return file;
}

FittedFile const* WorstOf(std::vector<FittedFile> const& files) {
  FittedFile const* worst = nullptr;
  for (FittedFile const& file : files) {
    if (!file.measure) continue;
    if (!file.measure->unreadable.empty()) return &file;
    // Written so that a deviation that is not a number counts as the largest.
    if (worst == nullptr || !(file.measure->relative <= worst->measure->relative)) worst = &file;
  }
  return worst;
}

Verdict VerdictOf(FitReport const& report, std::vector<FittedFile> const& files) {
  FittedFile const* const worst = WorstOf(files);
  bool const isGood = worst == nullptr || worst->measure->IsWithin();
  if (report.verdict != Verdict::WithinTolerance || isGood) return report.verdict;
  return Verdict::OutsideTolerance;
}

std::string Complaint(FitReport const& report, std::vector<FittedFile> const& files) {
  PointFile const& file = report.file;
  if (report.verdict == Verdict::StopsEarly) {
    GeometryUtils::Point const& end = report.pieces.back().end;
    return file.path + ": no fit beyond (" + FormatShort(end.x) + ", " + FormatShort(end.y) +
           "): the contour stops before the last point, " + file.NameOf(file.points.size() - 1);
  }
  if (report.verdict == Verdict::NotClosed) {
    return file.path + ": the ends of the closed contour are " + FormatShort(report.Gap()) +
           " apart at " + file.NameOf(report.seam) +
           ", and nothing within the tolerance joins them";
  }
  if (report.verdict == Verdict::WithinTolerance) return FileComplaint(report, *WorstOf(files));
  return file.path + ": the contour leaves the tolerance of " +
         file.NameOf(report.LargestDeviation().point) + " (relative deviation " +
         FormatShort(report.LargestDeviation().relative) + ")";
}

std::string ReadBackText(FitReport const& report, FittedFile const& file) {
  if (!file.measure->unreadable.empty()) return "not possible for " + NameOf(file);
  return RelativeText(file.measure->relative) + " of the tolerance at " +
         report.file.NameOf(file.measure->point) + " in " + NameOf(file);
}

}  // namespace Vorn::Cli
