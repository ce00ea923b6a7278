#include "cli/commands/FitMany.h"

#include <tbb/global_control.h>
#include <tbb/info.h>
#include <tbb/parallel_pipeline.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <filesystem>
#include <map>
#include <memory>
#include <ostream>
#include <utility>

#include "cli/base/Advice.h"
#include "cli/base/Handover.h"
#include "cli/commands/Outputs.h"
#include "cli/commands/PointsInput.h"
#include "cli/texts/Relative.h"
#include "vorn/io/FitSummary.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

namespace fs = std::filesystem;

constexpr int kTimeDecimals = 3;

/// How one file ended.
struct Outcome {
  std::string path;
  ExitCode code = ExitCode::Ok;
  std::string verdict;
  std::string dropped;  ///< what was not taken from the file, for standard error; may be empty
  std::string message;  ///< for standard error; empty when all is well
  bool isFitted = false;
  std::size_t points = 0;
  std::size_t pieces = 0;
  std::optional<std::size_t> bound;  ///< below which no contour can go
  double deviation = 0.0;            ///< relative
  double seconds = 0.0;
  std::vector<FittedFile> files;  ///< to write
  SummaryRow row;                 ///< only for a summary
};

/// Grows from what a file says about itself to what is wrong around it.
int Severity(ExitCode code) {
  constexpr std::array kMildestFirst = {ExitCode::Ok,      ExitCode::OutsideTolerance,
                                        ExitCode::NoFit,   ExitCode::PointsTooClose,
                                        ExitCode::Usage,   ExitCode::File,
                                        ExitCode::Internal};
  return static_cast<int>(std::find(kMildestFirst.begin(), kMildestFirst.end(), code) -
                          kMildestFirst.begin());
}

/// The first line of the message, without the name of the file that the line begins with anyway.
std::string ShortMessage(std::string const& path, std::string const& message) {
  std::string text = message.substr(0, message.find('\n'));
  for (std::string const& prefix : {path + ": ", path + ":"}) {
    if (text.starts_with(prefix)) return text.substr(prefix.size());
  }
  return text;
}

/// "29", "29 (26 at least)", "7 (fewest)".
std::string PiecesText(Outcome const& outcome) {
  std::string pieces = std::to_string(outcome.pieces);
  if (!outcome.bound) return pieces;
  if (*outcome.bound == outcome.pieces) return pieces + " (fewest)";
  return pieces + " (" + std::to_string(*outcome.bound) + " at least)";
}

Outcome Failed(std::string const& path, ExitCode code, std::string const& message) {
  Outcome outcome;
  outcome.path = path;
  outcome.code = code;
  outcome.message = message;
  outcome.verdict = "failed: " + ShortMessage(path, message);
  return outcome;
}

Outcome FitFile(FitMany const& many, std::string const& path) {
  auto const begin = std::chrono::steady_clock::now();
  FitReport const report = many.fit(path);
  Outcome outcome;
  outcome.path = path;
  outcome.isFitted = true;
  outcome.dropped = DroppedHeightsText(report.file) + SkippedLinesText(report.file);
  outcome.points = report.file.points.size();
  outcome.pieces = report.pieces.size();
  outcome.bound = report.fit.fewestPossible;
  outcome.deviation = report.LargestDeviation().relative;
  if (!many.outFolder.empty()) {
    for (Format const format : many.formats) {
      outcome.files.push_back(many.render(report, OutputOf(many, path, format), format));
    }
  }
  Verdict const verdict = VerdictOf(report, outcome.files);
  if (!many.summary.empty()) outcome.row = SummaryRowOf(report, verdict);
  outcome.code = ExitCodeOf(verdict);
  outcome.verdict = Describe(verdict);
  if (verdict != Verdict::WithinTolerance) outcome.message = Complaint(report, outcome.files);
  outcome.seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - begin).count();
  return outcome;
}

/// Calls it; what it throws becomes the outcome of the file.
template <typename Step>
Outcome Guarded(std::string const& path, Step const& step) {
  try {
    return step();
  } catch (Failure const& failure) {
    return Failed(path, ExitCodeOf(failure.Kind()), WithAdvice(failure));
  } catch (std::exception const& error) {
    return Failed(path, ExitCode::Internal, path + ": internal error: " + error.what());
  }
}

Outcome Written(Outcome outcome, Console const& console) {
  Outputs outputs;
  for (FittedFile& file : outcome.files) outputs.Add(file.path, std::move(file.text));
  outputs.Write(console);
  return outcome;
}

/// Prints the lines as the outcomes come in, and adds them up.
class Listing {
 public:
  Listing(FitMany const& many, Console const& console) : many_(many), console_(console) {
    for (std::string const& path : many.paths) width_ = std::max(width_, path.size());
    width_ = std::max(width_, std::string(kName).size());
    Print(kName, {"points", "pieces", "deviation", "seconds"}, "result");
  }

  void Add(Outcome const& outcome) {
    if (outcome.isFitted) {
      Print(outcome.path,
            {std::to_string(outcome.points), PiecesText(outcome), RelativeText(outcome.deviation),
             FormatFixed(outcome.seconds, kTimeDecimals)},
            outcome.verdict);
      points_ += outcome.points;
      pieces_ += outcome.pieces;
      if (largest_.empty() || outcome.deviation > deviation_) {
        deviation_ = outcome.deviation;
        largest_ = outcome.path;
      }
    } else {
      Print(outcome.path, {"-", "-", "-", "-"}, outcome.verdict);
    }
    if (!many_.summary.empty()) rows_.push_back(RowOf(outcome));
    for (std::string const& text : {outcome.dropped, outcome.message}) {
      if (!text.empty()) console_.err << "contour: " << text << '\n';
    }
    ++counts_[outcome.isFitted ? outcome.verdict : "failed"];
    if (Severity(outcome.code) > Severity(worst_)) worst_ = outcome.code;
  }

