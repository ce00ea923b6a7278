// Which files a fit of many writes, and that none of them is written over another.

#include <filesystem>
#include <map>
#include <optional>
#include <system_error>

#include "cli/commands/FitMany.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {

namespace {

namespace fs = std::filesystem;

constexpr char const* kStandardStream = "-";

/// Paths in one form, so that two that lead to one file are the same.
std::string WholePath(std::string const& path) {
  std::error_code error;
  return fs::weakly_canonical(fs::absolute(path, error), error).string();
}

/// The summary has one of two endings and is none of the inputs.
void RefuseSummary(FitMany const& many, std::map<std::string, std::string> const& inputs) {
  if (many.summary.empty()) return;
  std::optional<Format> const format = FormatOf(many.summary);
  if (format != Format::Csv && format != Format::Html) {
    throw Failure(FailureKind::BadArgument,
                  "--summary " + many.summary + ": the name must end in .csv or .html");
  }
  if (inputs.count(WholePath(many.summary)) > 0) {
    throw Failure(FailureKind::BadArgument,
                  "the summary would be written over the input " + many.summary);
  }
}

}  // namespace

std::string OutputOf(FitMany const& many, std::string const& path, Format format) {
  std::string const name = fs::path(path).stem().string() + "." + NameOf(format);
  return (fs::path(many.outFolder) / name).string();
}

void RefuseCollisions(FitMany const& many) {
  std::map<std::string, std::string> inputs;
  for (std::string const& path : many.paths) {
    if (path == kStandardStream) {
      throw Failure(FailureKind::BadArgument, "the standard input cannot be one of many files");
    }
    inputs.emplace(WholePath(path), path);
  }
  RefuseSummary(many, inputs);
  if (many.outFolder.empty()) return;
  std::map<std::string, std::string> outputs;
  for (std::string const& path : many.paths) {
    for (Format const format : many.formats) {
      std::string const output = OutputOf(many, path, format);
      std::string const whole = WholePath(output);
      if (auto const input = inputs.find(whole); input != inputs.end()) {
        throw Failure(FailureKind::BadArgument,
                      "the fit of " + path + " would be written over the input " + input->second);
      }
      auto const [other, isNew] = outputs.emplace(whole, path);
      if (!isNew) {
        std::string message = "the fits of ";
        message.append(other->second).append(" and ").append(path);
        throw Failure(FailureKind::BadArgument,
                      message.append(" would both be written to ").append(output));
      }
    }
  }
}

}  // namespace Vorn::Cli
