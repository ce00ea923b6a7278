#include "cli/commands/Outputs.h"

#include <filesystem>
#include <memory>
#include <ostream>

#include "vorn/io/Files.h"

namespace Vorn::Cli {

namespace {

bool AreSameFile(std::string const& a, std::string const& b) {
  if (a == "-" || b == "-") return a == b;
  std::error_code error;
  if (std::filesystem::equivalent(a, b, error)) return true;
  // Neither need be there yet.
  auto const whole = [&](std::string const& path) {
    return std::filesystem::weakly_canonical(std::filesystem::absolute(path), error);
  };
  return whole(a) == whole(b);
}

[[noreturn]] void Refuse(NamedFile const& a, NamedFile const& b) {
  std::string const what = b.path == "-" ? "the standard output" : "the same file: " + b.path;
  std::string const who = a.option == b.option ? "two " + a.option : a.option + " and " + b.option;
  throw Failure(FailureKind::BadArgument, who + " name " + what);
}

}  // namespace

void RefuseSharedFiles(std::vector<NamedFile> const& read, std::vector<NamedFile> const& written) {
  for (std::size_t i = 0; i < written.size(); ++i) {
    for (NamedFile const& input : read) {
      // The standard input is not the standard output.
      if (input.path != "-" && AreSameFile(input.path, written[i].path)) Refuse(input, written[i]);
    }
    for (std::size_t k = 0; k < i; ++k) {
      if (AreSameFile(written[k].path, written[i].path)) Refuse(written[k], written[i]);
    }
  }
}

void RequireWritable(std::vector<NamedFile> const& files) {
  for (NamedFile const& file : files) {
    if (file.path != "-") IO::RequireWritable(file.path);
  }
}

void Outputs::Add(std::string const& path, std::string text) {
  texts_.emplace_back(path, std::move(text));
}

void Outputs::Write(Console const& console) const {
  std::vector<std::unique_ptr<AtomicFile>> files;
  for (auto const& [path, text] : texts_) {
    if (path != "-") files.push_back(std::make_unique<AtomicFile>(path, text));
  }
  AtomicFile::CommitAll(files);
  for (auto const& [path, text] : texts_) {
    if (path == "-") console.out << text;
  }
}

}  // namespace Vorn::Cli