  ExitCode Finish() {
    std::string text = "\n" + Counted(many_.paths.size(), "file");
    std::string separator = ": ";
    for (auto const& [verdict, count] : counts_) {
      text.append(separator).append(std::to_string(count)).append(" ").append(verdict);
      separator = ", ";
    }
    text += "; " + Counted(points_, "point") + ", " + Counted(pieces_, "piece");
    if (!largest_.empty()) {
      text += "; largest deviation " + RelativeText(deviation_) + " of the tolerance in " +
              Printable(largest_);
    }
    if (many_.showTime) {
      std::chrono::duration<double> const taken = std::chrono::steady_clock::now() - begin_;
      text += "; " + FormatFixed(taken.count(), kTimeDecimals) + " s";
    }
    console_.out << text << '\n';
    if (!many_.summary.empty()) WriteSummary();
    return worst_;
  }

 private:
  static constexpr char const* kName = "file";
  static constexpr std::size_t kWidth = 9;        ///< of a column
  static constexpr std::size_t kBoundWidth = 20;  ///< of "1234 (1200 at least)"

  static SummaryRow RowOf(Outcome const& outcome) {
    if (outcome.isFitted) return outcome.row;
    SummaryRow row;
    row.path = outcome.path;
    row.result = outcome.verdict;
    return row;
  }

  void WriteSummary() {
    bool const isCsv = FormatOf(many_.summary) == Format::Csv;
    Outputs outputs;
    outputs.Add(many_.summary, isCsv ? SummaryCsv(rows_) : SummaryHtml(rows_, many_.head));
    outputs.Write(console_);
    console_.out << "wrote " << Printable(many_.summary) << '\n';
  }

  void Print(std::string const& name, std::array<std::string, 4> const& numbers,
             std::string const& result) const {
    std::string line = name + std::string(width_ - name.size(), ' ');
    for (std::size_t i = 0; i < numbers.size(); ++i) {
      bool const isTime = i + 1 == numbers.size();
      if (isTime && !many_.showTime) continue;
      std::size_t const width = i == 1 && many_.tellsBound ? kBoundWidth : kWidth;
      line += "  " + std::string(width - std::min(width, numbers[i].size()), ' ') + numbers[i];
    }
    console_.out << Printable(line) << "  " << Printable(result)
                 << std::endl;  // at once, for who is waiting
  }

  FitMany const& many_;
  Console const& console_;
  std::size_t width_ = 0;
  std::size_t points_ = 0;
  std::size_t pieces_ = 0;
  double deviation_ = 0.0;
  std::string largest_;
  std::vector<SummaryRow> rows_;
  std::map<std::string, std::size_t> counts_;
  ExitCode worst_ = ExitCode::Ok;
  std::chrono::steady_clock::time_point begin_ = std::chrono::steady_clock::now();
};

void MakeFolder(std::string const& folder) {
  std::error_code error;
  fs::create_directories(folder, error);
  if (error || !fs::is_directory(folder)) {
    throw Failure(FailureKind::File, folder + ": the folder cannot be made: " +
                                         (error ? error.message() : "a file has this name"));
  }
}

}  // namespace

ExitCode RunFitMany(FitMany const& many, Console const& console) {
  if (!many.summary.empty()) RequireWritable({{"--summary", many.summary}});
  if (!many.outFolder.empty()) MakeFolder(many.outFolder);
  int const jobs = many.jobs.value_or(tbb::info::default_concurrency());
  // With more jobs than processors the arena alone would not get its threads.
  tbb::global_control const threads(tbb::global_control::max_allowed_parallelism,
                                    static_cast<std::size_t>(jobs));
  tbb::task_arena arena(jobs);
  Listing listing(many, console);
  std::vector<std::unique_ptr<Outcome>> outcomes(many.paths.size());
  std::size_t next = 0;
  Handover taken;
  Handover done;
  auto const take = [&](tbb::flow_control& control) {
    taken.Take();
    std::size_t const i = next++;
    taken.Give();
    if (i == many.paths.size()) control.stop();
    return i;
  };
  auto const fit = [&](std::size_t i) {
    std::string const& path = many.paths[i];
    outcomes[i] = std::make_unique<Outcome>(Guarded(path, [&] { return FitFile(many, path); }));
    done.Give();
    return i;
  };
  auto const finish = [&](std::size_t i) {
    done.Take();
    Outcome outcome = std::move(*outcomes[i]);
    outcomes[i].reset();
    listing.Add(Guarded(many.paths[i], [&] { return Written(std::move(outcome), console); }));
    done.Give();
  };
  // Some more files on the way than threads, for a slow one not to hold up the others.
  std::size_t const onTheWay = 4 * static_cast<std::size_t>(jobs);
  arena.execute([&] {
    using tbb::filter_mode;
    tbb::parallel_pipeline(
        onTheWay, tbb::make_filter<void, std::size_t>(filter_mode::serial_in_order, take) &
                      tbb::make_filter<std::size_t, std::size_t>(filter_mode::parallel, fit) &
                      tbb::make_filter<std::size_t, void>(filter_mode::serial_in_order, finish));
  });
  done.Take();
  return listing.Finish();
}

}  // namespace Vorn::Cli
